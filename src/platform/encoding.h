#pragma once
// Text encodings of family files and the conversions between them.
//
// Inside Quillmark all text taken from a family file is UTF-8. A Windows-1252
// file's bytes are converted when a value is stored; a UTF-16 file is turned
// into UTF-8 line by line by the line reader. Typed text is encoded back into
// the file's own encoding when it is written.

#include <QString>

#include <cstdint>
#include <cstring>
#include <string>
#include <string_view>

namespace qm {

enum class textencoding {
    utf8,        // UTF-8 byte-order mark or "1 CHAR UTF-8"
    windows1252, // "1 CHAR ANSI" or no CHAR line
    utf16le,     // UTF-16 little-endian, with or without byte-order mark
    utf16be,     // UTF-16 big-endian, with or without byte-order mark
    other8bit,   // ANSEL, ASCII, IBMPC ...: shown as Windows-1252, typed text limited to ASCII
};

// "utf-8", "windows-1252" or "utf-16"; other 8-bit sets are shown as
// "windows-1252" since that is how their text is decoded.
const char* encodingname(textencoding enc);

bool isutf16(textencoding enc);

// Encoding named by the value of a "1 CHAR" line of an 8-bit file.
textencoding encodingforchar(std::string_view charvalue);

// Whether every byte is below 0x80; eight bytes at a time, since the loader
// asks this of nearly every value it reads.
inline bool allascii(std::string_view s)
{
    const char* p = s.data();
    size_t n = s.size();
    uint64_t bits = 0;
    while (n >= 8) {
        uint64_t w;
        std::memcpy(&w, p, 8);
        bits |= w;
        p += 8;
        n -= 8;
    }
    while (n--)
        bits |= static_cast<unsigned char>(*p++);
    return (bits & 0x8080808080808080ULL) == 0;
}

// Appends the UTF-8 form of bytes read from an 8-bit file of encoding enc
// (a UTF-16 file's lines are already UTF-8). Invalid UTF-8 sequences in a UTF-8
// file are kept as the Windows-1252 characters of their bytes, so nothing is
// lost to a replacement character.
void appendutf8(std::string_view bytes, textencoding enc, std::string& out);
std::string toutf8(std::string_view bytes, textencoding enc);

// Unicode code point of a Windows-1252 byte (undefined bytes map to U+FFFD...
// except the five undefined ones, which map to their C1 control points so that
// they survive a round trip).
char32_t cp1252tounicode(unsigned char b);
// Windows-1252 byte of a code point, or -1 when the code page has none.
int unicodetocp1252(char32_t cp);

// The code point of the character at utf8[i] and the number of bytes it
// takes. A byte that does not start a valid UTF-8 sequence is taken as the
// Windows-1252 character it would be, one byte long, so that nothing is lost.
char32_t nextcodepoint(std::string_view utf8, size_t i, size_t* len);

// Encodes UTF-8 text for a line of a file in encoding enc (for UTF-16 files:
// into UTF-8, which the line writer turns into UTF-16). Returns false and sets
// *bad to the first character the encoding cannot hold.
bool fromutf8(std::string_view utf8, textencoding enc, std::string& out, char32_t* bad = nullptr);

// The first character of text that a file of encoding enc cannot hold, or 0.
char32_t unencodable(const QString& text, textencoding enc);

inline QString qs(std::string_view utf8)
{
    return QString::fromUtf8(utf8.data(), static_cast<qsizetype>(utf8.size()));
}
inline std::string u8(const QString& s)
{
    return s.toStdString();
}

} // namespace qm
