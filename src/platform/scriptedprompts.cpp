#include "platform/scriptedprompts.h"

namespace qm {

namespace {
answer defaultof(const message& m)
{
    if (m.defaultanswer)
        return *m.defaultanswer;
    switch (m.choice) {
    case buttons::ok:
    case buttons::okcancel:
        return answer::ok;
    default:
        return answer::yes;
    }
}
} // namespace

void scriptedprompts::expect(answer a, const QString& contains)
{
    answers_.push_back({a, contains, std::move(onnext_)});
    onnext_ = nullptr;
}

void scriptedprompts::expectfile(std::optional<QString> path)
{
    files_.push_back(path ? std::optional<QStringList>(QStringList{*path}) : std::nullopt);
}

void scriptedprompts::expectfiles(std::optional<QStringList> paths)
{
    files_.push_back(std::move(paths));
}

void scriptedprompts::onnext(std::function<void(const message&)> f)
{
    onnext_ = std::move(f);
}

answer scriptedprompts::ask(const message& m)
{
    if (answers_.empty() || (!answers_.front().contains.isEmpty() && !m.text.contains(answers_.front().contains))) {
        history_.push_back({m, false});
        return defaultof(m);
    }
    queued q = std::move(answers_.front());
    answers_.pop_front();
    history_.push_back({m, true});
    if (q.before)
        q.before(m);
    return q.a;
}

std::optional<QStringList> scriptedprompts::nextfiles(const QString& kind, const QString& caption)
{
    message m;
    m.text = caption;
    m.title = QStringLiteral("dialog:") + kind;
    if (files_.empty()) {
        history_.push_back({m, false});
        return std::nullopt;
    }
    auto f = std::move(files_.front());
    files_.pop_front();
    history_.push_back({m, true});
    return f;
}

std::optional<QString> scriptedprompts::openfile(const QString& caption, const QString&, const QString&)
{
    auto f = nextfiles(QStringLiteral("open"), caption);
    if (!f || f->isEmpty())
        return std::nullopt;
    return f->front();
}

std::optional<QStringList> scriptedprompts::openfiles(const QString& caption, const QString&, const QString&)
{
    return nextfiles(QStringLiteral("openmany"), caption);
}

std::optional<QString> scriptedprompts::savefile(const QString& caption, const QString&, const QString&)
{
    auto f = nextfiles(QStringLiteral("save"), caption);
    if (!f || f->isEmpty())
        return std::nullopt;
    return f->front();
}

std::optional<QString> scriptedprompts::choosefolder(const QString& caption, const QString&)
{
    auto f = nextfiles(QStringLiteral("folder"), caption);
    if (!f || f->isEmpty())
        return std::nullopt;
    return f->front();
}

QStringList scriptedprompts::texts() const
{
    QStringList out;
    for (const auto& s : history_)
        out << s.m.text;
    return out;
}

int scriptedprompts::unexpected() const
{
    int n = static_cast<int>(answers_.size() + files_.size());
    for (const auto& s : history_)
        n += s.expected ? 0 : 1;
    return n;
}

void scriptedprompts::clear()
{
    answers_.clear();
    files_.clear();
    history_.clear();
    onnext_ = nullptr;
}

void scriptedprompts::showhelp(int topic, const QString& command)
{
    helpshown << (command.isEmpty() ? QString::number(topic) : command);
}

QString scriptedprompts::openexternal(const QString& target)
{
    opened << target;
    return openerror;
}

} // namespace qm
