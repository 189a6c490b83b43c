#include "platform/linereader.h"

#include <QFile>
#include <QStringDecoder>

#include <algorithm>
#include <cstdint>
#include <cstring>

namespace qm {

namespace {
constexpr size_t chunk = 1 << 20;
// How far into the file the header's "1 CHAR" line is looked for.
constexpr size_t charscan = 64 * 1024;

bool isspace_(char c)
{
    return c == ' ' || c == '\t';
}

} // namespace

// Position of the first CR or LF in data[from, end), or end. Lines are short
// and files long, so this scan is most of the reader's time: it looks at 64
// bytes at once and keeps their bit mask, so that the next few lines cost a
// bit scan each. The mask stays valid while the buffer's bytes stay where
// they are (fill() forgets it).
size_t linereader::findeol(const char* data, size_t from, size_t end)
{
    for (;;) {
        if (from >= eolbase_ && from - eolbase_ < 64) {
            const uint64_t bits = eolmask_ & (~uint64_t{0} << (from - eolbase_));
            if (bits)
                return eolbase_ + static_cast<size_t>(lowestbit(bits));
            from = eolbase_ + 64;
        }
        if (from + 64 > end) {
            while (from < end && data[from] != '\n' && data[from] != '\r')
                ++from;
            return std::min(from, end);
        }
        eolbase_ = from;
        eolmask_ = eolmask(data + from);
    }
}

linereader::linereader() = default;
linereader::~linereader() = default;

bool linereader::open(const QString& path, QString* error)
{
    auto f = std::make_unique<QFile>(path);
    if (!f->open(QIODevice::ReadOnly)) {
        if (error)
            *error = QStringLiteral("The file %1 could not be opened: %2").arg(path, f->errorString());
        return false;
    }
    file_ = std::move(f);
    detect();
    return true;
}

void linereader::openbytes(std::string_view bytes)
{
    mem_ = bytes;
    mempos_ = 0;
    frommem_ = true;
    detect();
}

size_t linereader::readraw(char* dest, size_t max)
{
    if (frommem_) {
        const size_t n = std::min(max, mem_.size() - mempos_);
        if (n)
            std::memcpy(dest, mem_.data() + mempos_, n);
        mempos_ += n;
        return n;
    }
    const qint64 n = file_->read(dest, static_cast<qint64>(max));
    if (n < 0) {
        failed_ = true;
        error_ = file_->errorString();
        return 0;
    }
    return static_cast<size_t>(n);
}

// Reads the first chunk and decides the encoding from it.
void linereader::detect()
{
    eolbase_ = nomask;
    buf_.resize(chunk);
    end_ = readraw(buf_.data(), chunk);
    // Top the first read up so that the header is seen whole even from a pipe-like device.
    while (end_ < chunk && !failed_) {
        const size_t n = readraw(buf_.data() + end_, chunk - end_);
        if (n == 0)
            break;
        end_ += n;
    }
    eof_ = end_ < chunk;
    const auto* b = reinterpret_cast<const unsigned char*>(buf_.data());

    if (end_ >= 3 && b[0] == 0xEF && b[1] == 0xBB && b[2] == 0xBF) {
        encoding_ = textencoding::utf8;
        bom_ = true;
        begin_ = 3;
        return;
    }
    if (end_ >= 2 && ((b[0] == 0xFF && b[1] == 0xFE) || (b[0] == 0xFE && b[1] == 0xFF))) {
        encoding_ = b[0] == 0xFF ? textencoding::utf16le : textencoding::utf16be;
        bom_ = true;
        begin_ = 2;
    } else if (end_ >= 2 && b[0] == '0' && b[1] == 0) {
        encoding_ = textencoding::utf16le;
    } else if (end_ >= 2 && b[0] == 0 && b[1] == '0') {
        encoding_ = textencoding::utf16be;
    }

    if (isutf16(encoding_)) {
        // Keep the raw bytes aside and decode them into the line buffer.
        raw_.assign(buf_.begin() + static_cast<std::ptrdiff_t>(begin_), buf_.begin() + static_cast<std::ptrdiff_t>(end_));
        decoder_ = std::make_unique<QStringDecoder>(encoding_ == textencoding::utf16le ? QStringConverter::Utf16LE
                                                                                       : QStringConverter::Utf16BE);
        begin_ = end_ = 0;
        const QString text = decoder_->decode(QByteArrayView(raw_.data(), static_cast<qsizetype>(raw_.size())));
        decoded(raw_.data(), raw_.size());
        const QByteArray utf8 = text.toUtf8();
        buf_.resize(std::max(chunk, static_cast<size_t>(utf8.size())));
        std::memcpy(buf_.data(), utf8.constData(), static_cast<size_t>(utf8.size()));
        end_ = static_cast<size_t>(utf8.size());
        return;
    }

    // An 8-bit file: the header's "1 CHAR" line names the character set.
    encoding_ = textencoding::windows1252;
    const std::string_view head(buf_.data() + begin_, std::min(end_ - begin_, charscan));
    size_t pos = 0;
    while (pos < head.size()) {
        size_t eol = head.find_first_of("\r\n", pos);
        if (eol == std::string_view::npos)
            eol = head.size();
        std::string_view line = head.substr(pos, eol - pos);
        while (!line.empty() && isspace_(line.front()))
            line.remove_prefix(1);
        if (line.starts_with("1 CHAR ") || line == "1 CHAR") {
            encoding_ = encodingforchar(line.size() > 7 ? line.substr(7) : std::string_view());
            break;
        }
        // The header ends at the first record after it.
        if (pos > 0 && line.starts_with("0 ") && !line.starts_with("0 HEAD"))
            break;
        pos = eol + 1;
    }
}

void linereader::decoded(const char* raw, size_t n)
{
    rawdecoded_ += static_cast<int64_t>(n);
    if (n)
        lastraw_ = raw[n - 1];
}

std::string_view linereader::strayend() const
{
    // A UTF-16 file of an odd number of bytes: the decoder holds the last one.
    if (decoder_ && eof_ && rawdecoded_ % 2 == 1)
        return std::string_view(&lastraw_, 1);
    return {};
}

// Makes room and reads more bytes after the unread ones. False when nothing more came.
bool linereader::fill()
{
    if (eof_ || failed_)
        return false;
    eolbase_ = nomask;
    if (begin_ > 0) {
        std::memmove(buf_.data(), buf_.data() + begin_, end_ - begin_);
        end_ -= begin_;
        begin_ = 0;
    }
    if (buf_.size() - end_ < chunk / 2)
        buf_.resize(buf_.size() + chunk);

    if (!decoder_) {
        const size_t n = readraw(buf_.data() + end_, buf_.size() - end_);
        if (n == 0) {
            eof_ = true;
            return false;
        }
        end_ += n;
        return true;
    }
    raw_.resize(chunk);
    const size_t n = readraw(raw_.data(), chunk);
    if (n == 0) {
        eof_ = true;
        return false;
    }
    const QString text = decoder_->decode(QByteArrayView(raw_.data(), static_cast<qsizetype>(n)));
    decoded(raw_.data(), n);
    const QByteArray utf8 = text.toUtf8();
    if (buf_.size() - end_ < static_cast<size_t>(utf8.size()))
        buf_.resize(end_ + static_cast<size_t>(utf8.size()));
    std::memcpy(buf_.data() + end_, utf8.constData(), static_cast<size_t>(utf8.size()));
    end_ += static_cast<size_t>(utf8.size());
    return true;
}

bool linereader::nextline(std::string_view& line)
{
    truncated_ = false;
    size_t scan = begin_;
    for (;;) {
        const char* data = buf_.data();
        const size_t i = findeol(data, scan, end_);
        if (i < end_) {
            // A line end: look at the following byte to tell CR LF and LF CR
            // from single ones; fetch it first when the buffer ends here.
            if (i + 2 >= end_ && !eof_ && !failed_) {
                const size_t off = i - begin_;
                fill();
                scan = begin_ + off;
                continue;
            }
            data = buf_.data();
            size_t len = 1;
            if (data[i] == '\r') {
                if (i + 1 < end_ && data[i + 1] == '\n')
                    len = 2;
            } else if (i + 1 < end_ && data[i + 1] == '\r' && !(i + 2 < end_ && data[i + 2] == '\n')) {
                // LF CR, unless the CR begins a CR LF of the next (empty) line.
                len = 2;
            }
            line = std::string_view(data + begin_, i - begin_);
            lineend_ = std::string_view(data + i, len);
            begin_ = i + len;
            if (maxline_ && line.size() > maxline_) {
                line = line.substr(0, maxline_);
                truncated_ = true;
            }
            ++linenumber_;
            return true;
        }
        // No line end in what is buffered.
        if (maxline_ && end_ - begin_ > maxline_) {
            // Keep the start of an over-long line and pass over the rest of it.
            cut_.assign(buf_.data() + begin_, maxline_);
            begin_ = end_;
            for (;;) {
                if (begin_ == end_ && !fill())
                    break;
                const char* d = buf_.data();
                size_t k = findeol(d, begin_, end_);
                if (k < end_) {
                    begin_ = k;
                    if (k + 1 >= end_)
                        fill();
                    d = buf_.data();
                    k = begin_;
                    size_t len = 1;
                    if (k + 1 < end_ && ((d[k] == '\r' && d[k + 1] == '\n') || (d[k] == '\n' && d[k + 1] == '\r')))
                        len = 2;
                    begin_ = k + len;
                    break;
                }
                begin_ = end_;
            }
            line = cut_;
            lineend_ = std::string_view("\r\n", 2);
            truncated_ = true;
            ++linenumber_;
            return true;
        }
        const size_t off = end_ - begin_;
        if (!fill()) {
            if (begin_ == end_)
                return false;
            // The last line has no line end.
            line = std::string_view(buf_.data() + begin_, end_ - begin_);
            if (maxline_ && line.size() > maxline_) {
                line = line.substr(0, maxline_);
                truncated_ = true;
            }
            lineend_ = std::string_view();
            begin_ = end_;
            ++linenumber_;
            return true;
        }
        scan = begin_ + off;
    }
}

std::string_view linereader::nextcrlflines(std::string_view stopfirst, int64_t& count)
{
    count = 0;
    const char* data = buf_.data();
    const size_t from = begin_;
    size_t at = begin_;
    const auto stops = [stopfirst](char c) {
        for (const char s : stopfirst)
            if (c == s)
                return true;
        return false;
    };
    while (at < end_ && !stops(data[at])) {
        const size_t i = findeol(data, at, end_);
        if (i + 1 >= end_ || data[i] != '\r' || data[i + 1] != '\n' || (maxline_ && i - at > maxline_))
            break;
        at = i + 2;
        ++count;
    }
    if (count == 0)
        return {};
    begin_ = at;
    linenumber_ += count;
    lineend_ = std::string_view(data + at - 2, 2);
    truncated_ = false;
    return std::string_view(data + from, at - from);
}

} // namespace qm
