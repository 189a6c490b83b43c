#include "writer/linewriter.h"

#include "platform/linereader.h"
#include "support/testfiles.h"

#include <QDir>
#include <QTemporaryDir>

#include <gtest/gtest.h>

using namespace qm;

TEST(LineWriter, Utf16LinesRoundTripThroughTheReader)
{
    for (textencoding enc : {textencoding::utf16le, textencoding::utf16be}) {
        linewriter w(enc, true);
        w.openmemory();
        const std::string line = "1 NAME Zo\xC3\xAB \xF0\x9F\x8C\xB3 /Bront\xC3\xAB/"; // with a character beyond U+FFFF
        w.writeline("0 HEAD");
        w.writeline(line);
        EXPECT_TRUE(w.writetext("1 NOTE \xE2\x82\xAC"));
        ASSERT_TRUE(w.commit());
        const std::string& bytes = w.memory();
        EXPECT_EQ(bytes.substr(0, 2), enc == textencoding::utf16le ? "\xFF\xFE" : "\xFE\xFF");

        linereader r;
        r.openbytes(bytes);
        std::string_view got;
        ASSERT_TRUE(r.next(got));
        EXPECT_EQ(got, "0 HEAD");
        EXPECT_EQ(r.lineend(), "\r\n");
        ASSERT_TRUE(r.next(got));
        EXPECT_EQ(got, line);
        ASSERT_TRUE(r.next(got));
        EXPECT_EQ(got, "1 NOTE \xE2\x82\xAC");
        EXPECT_EQ(r.encoding(), enc);
    }
}

TEST(LineWriter, NewTextIsEncodedForTheFile)
{
    linewriter ansi(textencoding::windows1252, false);
    ansi.openmemory();
    EXPECT_TRUE(ansi.writetext("1 NOTE Caf\xC3\xA9 \xE2\x82\xAC"));
    ansi.writeline("1 NOTE kept \xE9 as read");
    EXPECT_EQ(ansi.memory(), "1 NOTE Caf\xE9 \x80\r\n1 NOTE kept \xE9 as read\r\n");
    EXPECT_FALSE(ansi.writetext("1 NOTE \xC5\x81")); // Ł: not in the code page
    EXPECT_TRUE(ansi.failed());

    linewriter ansel(textencoding::other8bit, false);
    ansel.openmemory();
    EXPECT_FALSE(ansel.writetext("1 NOTE Caf\xC3\xA9"));
    linewriter ansel2(textencoding::other8bit, false);
    ansel2.openmemory();
    EXPECT_TRUE(ansel2.writefiletext("2 __X Caf\xC3\xA9")); // a name read from the file goes back as its bytes
    EXPECT_EQ(ansel2.memory(), "2 __X Caf\xE9\r\n");

    linewriter bom(textencoding::utf8, true);
    bom.openmemory();
    EXPECT_TRUE(bom.commit());
    EXPECT_EQ(bom.memory(), "\xEF\xBB\xBF");
}

TEST(LineWriter, NothingReachesTheFileBeforeCommit)
{
    QTemporaryDir dir;
    const QString path = dir.filePath(QStringLiteral("family.ged"));
    qmtest::writefile(path, "old\r\n");
    {
        linewriter w(textencoding::utf8, false);
        ASSERT_TRUE(w.open(path));
        for (int i = 0; i < 200000; ++i) // more than one buffer's worth
            w.writeline("1 NOTE a line of text");
        EXPECT_EQ(qmtest::readfile(path), "old\r\n");
    } // dropped without commit
    EXPECT_EQ(qmtest::readfile(path), "old\r\n");
    EXPECT_EQ(QDir(dir.path()).entryList(QDir::Files | QDir::Hidden).size(), 1);

    linewriter w(textencoding::utf8, false);
    ASSERT_TRUE(w.open(path));
    w.writeline("new");
    ASSERT_TRUE(w.commit());
    EXPECT_EQ(qmtest::readfile(path), "new\r\n");
}
