// Placement rules and edge cases of the rewrite, checked on the lines they
// concern, and the small formats shared by the record writers.

#include "writer/rewritefile.h"

#include "images/imagechoices.h"
#include "model/loadgedcom.h"
#include "platform/clock.h"
#include "writer/linewriter.h"
#include "writer/recordwriters.h"
#include "writer/rewritechecks.h"
#include "support/censusentries.h"

#include <gtest/gtest.h>

using namespace qm;
using qmtest::censusof;
using qmtest::chosen;

namespace {

std::vector<std::string> lines(const std::string& bytes)
{
    std::vector<std::string> out;
    size_t start = 0;
    for (size_t at; (at = bytes.find("\r\n", start)) != std::string::npos; start = at + 2)
        out.push_back(bytes.substr(start, at - start));
    return out;
}

size_t lineat(const std::vector<std::string>& ls, const std::string& line)
{
    for (size_t i = 0; i < ls.size(); ++i)
        if (ls[i] == line)
            return i;
    return std::string::npos;
}

std::vector<std::string> multiline(std::string_view text, std::string_view first, std::string_view cont)
{
    linewriter w(textencoding::utf8, false);
    w.openmemory();
    writemultiline(w, text, first, cont);
    return lines(w.memory());
}

struct run {
    rewriteresult result;
    std::vector<std::string> out;
};

run rewrite(const std::string& input, const settings& s, const rewriterequest& r, const flagtable& defs = {})
{
    auto ix = loadgedcombytes(input, defs);
    std::string out;
    run x;
    x.result = rewritebytes(input, out, *ix, s, r);
    x.out = lines(out);
    return x;
}

class RewriteEdges : public ::testing::Test {
protected:
    void SetUp() override { setclockfortests(QDateTime(QDate(2026, 5, 4), QTime(7, 8, 9))); }
    void TearDown() override { setclockfortests(QDateTime()); }
};

} // namespace

TEST(RecordFormats, MultiLineTextsSplitAtEveryKindOfLineBreak)
{
    using v = std::vector<std::string>;
    EXPECT_EQ(multiline("a\r\nb\nc\rd", "4 TEXT ", "5 CONT "), (v{"4 TEXT a", "5 CONT b", "5 CONT c", "5 CONT d"}));
    EXPECT_EQ(multiline("one\r\n\r\nthree", "4 TEXT ", "5 CONT "), (v{"4 TEXT one", "5 CONT ", "5 CONT three"}));
    EXPECT_EQ(multiline("note\r\n", "3 NOTE ", "4 CONT "), (v{"3 NOTE note"}));
    EXPECT_EQ(multiline("note\n\n", "3 NOTE ", "4 CONT "), (v{"3 NOTE note", "4 CONT "}));
    EXPECT_EQ(multiline("", "1 TEXT ", "2 CONT "), (v{"1 TEXT "}));
    EXPECT_EQ(multiline("", "1 CONT ", "1 CONT "), v{});
    EXPECT_EQ(multiline("  kept as typed  ", "1 NOTE ", "2 CONT "), (v{"1 NOTE   kept as typed  "}));
}

TEST(RecordFormats, OneLineValuesNeverCarryALineBreak)
{
    EXPECT_EQ(oneline(QStringLiteral(" Leeds\r\nYorkshire\nEngland\r ")), "Leeds Yorkshire England");
    EXPECT_EQ(censusyear(QStringLiteral("30 MAR 1851"), 0), "1851");
    EXPECT_EQ(censusyear(QStringLiteral("1851"), 0), "1851");
    EXPECT_EQ(censusyear(QStringLiteral("MAR 18511"), 1851), "1851");
}

TEST_F(RewriteEdges, FirstSourceAndFirstImagesGoBeforeTheirFirstFollowers)
{
    // No source and no multimedia record yet: the new source (number 1) goes
    // before the first submitter record, the images before the first note.
    const std::string input = "0 HEAD\r\n0 @I1@ INDI\r\n1 NAME A\r\n0 @N1@ NOTE x\r\n0 @U1@ SUBM\r\n0 TRLR\r\n";
    rewriterequest r;
    r.entry = censusof(QStringLiteral("1"), "Census 1881 Leeds", "Leeds\r\nYorkshire");
    r.entry.selection = {chosen(1, 0, "Someone", "40", "-")};
    imagechoice img;
    img.objectid = 1;
    img.isnew = true;
    r.entry.chosenimages = {img};
    const run x = rewrite(input, settings{}, r);
    ASSERT_TRUE(x.result.ok) << x.result.message.toStdString();
    EXPECT_LT(lineat(x.out, "0 @O1@ OBJE"), lineat(x.out, "0 @N1@ NOTE x"));
    EXPECT_EQ(lineat(x.out, "0 @S1@ SOUR") + 9, lineat(x.out, "0 @U1@ SUBM")); // TITL, _TYPE, TEXT, OBJE, _ASID, CHAN
    EXPECT_NE(lineat(x.out, "2 PLAC Leeds Yorkshire"), std::string::npos);
    // A one-character occupation gives no OCCU, but the record still gets a change stamp.
    EXPECT_EQ(lineat(x.out, "1 OCCU -"), std::string::npos);
    EXPECT_EQ(x.out[lineat(x.out, "0 @N1@ NOTE x") - 3], "1 CHAN");
    EXPECT_EQ(x.result.maxobjectid, 1);
    EXPECT_EQ(x.result.censusblocks, 1);
}

TEST_F(RewriteEdges, TheFirstSharedNoteIsNumberOneAndTheCountersComeBack)
{
    const std::string input = "0 HEAD\r\n0 @I1@ INDI\r\n0 @R1@ REPO\r\n0 TRLR\r\n";
    settings s;
    s.fullentry = false;
    s.sharednote = true;
    rewriterequest r;
    r.entry = censusof(QStringLiteral("7"), "", "");
    r.entry.selection = {chosen(1, 0)};
    const run x = rewrite(input, s, r);
    ASSERT_TRUE(x.result.ok);
    EXPECT_EQ(x.result.maxnoteid, 1);
    EXPECT_EQ(lineat(x.out, "0 @N1@ NOTE Census 1881 ") + 6, lineat(x.out, "0 @R1@ REPO"));
    EXPECT_NE(lineat(x.out, "3 NOTE @N1@"), std::string::npos);
    EXPECT_EQ(newnotenumber(-1), 1);
    EXPECT_EQ(newnotenumber(0), 1);
    EXPECT_EQ(newnotenumber(12), 13);
}

TEST_F(RewriteEdges, IndentedLinesAreRecognisedAndKept)
{
    const std::string input = "0 HEAD\r\n  0 @I1@ INDI\r\n\t1 NAME A\r\n  1 CHAN\r\n    2 DATE 1 JAN 2000\r\n  0 TRLR\r\n";
    rewriterequest r;
    r.entry = censusof(QStringLiteral("1"), "", "");
    r.entry.selection = {chosen(1, 0)};
    const run x = rewrite(input, settings{}, r);
    ASSERT_TRUE(x.result.ok);
    EXPECT_EQ(x.out[2], "\t1 NAME A");
    EXPECT_EQ(x.out[3], "1 CENS");
    EXPECT_EQ(lineat(x.out, "    2 DATE 1 JAN 2000"), std::string::npos);
    EXPECT_EQ(x.out.back(), "  0 TRLR");
}

TEST_F(RewriteEdges, WhatCannotBeFoundStopsTheRunWithTheFileUntouched)
{
    const std::string input = "0 HEAD\r\n0 @I1@ INDI\r\n0 @S1@ SOUR\r\n0 TRLR\r\n";
    rewriterequest r;
    r.entry = censusof(QStringLiteral("2"), "", "");
    r.entry.selection = {chosen(1, 0), chosen(9, -1)};
    run x = rewrite(input, settings{}, r);
    EXPECT_FALSE(x.result.ok);
    EXPECT_TRUE(x.result.refused);
    EXPECT_TRUE(x.result.message.contains(QStringLiteral("Someone (9)"))) << x.result.message.toStdString();
    EXPECT_TRUE(x.out.empty());

    rewriterequest a;
    a.mode = rewritemode::attachimages;
    a.entry.sourceid = QStringLiteral("5");
    a.entry.title = QStringLiteral("Census 1881");
    imagechoice img;
    img.objectid = 3;
    a.entry.chosenimages = {img};
    x = rewrite(input, settings{}, a);
    EXPECT_TRUE(x.result.refused);
    EXPECT_TRUE(x.result.message.contains(QStringLiteral("(ID: 5)")));
}

TEST_F(RewriteEdges, FlagUseGivesTheFlagOnceAndCountsIt)
{
    flagtable defs{{"__C1881", "Census 1881", "1881", 0, "UK"}, {"__C1891", "Census 1891", "1891", 0, "USA"}};
    const std::string input = "0 HEAD\r\n0 @I1@ INDI\r\n1 _FLGS\r\n2 __C1881 Census 1881\r\n"
                              "0 @I2@ INDI\r\n1 _FLGS\r\n2 __C18811 Other\r\n0 TRLR\r\n";
    settings s;
    s.flaguse = true;
    rewriterequest r;
    r.entry = censusof(QStringLiteral("1"), "", "");
    r.entry.selection = {chosen(1, 0), chosen(2, 1)};
    run x = rewrite(input, s, r, defs);
    ASSERT_TRUE(x.result.ok);
    EXPECT_EQ(x.result.entryflag, std::optional<size_t>(0));
    EXPECT_EQ(x.result.flaggiven, 1);
    EXPECT_EQ(std::count(x.out.begin(), x.out.end(), "1 _FLGS"), 2);
    EXPECT_EQ(std::count(x.out.begin(), x.out.end(), "2 __C1881 Census 1881"), 2);

    // No flag of the configured country for that census: nothing is given.
    s.country = QStringLiteral("USA");
    x = rewrite(input, s, r, defs);
    EXPECT_FALSE(x.result.entryflag.has_value());
    EXPECT_EQ(std::count(x.out.begin(), x.out.end(), "2 __C1881 Census 1881"), 1);
}

TEST_F(RewriteEdges, AFlagNameTheFileCannotHoldIsRefused)
{
    flagtable defs{{"__SPIS_1881", "Spis ludno\xC5\x9B\x63i", "1881", 0, "UK"}};
    const std::string input = "0 HEAD\r\n1 CHAR ANSI\r\n0 @I1@ INDI\r\n0 TRLR\r\n";
    rewriterequest r;
    r.mode = rewritemode::flagchanges;
    r.flagchanges = {{0, 0, true}};
    const run x = rewrite(input, settings{}, r, defs);
    EXPECT_TRUE(x.result.refused);
    EXPECT_TRUE(x.result.message.startsWith(QStringLiteral("The flag Spis"))) << x.result.message.toStdString();
}

TEST_F(RewriteEdges, FlagsAreChangedInTheirOwnBlockWhereverItStands)
{
    flagtable defs{{"__C1881", "Census 1881", "1881", 0, "UK"}, {"__C1891", "Census 1891", "1891", 0, "UK"}};
    const std::string chan = "1 CHAN\r\n2 DATE 1 JAN 2000\r\n";
    // I1's block after its change stamp; I2's in two blocks (as an earlier
    // fault wrote them); I3 does not hold the flag asked to go, only one whose
    // code begins with it (codes are compared whole).
    const std::string input = "0 HEAD\r\n0 @I1@ INDI\r\n1 NAME A\r\n" + chan
                            + "1 _FLGS\r\n2 __C1881 Census 1881\r\n2 LIVING Kept\r\n"
                              "0 @I2@ INDI\r\n1 _FLGS\r\n2 __C1891 Census 1891\r\n" + chan
                            + "1 _FLGS\r\n2 __C1881 Census 1881\r\n0 @I3@ INDI\r\n1 _FLGS\r\n2 __C18911 Longer\r\n" + chan
                            + "0 TRLR\r\n";
    const std::vector<std::string> stamp{"1 CHAN", "2 DATE 04 MAY 2026", "3 TIME 07:08:09"};
    const auto join = [](std::initializer_list<std::vector<std::string>> parts) {
        std::vector<std::string> out;
        for (const auto& p : parts)
            out.insert(out.end(), p.begin(), p.end());
        return out;
    };
    rewriterequest r;
    r.mode = rewritemode::flagchanges;
    r.flagchanges = {{0, 0, false}, {0, 1, true}, {1, 0, false}, {2, 1, false}};
    run x = rewrite(input, settings{}, r, defs);
    ASSERT_TRUE(x.result.ok);
    EXPECT_EQ(x.result.flagchangesmade, 3);
    EXPECT_EQ(x.out, join({{"0 HEAD", "0 @I1@ INDI", "1 NAME A", "1 _FLGS", "2 __C1891 Census 1891", "2 LIVING Kept"},
                           stamp,
                           {"0 @I2@ INDI", "1 _FLGS", "2 __C1891 Census 1891"},
                           stamp,
                           {"0 @I3@ INDI", "1 _FLGS", "2 __C18911 Longer", "1 CHAN", "2 DATE 1 JAN 2000", "0 TRLR"}}));

    // A census entry recording its flag puts it into the block after the stamp.
    settings s;
    s.flaguse = true;
    r = rewriterequest();
    r.entry = censusof(QStringLiteral("1"), "", "");
    r.entry.selection = {chosen(1, 0)};
    x = rewrite("0 HEAD\r\n0 @I1@ INDI\r\n" + chan + "1 _FLGS\r\n2 __C1891 Census 1891\r\n0 TRLR\r\n", s, r, defs);
    ASSERT_TRUE(x.result.ok);
    EXPECT_EQ(x.result.flaggiven, 1);
    const auto header = std::find(x.out.begin(), x.out.end(), "1 _FLGS");
    ASSERT_GE(std::distance(header, x.out.end()), 6);
    EXPECT_LT(lineat(x.out, "1 CENS"), lineat(x.out, "1 _FLGS"));
    EXPECT_EQ(std::vector<std::string>(header, header + 6),
              join({{"1 _FLGS", "2 __C1881 Census 1881", "2 __C1891 Census 1891"}, stamp}));
}

// Identifiers other programs write: records are cited as they are named, and
// an identifier that cannot tell records apart, or a number that is not left,
// refuses the change before anything is written.
TEST_F(RewriteEdges, RecordsAreCitedByTheirOwnIdentifiers)
{
    const std::string input = "0 HEAD\r\n0 @I1@ INDI\r\n1 NAME Ann /Lee/\r\n0 @S0001@ SOUR\r\n1 TITL Census 1881\r\n"
                              "0 @O0003@ OBJE\r\n1 FILE p.jpg\r\n0 TRLR\r\n";
    const auto ix = loadgedcombytes(input, {});
    settings s;
    s.fullentry = false;
    rewriterequest r;
    r.entry = censusof(QStringLiteral("1"), "Census 1881", "Leeds");
    r.entry.selection.push_back(chosen(1, 0, "Lee, Ann", "30"));
    addexistingimage(r.entry.chosenimages, ix->objects.at(0));
    ASSERT_TRUE(checkidentifiers(*ix, s, r).isEmpty());
    std::string out;
    ASSERT_TRUE(rewritebytes(input, out, *ix, s, r).ok);
    EXPECT_NE(out.find("2 SOUR @S0001@\r\n"), std::string::npos) << out;
    EXPECT_NE(out.find("3 OBJE @O0003@\r\n"), std::string::npos) << out;

    r.mode = rewritemode::attachimages;
    ASSERT_TRUE(rewritebytes(input, out, *ix, s, r).ok);
    EXPECT_NE(out.find("0 @S0001@ SOUR\r\n1 TITL Census 1881\r\n1 OBJE @O0003@\r\n"), std::string::npos) << out;
}

struct identifiercase {
    const char* name;
    const char* records;  // the family file's records
    bool fullentry, sharednote;
    const char* refusal;  // the start of the message
};

class RewriteIdentifiers : public ::testing::TestWithParam<identifiercase> {};

TEST_P(RewriteIdentifiers, ThatCannotServeAreRefused)
{
    const identifiercase& c = GetParam();
    const auto ix = loadgedcombytes(std::string("0 HEAD\r\n") + c.records + "0 TRLR\r\n", {});
    settings s;
    s.fullentry = c.fullentry;
    s.sharednote = c.sharednote;
    rewriterequest r;
    r.entry = censusof(c.fullentry ? QString::number(ix->nextsourceid) : QStringLiteral("1"), "Census", "Leeds");
    r.entry.selection.push_back(chosen(1, 0, "Lee, Ann", "30"));
    const QString refusal = checkidentifiers(*ix, s, r);
    if (*c.refusal == 0)
        EXPECT_TRUE(refusal.isEmpty()) << refusal.toStdString();
    else
        EXPECT_TRUE(refusal.startsWith(QString::fromUtf8(c.refusal))) << refusal.toStdString();
}

INSTANTIATE_TEST_SUITE_P(
    Files, RewriteIdentifiers,
    ::testing::Values(
        identifiercase{"TwoIndividualsOneNumber", "0 @I1@ INDI\r\n0 @I01@ INDI\r\n0 @S1@ SOUR\r\n", true, false,
                       "The record number 1 of Lee, Ann belongs to two records"},
        identifiercase{"TwoSourcesOneNumber", "0 @I1@ INDI\r\n0 @S1@ SOUR\r\n0 @S1@ SOUR\r\n", false, false,
                       "The source number 1 belongs to two records"},
        identifiercase{"NoSourceNumberLeft", "0 @I1@ INDI\r\n0 @S2147483647@ SOUR\r\n", true, false,
                       "The family file has no record number left for a new source"},
        identifiercase{"NoNoteNumberLeft", "0 @I1@ INDI\r\n0 @S1@ SOUR\r\n0 @N2147483647@ NOTE\r\n", false, true,
                       "The family file has no record number left for a new note"},
        identifiercase{"AllWell", "0 @I1@ INDI\r\n0 @S1@ SOUR\r\n0 @N7@ NOTE\r\n", false, true, ""}),
    [](const auto& info) { return std::string(info.param.name); });
