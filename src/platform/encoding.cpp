#include "platform/encoding.h"

namespace qm {

namespace {

// Windows-1252 bytes 0x80..0x9F. The five bytes the code page leaves undefined
// map to the C1 control with the same number.
const char16_t cp1252high[32] = {
    0x20AC, 0x0081, 0x201A, 0x0192, 0x201E, 0x2026, 0x2020, 0x2021, 0x02C6, 0x2030, 0x0160,
    0x2039, 0x0152, 0x008D, 0x017D, 0x008F, 0x0090, 0x2018, 0x2019, 0x201C, 0x201D, 0x2022,
    0x2013, 0x2014, 0x02DC, 0x2122, 0x0161, 0x203A, 0x0153, 0x009D, 0x017E, 0x0178,
};

void appendcodepoint(char32_t cp, std::string& out)
{
    if (cp < 0x80) {
        out.push_back(static_cast<char>(cp));
    } else if (cp < 0x800) {
        out.push_back(static_cast<char>(0xC0 | (cp >> 6)));
        out.push_back(static_cast<char>(0x80 | (cp & 0x3F)));
    } else if (cp < 0x10000) {
        out.push_back(static_cast<char>(0xE0 | (cp >> 12)));
        out.push_back(static_cast<char>(0x80 | ((cp >> 6) & 0x3F)));
        out.push_back(static_cast<char>(0x80 | (cp & 0x3F)));
    } else {
        out.push_back(static_cast<char>(0xF0 | (cp >> 18)));
        out.push_back(static_cast<char>(0x80 | ((cp >> 12) & 0x3F)));
        out.push_back(static_cast<char>(0x80 | ((cp >> 6) & 0x3F)));
        out.push_back(static_cast<char>(0x80 | (cp & 0x3F)));
    }
}

// Length of the valid UTF-8 sequence at s[i], or 0 when it is not one.
size_t utf8seq(std::string_view s, size_t i, char32_t* cp)
{
    const auto b0 = static_cast<unsigned char>(s[i]);
    size_t len;
    char32_t v;
    if (b0 < 0x80) {
        *cp = b0;
        return 1;
    } else if (b0 >= 0xC2 && b0 <= 0xDF) {
        len = 2;
        v = b0 & 0x1F;
    } else if (b0 >= 0xE0 && b0 <= 0xEF) {
        len = 3;
        v = b0 & 0x0F;
    } else if (b0 >= 0xF0 && b0 <= 0xF4) {
        len = 4;
        v = b0 & 0x07;
    } else {
        return 0;
    }
    if (i + len > s.size())
        return 0;
    for (size_t k = 1; k < len; ++k) {
        const auto b = static_cast<unsigned char>(s[i + k]);
        if ((b & 0xC0) != 0x80)
            return 0;
        v = (v << 6) | (b & 0x3F);
    }
    if ((len == 3 && (v < 0x800 || (v >= 0xD800 && v <= 0xDFFF))) || (len == 4 && (v < 0x10000 || v > 0x10FFFF)))
        return 0;
    *cp = v;
    return len;
}

} // namespace

char32_t nextcodepoint(std::string_view utf8, size_t i, size_t* len)
{
    char32_t cp;
    *len = utf8seq(utf8, i, &cp);
    if (*len)
        return cp;
    *len = 1;
    return cp1252tounicode(static_cast<unsigned char>(utf8[i]));
}

const char* encodingname(textencoding enc)
{
    switch (enc) {
    case textencoding::utf8:
        return "utf-8";
    case textencoding::utf16le:
    case textencoding::utf16be:
        return "utf-16";
    default:
        return "windows-1252";
    }
}

bool isutf16(textencoding enc)
{
    return enc == textencoding::utf16le || enc == textencoding::utf16be;
}

textencoding encodingforchar(std::string_view v)
{
    while (!v.empty() && (v.back() == ' ' || v.back() == '\t'))
        v.remove_suffix(1);
    while (!v.empty() && (v.front() == ' ' || v.front() == '\t'))
        v.remove_prefix(1);
    std::string up(v);
    for (char& c : up)
        if (c >= 'a' && c <= 'z')
            c = static_cast<char>(c - 32);
    if (up == "UTF-8" || up == "UTF8" || up == "UNICODE")
        return textencoding::utf8;
    if (up.empty() || up == "ANSI" || up == "WINDOWS-1252" || up == "CP1252" || up == "WINDOWS")
        return textencoding::windows1252;
    return textencoding::other8bit;
}

char32_t cp1252tounicode(unsigned char b)
{
    if (b >= 0x80 && b <= 0x9F)
        return cp1252high[b - 0x80];
    return b;
}

int unicodetocp1252(char32_t cp)
{
    if (cp < 0x80 || (cp >= 0xA0 && cp <= 0xFF))
        return static_cast<int>(cp);
    for (int i = 0; i < 32; ++i)
        if (cp1252high[i] == cp)
            return 0x80 + i;
    return -1;
}

void appendutf8(std::string_view bytes, textencoding enc, std::string& out)
{
    if (allascii(bytes)) {
        out.append(bytes);
        return;
    }
    if (enc == textencoding::utf8 || isutf16(enc)) {
        for (size_t i = 0; i < bytes.size();) {
            char32_t cp;
            const size_t len = utf8seq(bytes, i, &cp);
            if (len) {
                out.append(bytes.substr(i, len));
                i += len;
            } else {
                appendcodepoint(cp1252tounicode(static_cast<unsigned char>(bytes[i])), out);
                ++i;
            }
        }
        return;
    }
    for (unsigned char b : bytes)
        appendcodepoint(cp1252tounicode(b), out);
}

std::string toutf8(std::string_view bytes, textencoding enc)
{
    std::string out;
    out.reserve(bytes.size());
    appendutf8(bytes, enc, out);
    return out;
}

bool fromutf8(std::string_view utf8, textencoding enc, std::string& out, char32_t* bad)
{
    if (allascii(utf8)) {
        out.append(utf8);
        return true;
    }
    for (size_t i = 0; i < utf8.size();) {
        size_t len;
        const char32_t cp = nextcodepoint(utf8, i, &len);
        const int cp1252 = enc == textencoding::windows1252 ? unicodetocp1252(cp) : -1;
        if (enc == textencoding::utf8 || isutf16(enc)) {
            appendcodepoint(cp, out);
        } else if (cp1252 >= 0) {
            out.push_back(static_cast<char>(cp1252));
        } else if (cp < 0x80) {
            out.push_back(static_cast<char>(cp));
        } else {
            if (bad)
                *bad = cp;
            return false;
        }
        i += len;
    }
    return true;
}

char32_t unencodable(const QString& text, textencoding enc)
{
    std::string out;
    char32_t bad = 0;
    if (fromutf8(text.toStdString(), enc, out, &bad))
        return 0;
    return bad;
}

} // namespace qm
