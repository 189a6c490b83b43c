#include "writer/linewriter.h"

#include "platform/linereader.h"
#include "support/testfiles.h"

#include <QDir>
#include <QTemporaryDir>

#include <gtest/gtest.h>

using namespace qm;

TEST(LineWriter, Utf16LinesRoundTripThroughTheReader)
{
    const std::vector<std::string> lines{"0 HEAD", "1 NAME Zo\xC3\xAB \xF0\x9F\x8C\xB3 /Bront\xC3\xAB/", // beyond U+FFFF
                                         "1 NOTE \xE2\x82\xAC"};
    for (textencoding enc : {textencoding::utf16le, textencoding::utf16be}) {
        linewriter w(enc, true);
        w.openmemory();
        w.writeline(lines[0]);
        w.writeline(lines[1]);
        EXPECT_TRUE(w.writetext(lines[2]));
        ASSERT_TRUE(w.commit());
        EXPECT_EQ(w.memory().substr(0, 2), enc == textencoding::utf16le ? "\xFF\xFE" : "\xFE\xFF");
        linereader r;
        r.openbytes(w.memory());
        std::vector<std::string> got;
        for (std::string_view line; r.next(line);)
            got.push_back(std::string(line) + (r.lineend() == "\r\n" ? "" : " (no CR LF)"));
        EXPECT_EQ(got, lines);
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

TEST(LineWriter, RunsGiveTheBytesOfTheirLinesInEveryEncoding)
{
    const std::string run = "1 NAME Ren\xC3\xA9 /Lee/\r\n\r\n2 DATE 1881\r\n";
    for (const textencoding enc : {textencoding::windows1252, textencoding::utf8, textencoding::utf16le,
                                   textencoding::utf16be}) {
        linewriter a(enc, true), b(enc, true);
        a.openmemory();
        b.openmemory();
        a.writelines(run, 3);
        a.writeline("0 TRLR");
        for (const char* line : {"1 NAME Ren\xC3\xA9 /Lee/", "", "2 DATE 1881", "0 TRLR"})
            b.writeline(line);
        ASSERT_TRUE(a.commit());
        ASSERT_TRUE(b.commit());
        EXPECT_EQ(a.memory(), b.memory()) << encodingname(enc);
        EXPECT_EQ(a.lines(), 4);
    }
}

// A file large enough to be sent on to the disk while it is written: nothing
// of it reaches the family file before the commit, all of it after.
TEST(LineWriter, NothingReachesTheFileBeforeCommit)
{
    QTemporaryDir dir;
    const QString path = dir.filePath(QStringLiteral("family.ged"));
    qmtest::writefile(path, "old\r\n");
    std::string runs;
    for (int i = 0; i < 1000; ++i)
        runs += "2 NOTE line " + std::to_string(i) + "\r\n";
    const auto fill = [&](linewriter& w) {
        std::string expect;
        for (int k = 0; expect.size() < (24u << 20); ++k) {
            w.writelines(runs, 1000);
            w.writeline("0 @I" + std::to_string(k) + "@ INDI");
            expect += runs + "0 @I" + std::to_string(k) + "@ INDI\r\n";
        }
        return expect;
    };
    {
        linewriter w(textencoding::windows1252, false);
        ASSERT_TRUE(w.open(path));
        fill(w);
        EXPECT_EQ(qmtest::readfile(path), "old\r\n");
    } // dropped without commit
    EXPECT_EQ(qmtest::readfile(path), "old\r\n");
    EXPECT_EQ(QDir(dir.path()).entryList(QDir::Files | QDir::Hidden).size(), 1);

    linewriter w(textencoding::windows1252, false);
    ASSERT_TRUE(w.open(path));
    const std::string expect = fill(w);
    EXPECT_EQ(qmtest::readfile(path), "old\r\n");
    ASSERT_TRUE(w.commit());
    EXPECT_TRUE(qmtest::readfile(path) == expect);
}
