#include "log/logpages.h"

#include "platform/encoding.h"

#include <QFile>

namespace qm {

bool logpages::open(const QString& path)
{
    path_ = path;
    text_.clear();
    page_ = 0;
    pending_ = false;
    reader_.reset();
    bytes_.clear();
    QFile file(path);
    if (!file.open(QIODevice::ReadOnly))
        return false;
    bytes_ = file.readAll();
    if (file.error() != QFileDevice::NoError) {
        bytes_.clear();
        return false;
    }
    file.close();
    reader_ = std::make_unique<linereader>();
    reader_->openbytes(std::string_view(bytes_.constData(), static_cast<size_t>(bytes_.size())));
    std::string_view line;
    if (reader_->next(line)) {
        held_.assign(line);
        pending_ = true;
    }
    nextpage();
    return true;
}

bool logpages::readline(QString& line)
{
    if (!pending_)
        return false;
    // The log is written as UTF-8; an older log in the ANSI code page keeps
    // its characters, since bytes that are not UTF-8 are read as Windows-1252.
    if (reader_ && isutf16(reader_->encoding()))
        line = qs(held_);
    else
        line = qs(toutf8(held_, textencoding::utf8));
    std::string_view next;
    pending_ = reader_ && reader_->next(next);
    if (pending_)
        held_.assign(next);
    return true;
}

void logpages::nextpage()
{
    ++page_;
    text_.clear();
    qsizetype count = 0;
    QString line;
    while (count < pagesize && readline(line)) {
        qsizetype end = line.size();
        while (end > 0 && line.at(end - 1) == u' ')
            --end;
        line.truncate(end);
        text_ += line;
        text_ += QLatin1String("\r\n");
        count += line.size() + 2;
    }
}

} // namespace qm
