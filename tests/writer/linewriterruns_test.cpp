// Runs of kept lines (writelines) against the same lines one by one, and a
// file large enough to be sent on to the disk while it is written.
#include "writer/linewriter.h"

#include "support/testfiles.h"

#include <QTemporaryDir>

#include <gtest/gtest.h>

using namespace qm;

TEST(LineWriterRuns, RunsGiveTheBytesOfTheirLinesInEveryEncoding)
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

TEST(LineWriterRuns, LargeFileIsWholeAfterCommit)
{
    QTemporaryDir dir;
    const QString path = dir.filePath(QStringLiteral("family.ged"));
    qmtest::writefile(path, "old\r\n");
    std::string runs;
    for (int i = 0; i < 1000; ++i)
        runs += "2 NOTE line " + std::to_string(i) + "\r\n";
    std::string expect;
    linewriter w(textencoding::windows1252, false);
    ASSERT_TRUE(w.open(path));
    for (int k = 0; expect.size() < (24u << 20); ++k) {
        w.writelines(runs, 1000);
        w.writeline("0 @I" + std::to_string(k) + "@ INDI");
        expect += runs + "0 @I" + std::to_string(k) + "@ INDI\r\n";
    }
    EXPECT_EQ(qmtest::readfile(path), "old\r\n");
    ASSERT_TRUE(w.commit());
    EXPECT_TRUE(qmtest::readfile(path) == expect);
}
