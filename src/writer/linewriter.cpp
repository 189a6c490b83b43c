#include "writer/linewriter.h"

#include "platform/writeback.h"

#include <algorithm>

namespace qm {

namespace {

constexpr size_t flushsize = 1 << 20;
// Written bytes are sent on to the disk in steps of this size while the
// rewrite goes on, rather than all at the commit.
constexpr int64_t writebackstep = 8 << 20;

writefault& faultstate()
{
    static writefault f;
    return f;
}

void put16(char16_t u, bool be, std::string& out)
{
    const char hi = static_cast<char>(u >> 8), lo = static_cast<char>(u & 0xFF);
    if (be) {
        out.push_back(hi);
        out.push_back(lo);
    } else {
        out.push_back(lo);
        out.push_back(hi);
    }
}

} // namespace

void setwritefaultfortests(const writefault& fault)
{
    faultstate() = fault;
}

void appendutf16(std::string_view s, bool be, std::string& out)
{
    for (size_t i = 0; i < s.size();) {
        size_t len = 0;
        char32_t cp = nextcodepoint(s, i, &len);
        if (cp >= 0x10000) {
            cp -= 0x10000;
            put16(static_cast<char16_t>(0xD800 + (cp >> 10)), be, out);
            put16(static_cast<char16_t>(0xDC00 + (cp & 0x3FF)), be, out);
        } else {
            put16(static_cast<char16_t>(cp), be, out);
        }
        i += len;
    }
}

linewriter::linewriter(textencoding enc, bool bom) : enc_(enc), bom_(bom) {}

linewriter::~linewriter()
{
    cancel();
}

bool linewriter::open(const QString& path)
{
    file_ = std::make_unique<replacefile>(path);
    if (faultstate().failopen) {
        file_.reset();
        fail(QStringLiteral("Permission denied"));
        return false;
    }
    if (!file_->open()) {
        const QString e = file_->errorstring();
        file_.reset();
        fail(e);
        return false;
    }
    buf_.reserve(flushsize + 4096);
    return true;
}

void linewriter::openmemory(size_t expected)
{
    mem_.reserve(expected);
    memory_ = true;
    mem_.clear();
}

void linewriter::fail(const QString& error)
{
    if (!failed_) {
        failed_ = true;
        error_ = error;
    }
}

void linewriter::put(std::string_view bytes)
{
    if (failed_)
        return;
    start();
    std::string& out = memory_ ? mem_ : buf_;
    if (isutf16(enc_)) {
        const bool be = enc_ == textencoding::utf16be;
        appendutf16(bytes, be, out);
        appendutf16("\r\n", be, out);
    } else {
        out.append(bytes);
        out.append("\r\n");
    }
    ++lines_;
    if (!memory_ && buf_.size() >= flushsize)
        flush();
}

void linewriter::start()
{
    if (started_)
        return;
    started_ = true;
    if (!bom_)
        return;
    std::string& out = memory_ ? mem_ : buf_;
    if (enc_ == textencoding::utf8)
        out.append("\xEF\xBB\xBF");
    else if (enc_ == textencoding::utf16le)
        out.append("\xFF\xFE");
    else if (enc_ == textencoding::utf16be)
        out.append("\xFE\xFF");
}

void linewriter::flush()
{
    if (failed_ || memory_ || !file_ || buf_.empty())
        return;
    const writefault& f = faultstate();
    qint64 want = static_cast<qint64>(buf_.size());
    bool full = false;
    if (f.failafterbytes >= 0 && written_ + want > f.failafterbytes) {
        want = std::max<qint64>(0, f.failafterbytes - written_);
        full = true;
    }
    if (want > 0) {
        if (!file_->write(buf_.data(), want)) {
            fail(file_->errorstring());
            return;
        }
        hash_.add(buf_.data(), static_cast<size_t>(want));
        written_ += want;
        if (written_ - sentback_ >= writebackstep) {
            startwriteback(file_->handle(), sentback_, written_ - sentback_);
            sentback_ = written_;
        }
    }
    if (full) {
        fail(QStringLiteral("No space left on device"));
        return;
    }
    buf_.clear();
}

void linewriter::writeline(std::string_view line)
{
    put(line);
}

void linewriter::writelines(std::string_view lines, int64_t count)
{
    if (failed_ || lines.empty())
        return;
    start();
    std::string& out = memory_ ? mem_ : buf_;
    // Line by line UTF-16 is the same as all at once: the conversion keeps no
    // state from one character to the next.
    if (isutf16(enc_))
        appendutf16(lines, enc_ == textencoding::utf16be, out);
    else
        out.append(lines);
    lines_ += count;
    if (!memory_ && buf_.size() >= flushsize)
        flush();
}

void linewriter::writeraw(std::string_view bytes)
{
    if (failed_ || bytes.empty())
        return;
    start();
    (memory_ ? mem_ : buf_).append(bytes);
}

bool linewriter::writetext(std::string_view utf8)
{
    if (failed_)
        return false;
    scratch_.clear();
    char32_t bad = 0;
    if (!fromutf8(utf8, enc_, scratch_, &bad)) {
        fail(QStringLiteral("the character U+%1 cannot be written in this file's encoding")
                 .arg(QString::number(static_cast<uint>(bad), 16).toUpper().rightJustified(4, QLatin1Char('0'))));
        return false;
    }
    put(scratch_);
    return true;
}

bool linewriter::writefiletext(std::string_view utf8)
{
    if (enc_ != textencoding::other8bit)
        return writetext(utf8);
    if (failed_)
        return false;
    scratch_.clear();
    if (!fromutf8(utf8, textencoding::windows1252, scratch_)) {
        fail(QStringLiteral("a flag name cannot be written in this file's encoding"));
        return false;
    }
    put(scratch_);
    return true;
}

bool linewriter::commit(const replacefile::lastcheck& check)
{
    if (memory_) {
        start();
        return !failed_;
    }
    if (!file_) {
        fail(QStringLiteral("The file was not opened"));
        return false;
    }
    start();
    flush();
    if (failed_) {
        cancel();
        return false;
    }
    if (faultstate().failcommit) {
        cancel();
        fail(QStringLiteral("The file is in use by another program"));
        return false;
    }
    const replacefile::outcome done = file_->commit(check);
    inplace_ = file_->inplace();
    damaged_ = file_->damaged();
    const QString e = file_->errorstring();
    file_.reset();
    if (done == replacefile::outcome::withdrawn) {
        withdrawn_ = true;
        return false;
    }
    if (done == replacefile::outcome::failed) {
        fail(e);
        return false;
    }
    return true;
}

void linewriter::cancel()
{
    // A replacement dropped before its commit removes its temporary file.
    file_.reset();
}

} // namespace qm
