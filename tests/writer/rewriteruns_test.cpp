// Lines kept as they are go through the rewrite in runs when they end in
// CR LF; the result must be what the line-by-line path gives for the same lines.

#include "writer/rewritefile.h"

#include "model/loadgedcom.h"
#include "platform/clock.h"
#include "platform/linereader.h"
#include "support/censusentries.h"

#include <gtest/gtest.h>

using namespace qm;
using qmtest::chosen;

namespace {

// The same lines, each ending in LF.
std::string lfform(const std::string& bytes)
{
    std::string lf;
    linereader r;
    r.openbytes(bytes);
    std::string_view line;
    while (r.next(line))
        (lf += line) += '\n';
    return lf;
}

rewriteresult rewrite(const std::string& input, const rewriterequest& r, std::string& out)
{
    const auto ix = loadgedcombytes(input, {});
    return rewritebytes(input, out, *ix, settings{}, r);
}

} // namespace

TEST(RewriteRuns, CrLfFileGivesTheSameBytesAsItsLfForm)
{
    setclockfortests(QDateTime(QDate(2026, 5, 4), QTime(7, 8, 9)));
    // Indented lines, empty lines, a lone CR, change stamps and record starts
    // among the runs, over more than one buffer of the reader.
    std::string crlf = "0 HEAD\r\n1 CHAR ANSI\r\n";
    for (int i = 1; i <= 20000; ++i) {
        const std::string id = std::to_string(i);
        crlf += "0 @I" + id + "@ INDI\r\n1 NAME Ann /Lee" + id + "/\r\n1 SEX F\r\n";
        crlf += i % 7 == 0 ? "  1 CENS\r\n" : "1 CENS\r\n";
        crlf += "2 DATE 1881\r\n2 PLAC Leeds\r\n\r\n2 SOUR @S1@\r\n1 FAMS @F" + id + "@\r\n";
        crlf += i % 5 == 0 ? "1 CHAN\r\n2 DATE 1 JAN 2000\r\n" : "1 NOTE x\rcut\r\n";
    }
    crlf += "0 @S1@ SOUR\r\n1 TITL Census 1881\r\n0 TRLR\r\n";
    ASSERT_GT(crlf.size(), 2u << 20);

    rewriterequest r;
    r.entry = qmtest::censusof(QStringLiteral("2"), "Census 1891", "Leeds", "5 APR 1891");
    r.entry.selection = {chosen(5, 4, "Someone", "40", "Weaver"), chosen(19999, 19998)};
    std::string a, b;
    const rewriteresult ra = rewrite(crlf, r, a);
    const rewriteresult rb = rewrite(lfform(crlf), r, b);
    setclockfortests(QDateTime());
    ASSERT_TRUE(ra.ok);
    EXPECT_EQ(ra.censusblocks, 2);
    EXPECT_EQ(ra.lines, rb.lines);
    EXPECT_TRUE(a == b);
    EXPECT_NE(a.find("2 SOUR @S1@\r\n1 CENS\r\n2 DATE 5 APR 1891\r\n"), std::string::npos);
}
