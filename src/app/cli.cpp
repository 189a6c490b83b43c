#include "app/cli.h"

#include "flags/flagalloc.h"
#include "platform/settingsstore.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QJsonDocument>

#include <cmath>
#include <cstdio>

namespace qm {

int clifail(const QString& message)
{
    QString line = message;
    line.replace(QLatin1Char('\n'), QLatin1Char(' '));
    const std::string text = "quillmark-cli: " + line.toStdString() + "\n";
    std::fputs(text.c_str(), stderr);
    return clifailure;
}

void cliwarn(const QString& message)
{
    std::fputs(("quillmark-cli: warning: " + message.toStdString() + "\n").c_str(), stderr);
}

void clinote(const QString& message)
{
    std::fputs(("quillmark-cli: note: " + message.toStdString() + "\n").c_str(), stderr);
}

QString cliusage(const QString& name)
{
    QString text = QStringLiteral("usage:\n");
    for (const clicommand& c : clicommands()) {
        if (!name.isEmpty() && name != QLatin1String(c.name))
            continue;
        text += QStringLiteral("  quillmark-cli %1 %2\n      %3\n")
                    .arg(QLatin1String(c.name), QLatin1String(c.args), QLatin1String(c.summary));
    }
    if (name.isEmpty())
        text += QStringLiteral("  quillmark-cli --help\n"
                               "\n--settings S.ini reads the settings from an INI file holding the same value names\n"
                               "as the settings store; without it the user's own settings are used.\n"
                               "Exit status: 0 when done, 2 when the command could not be carried out.\n");
    return text;
}

QStringList takeoperands(QStringList& args)
{
    const qsizetype end = args.indexOf(QStringLiteral("--"));
    if (end < 0)
        return {};
    const QStringList operands = args.mid(end + 1);
    args.resize(end);
    return operands;
}

bool takesettingsoption(QStringList& args, QString* path, QString* error)
{
    static const QString option = QStringLiteral("--settings");
    for (qsizetype i = 0; i < args.size(); ++i) {
        if (args[i] == option) {
            if (i + 1 >= args.size() || args[i + 1].isEmpty()) {
                *error = QStringLiteral("--settings needs the path of an INI file");
                return false;
            }
            *path = args[i + 1];
            args.remove(i, 2);
            return true;
        }
        if (args[i].startsWith(option + QLatin1Char('='))) {
            *path = args[i].mid(option.size() + 1);
            args.remove(i);
            if (path->isEmpty()) {
                *error = QStringLiteral("--settings needs the path of an INI file");
                return false;
            }
            return true;
        }
    }
    return true;
}

std::unique_ptr<clifile> opensettings(const QString& inipath, QString* error)
{
    std::unique_ptr<settingsstore> store;
    if (inipath.isEmpty()) {
        store = settingsstore::native();
    } else {
        const QFileInfo info(inipath);
        if (!info.isFile() || !info.isReadable()) {
            *error = QStringLiteral("the settings file %1 does not exist or cannot be read").arg(inipath);
            return nullptr;
        }
        store = settingsstore::onfile(inipath);
        // An empty file asks for the defaults; anything else must hold settings
        // (values, or only census flag definitions).
        const bool empty = QFile(inipath).size() == 0;
        if (!store->readable()
            || (!empty && !store->holdsany(settingnames()) && !store->groupexists(QStringLiteral("Flags")))) {
            *error = QStringLiteral("the settings file %1 cannot be read as Quillmark settings: it holds none of "
                                    "their values (see docs/cli.md)")
                         .arg(QDir::toNativeSeparators(inipath));
            return nullptr;
        }
        if (empty)
            cliwarn(QStringLiteral("the settings file %1 is empty: every setting takes its default")
                        .arg(QDir::toNativeSeparators(inipath)));
    }
    auto s = std::make_unique<clifile>(std::move(store));
    const settingsload loaded = s->file.readsettings();
    if (!inipath.isEmpty() && !loaded.defaulted.isEmpty() && loaded.defaulted.size() < settingnames().size())
        cliwarn(QStringLiteral("the settings file %1 lacks these values or holds them in a form not accepted, so "
                               "they take their defaults: %2")
                    .arg(QDir::toNativeSeparators(inipath), loaded.defaulted.join(QStringLiteral(", "))));
    return s;
}

bool takeoptionvalue(QStringList& args, qsizetype i, const QString& name, QString& value, QString& error)
{
    if (args[i] == name) {
        if (i + 1 >= args.size()) {
            error = QStringLiteral("%1 needs a value").arg(name);
            return true;
        }
        value = args[i + 1];
        args.remove(i, 2);
        return true;
    }
    if (args[i].startsWith(name + u'=')) {
        value = args[i].mid(name.size() + 1);
        args.remove(i);
        return true;
    }
    return false;
}

QString unknownoption(const QStringList& args)
{
    for (const QString& a : args)
        if (a.startsWith(QLatin1Char('-')) && a != QLatin1String("-"))
            return QStringLiteral("unknown option %1 (see quillmark-cli --help)").arg(a);
    return QString();
}

bool beginargs(QStringList& args, QStringList& operands, QString& inipath, QString& error)
{
    operands = takeoperands(args);
    return takesettingsoption(args, &inipath, &error);
}

bool endargs(QStringList& args, const QStringList& operands, QString& error)
{
    error = unknownoption(args);
    if (!error.isEmpty())
        return false;
    args += operands;
    return true;
}

QString readapplyargs(const QStringList& args, const QString& name, const QString& missing,
                      const std::function<QString(const QString& value)>& take, bool* apply, QStringList* files)
{
    for (qsizetype i = 0; i < args.size(); ++i) {
        const QString& a = args[i];
        QString value;
        if (a == QLatin1String("--apply")) {
            *apply = true;
            continue;
        }
        if (a == name) {
            if (i + 1 >= args.size())
                return missing;
            value = args[++i];
        } else if (a.startsWith(name + QLatin1Char('='))) {
            value = a.mid(name.size() + 1);
        } else if (const QString refused = unknownoption({a}); !refused.isEmpty()) {
            return refused;
        } else {
            files->push_back(a);
            continue;
        }
        if (const QString refused = take(value); !refused.isEmpty())
            return refused;
    }
    return QString();
}

QString censuscountry(const QString& text)
{
    for (const QString& c : flagcountries())
        if (text.trimmed().compare(c, Qt::CaseInsensitive) == 0)
            return c;
    return QString();
}

QString takecountry(const QString& given, QString* country)
{
    *country = censuscountry(given);
    return country->isEmpty() ? QStringLiteral("--country %1: give one of UK, USA, Ireland, Canada").arg(given)
                              : QString();
}

QString checkfamilypath(const QString& path)
{
    const QFileInfo info(path);
    if (!info.exists())
        return QStringLiteral("%1: no such file").arg(QDir::toNativeSeparators(path));
    if (info.isDir())
        return QStringLiteral("%1 is a folder, not a family file").arg(QDir::toNativeSeparators(path));
    return QString();
}

bool clisaved(const saveoutcome& out)
{
    if (!out.saved()) {
        clifail(out.message);
        return false;
    }
    if (!out.logerror.isEmpty())
        cliwarn(out.logerror);
    if (!out.undoerror.isEmpty())
        cliwarn(out.undoerror);
    return true;
}

readoutcome loadfamily(clifile& f, const QString& path)
{
    const readoutcome r = f.file.load(path, true);
    f.loadms = r.ms;
    if (!r.flagerror.isEmpty())
        cliwarn(r.flagerror);
    return r;
}

std::unique_ptr<clifile> openfamily(const QStringList& files, const QString& usage, const QString& inipath)
{
    if (files.size() != 1) {
        clifail(usage);
        return nullptr;
    }
    const QString& path = files.front();
    QString error = checkfamilypath(path);
    std::unique_ptr<clifile> f;
    if (error.isEmpty())
        f = opensettings(inipath, &error);
    if (f) {
        const readoutcome r = loadfamily(*f, path);
        if (r.ok)
            return f;
        error = r.error;
    }
    clifail(error);
    return nullptr;
}

void printline(const QString& text)
{
    printtext(text + u'\n');
}

void printtext(const QString& text)
{
    const QByteArray bytes = text.toUtf8();
    std::fwrite(bytes.constData(), 1, static_cast<size_t>(bytes.size()), stdout);
}

void printjson(const QJsonObject& object)
{
    const QByteArray text = QJsonDocument(object).toJson(QJsonDocument::Compact) + '\n';
    std::fwrite(text.constData(), 1, static_cast<size_t>(text.size()), stdout);
    std::fflush(stdout);
}

void jsonobject::key(const char* key)
{
    if (out_.size() > 1)
        out_ += ", ";
    out_ += '"';
    out_ += key;
    out_ += "\": ";
}

void jsonobject::add(const char* k, int64_t value)
{
    key(k);
    out_ += std::to_string(value);
}

void jsonobject::add(const char* k, double value)
{
    key(k);
    if (!std::isfinite(value)) {
        out_ += "null";
        return;
    }
    char buf[64];
    std::snprintf(buf, sizeof buf, "%.3f", value);
    out_ += buf;
}

void jsonobject::add(const char* k, const QString& value)
{
    key(k);
    appendjsontext(out_, value.toStdString());
}

void appendjsontext(std::string& out, std::string_view utf8)
{
    out += '"';
    for (const char c : utf8) {
        const auto u = static_cast<unsigned char>(c);
        if (c == '"' || c == '\\') {
            out += '\\';
            out += c;
        } else if (u < 0x20) {
            char buf[8];
            std::snprintf(buf, sizeof buf, "\\u%04x", u);
            out += buf;
        } else {
            out += c;
        }
    }
    out += '"';
}

} // namespace qm
