#include "platform/encoding.h"

#include <gtest/gtest.h>

using namespace qm;

TEST(Encoding, Windows1252RoundTrip)
{
    // Every byte of the code page, the five undefined ones included, comes back.
    std::string all;
    for (int b = 1; b < 256; ++b)
        all += static_cast<char>(b);
    std::string back;
    ASSERT_TRUE(fromutf8(toutf8(all, textencoding::windows1252), textencoding::windows1252, back));
    EXPECT_EQ(back, all);
    EXPECT_EQ(toutf8("\x80\xe9", textencoding::windows1252), "\xE2\x82\xAC\xC3\xA9");
}

TEST(Encoding, Utf8KeepsValidAndRescuesInvalidBytes)
{
    EXPECT_EQ(toutf8("J\xC3\xB6rg", textencoding::utf8), "J\xC3\xB6rg");
    // A stray Windows-1252 byte in a UTF-8 file reads as its character.
    EXPECT_EQ(toutf8("Jos\xe9", textencoding::utf8), "Jos\xC3\xA9");
}

TEST(Encoding, RefusesWhatTheFileCannotHold)
{
    std::string out;
    char32_t bad = 0;
    EXPECT_FALSE(fromutf8("\xE2\x84\x96", textencoding::windows1252, out, &bad)); // NUMERO SIGN
    EXPECT_EQ(bad, U'\u2116');
    EXPECT_FALSE(fromutf8("\xC3\xA9", textencoding::other8bit, out, &bad));
    EXPECT_EQ(bad, U'\u00e9');
    out.clear();
    EXPECT_TRUE(fromutf8("\xE2\x84\x96", textencoding::utf8, out));
    EXPECT_EQ(unencodable(QStringLiteral("Caf\u00e9"), textencoding::windows1252), 0u);
    EXPECT_EQ(unencodable(QStringLiteral("\u0141\u00f3d\u017a"), textencoding::windows1252), U'\u0141');
    // The name the command-line tool gives both kinds of UTF-16 file.
    EXPECT_STREQ(encodingname(textencoding::utf16be), "utf-16");
}
