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
#if defined(__SSE2__) || defined(_M_X64)
#include <emmintrin.h>
#endif
#if defined(_MSC_VER) && !defined(__clang__)
#include <intrin.h>
#endif

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
    bool next(std::string_view& line)
    {
        // Most lines end in CR LF within the buffer: those are taken here,
        // everything else by nextline().
        for (size_t from = begin_;;) {
            if (from >= eolbase_ && from - eolbase_ < 64) {
                const uint64_t bits = eolmask_ & (~uint64_t{0} << (from - eolbase_));
                if (bits) {
                    const size_t i = eolbase_ + static_cast<size_t>(lowestbit(bits));
                    const char* data = buf_.data();
                    if (data[i] != '\r' || i + 1 >= end_ || data[i + 1] != '\n' || (maxline_ && i - begin_ > maxline_))
                        break;
                    line = std::string_view(data + begin_, i - begin_);
                    lineend_ = std::string_view(data + i, 2);
                    begin_ = i + 2;
                    truncated_ = false;
                    ++linenumber_;
                    return true;
                }
                from = eolbase_ + 64;
            }
            if (from + 64 > end_)
                break;
            eolbase_ = from;
            eolmask_ = eolmask(buf_.data() + from);
        }
        return nextline(line);
    }

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

    // After the last line of a UTF-16 file of an odd number of bytes: the
    // stray last byte, which is no character and so in no line; else "".
    std::string_view strayend() const;

    textencoding encoding() const { return encoding_; }
    bool hasbom() const { return bom_; }
    bool failed() const { return failed_; }
    QString errorstring() const { return error_; }
    int64_t linenumber() const { return linenumber_; }

private:
    static constexpr size_t nomask = static_cast<size_t>(-1);

    // Bit i set where data[i] is CR or LF, for 64 bytes.
    static uint64_t eolmask(const char* data)
    {
        uint64_t mask = 0;
#if defined(__SSE2__) || defined(_M_X64)
        const __m128i lf = _mm_set1_epi8('\n');
        const __m128i cr = _mm_set1_epi8('\r');
        for (int k = 0; k < 4; ++k) {
            const __m128i v = _mm_loadu_si128(reinterpret_cast<const __m128i*>(data + 16 * k));
            const int m = _mm_movemask_epi8(_mm_or_si128(_mm_cmpeq_epi8(v, lf), _mm_cmpeq_epi8(v, cr)));
            mask |= static_cast<uint64_t>(static_cast<uint16_t>(m)) << (16 * k);
        }
#else
        for (int i = 0; i < 64; ++i)
            if (data[i] == '\n' || data[i] == '\r')
                mask |= uint64_t{1} << i;
#endif
        return mask;
    }
    static int lowestbit(uint64_t bits)
    {
#if defined(_MSC_VER) && !defined(__clang__)
        unsigned long bit;
        _BitScanForward64(&bit, bits);
        return static_cast<int>(bit);
#else
        return __builtin_ctzll(bits);
#endif
    }

    bool nextline(std::string_view& line);

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
    int64_t rawdecoded_ = 0; // UTF-16 bytes handed to the decoder
    char lastraw_ = 0;       // the last of them
    void decoded(const char* raw, size_t n);

    size_t maxline_ = 0;
    std::string cut_;
    bool truncated_ = false;
    std::string_view lineend_;
    int64_t linenumber_ = 0;
};

} // namespace qm
