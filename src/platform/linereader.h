#pragma once
// Buffered, one-pass reader of a family file's lines.
//
// Lines come out as byte views without their line ends, valid until the next
// call. Line ends may be CR LF, LF, CR or LF CR, mixed within one file. The
// reader finds the file's encoding (byte-order mark, UTF-16 without one, or the
// header's "1 CHAR" line); lines of a UTF-16 file are handed out as UTF-8, all
// others as the file's own bytes.

#include "platform/encoding.h"

#include <QString>

#include <cstdint>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

class QIODevice;
class QStringDecoder;

namespace qm {

class linereader {
public:
    linereader();
    ~linereader();
    linereader(const linereader&) = delete;
    linereader& operator=(const linereader&) = delete;

    // Opens a file. On failure returns false with a message for the user.
    bool open(const QString& path, QString* error = nullptr);
    // Reads from bytes held in memory (tests, fuzzing). The bytes must outlive the reader.
    void openbytes(std::string_view bytes);

    // Lines longer than this are cut to it and the rest of the line is passed
    // over, so that a damaged file cannot make the reader hold it whole.
    // 0 (the default) means no limit.
    void setmaxline(size_t bytes) { maxline_ = bytes; }

    // The next line, without its line end. False at the end of the file or
    // after a read error (see failed()).
    bool next(std::string_view& line);

    // For a caller that copies most lines through unchanged: the buffered
    // lines that follow, whole with their line ends, as long as each ends in
    // CR LF, does not begin with a byte of `stopfirst` and is not cut by the
    // line limit. The caller reads the others with next(). The bytes are in
    // the form lines are handed out, valid until the next call; `count` gets
    // the number of lines. Often empty.
    std::string_view nextcrlflines(std::string_view stopfirst, int64_t& count);

    // The line end that followed the line last returned, in the form lines are
    // handed out: "\r\n", "\n", "\r", "\n\r", or "" for a last line without one.
    std::string_view lineend() const { return lineend_; }
    bool linetruncated() const { return truncated_; }

    textencoding encoding() const { return encoding_; }
    bool hasbom() const { return bom_; }
    bool failed() const { return failed_; }
    QString errorstring() const { return error_; }
    int64_t linenumber() const { return linenumber_; }

private:
    static constexpr size_t nomask = static_cast<size_t>(-1);

    size_t findeol(const char* data, size_t from, size_t end);
    size_t readraw(char* dest, size_t max);
    bool fill();
    void detect();

    std::unique_ptr<QIODevice> file_;
    std::string_view mem_;
    size_t mempos_ = 0;
    bool frommem_ = false;

    std::vector<char> buf_;
    size_t begin_ = 0, end_ = 0;
    size_t eolbase_ = nomask; // where the bytes of eolmask_ start in buf_
    uint64_t eolmask_ = 0;    // CR and LF among the 64 bytes from eolbase_
    bool eof_ = false;
    bool failed_ = false;
    QString error_;

    textencoding encoding_ = textencoding::windows1252;
    bool bom_ = false;
    std::unique_ptr<QStringDecoder> decoder_;
    std::vector<char> raw_;

    size_t maxline_ = 0;
    std::string cut_;
    bool truncated_ = false;
    std::string_view lineend_;
    int64_t linenumber_ = 0;
};

} // namespace qm
