#pragma once
// Buffered writer of a family file's lines, the counterpart of linereader.
//
// Every line ends with CR LF. A line kept from the input is written as the
// reader handed it out: its bytes unchanged for an 8-bit file, re-encoded from
// UTF-8 into UTF-16 of the file's byte order for a UTF-16 file. A new line is
// UTF-8 text encoded into the file's encoding (Windows-1252, UTF-8, UTF-16, or
// ASCII only for other 8-bit sets).
//
// A file is written safely: the lines go to a temporary file beside it that
// replaces it in one atomic step on commit() (or, for a linked file, is copied
// into it: replacefile.h); until then, and whenever anything fails, the file
// stays as it was. After the first failure nothing more is written and the
// error is kept for the end.

#include "platform/contenthash.h"
#include "platform/encoding.h"
#include "platform/replacefile.h"

#include <QString>

#include <cstdint>
#include <memory>
#include <string>
#include <string_view>

namespace qm {

// Faults a test can make every line writer (and every other safe write of the
// family file) meet, like a full disk or a locked file. In force until reset
// with an empty writefault.
struct writefault {
    bool failopen = false;        // the temporary file cannot be created
    int64_t failafterbytes = -1;  // the device takes this many bytes, then every write fails
    bool failcommit = false;      // the final replace fails
};
void setwritefaultfortests(const writefault& fault);

class linewriter {
public:
    linewriter(textencoding enc, bool bom);
    ~linewriter(); // cancels an uncommitted file
    linewriter(const linewriter&) = delete;
    linewriter& operator=(const linewriter&) = delete;

    // Starts the safe write of path. False with errorstring() on failure.
    bool open(const QString& path);
    // Collects the bytes in memory instead (tests, previews); memory() holds
    // them. `expected` bytes are reserved at once, so that a whole file's
    // worth is not copied again and again as it grows.
    void openmemory(size_t expected = 0);
    const std::string& memory() const { return mem_; }
    // The bytes collected, handed over without a copy.
    std::string takememory() { return std::move(mem_); }

    // A line kept from the input, as the line reader handed it out.
    void writeline(std::string_view line);
    // Lines kept from the input, each with its CR LF line end, in the form
    // the line reader hands them out (linereader::nextcrlflines).
    void writelines(std::string_view lines, int64_t count);
    // A new line of UTF-8 text. False (and the writer failed) when a
    // character cannot be held by the file's encoding: callers check typed
    // text before writing, so this is a fault.
    bool writetext(std::string_view utf8);
    // A new line of text that came from the file itself (flag names ...):
    // for other 8-bit sets it is encoded back through Windows-1252, which
    // gives the file's own bytes.
    bool writefiletext(std::string_view utf8);

    // Bytes kept from the input as they were, outside any line (the stray
    // last byte of a UTF-16 file of an odd length).
    void writeraw(std::string_view bytes);

    // Writes what is buffered and replaces the file, after `check` (asked when
    // the new content is on the disk) agreed. False on failure, with the file
    // untouched unless damaged(); false and withdrawn() when check refused.
    bool commit(const replacefile::lastcheck& check = {});
    // Drops everything written; the file stays as it was.
    void cancel();

    bool failed() const { return failed_; }
    bool withdrawn() const { return withdrawn_; }
    // After commit: the content was copied into the existing file in place.
    bool inplace() const { return inplace_; }
    // A copy in place failed part way: only the backup holds the file now.
    bool damaged() const { return damaged_; }
    QString errorstring() const { return error_; }
    int64_t lines() const { return lines_; }
    textencoding encoding() const { return enc_; }
    // The hash (contenthash.h) of the bytes handed to the file so far: after
    // commit, of the whole new file.
    uint64_t writtenhash() const { return hash_.value(); }

private:
    void fail(const QString& error);
    void start(); // the byte-order mark, once
    void put(std::string_view bytes); // one line's bytes without the line end
    void flush();

    textencoding enc_;
    bool bom_;
    std::unique_ptr<replacefile> file_;
    bool memory_ = false;
    std::string mem_;
    std::string buf_;
    std::string scratch_;
    int64_t written_ = 0;  // bytes handed to the device
    int64_t sentback_ = 0; // bytes of them sent on to the disk
    int64_t lines_ = 0;
    contenthash hash_;
    bool failed_ = false;
    bool started_ = false;
    bool withdrawn_ = false, inplace_ = false, damaged_ = false;
    QString error_;
};

// Appends the UTF-16 form (byte order of enc) of UTF-8 text; bytes that are
// not UTF-8 are taken as the Windows-1252 characters they would be.
void appendutf16(std::string_view utf8, bool bigendian, std::string& out);

} // namespace qm
