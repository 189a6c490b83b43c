// Placement rules and edge cases of the rewrite, checked on the lines they
// concern; flags wherever their block stands; identifiers other programs
// write; and the small formats shared by the record writers.

#include "writer/rewritefile.h"

#include "images/imagechoices.h"
#include "model/loadgedcom.h"
#include "support/savefolder.h"
#include "support/censusentries.h"
#include "writer/maketitle.h"
#include "writer/recordwriters.h"
#include "writer/rewritechecks.h"

#include <cstring>

using namespace qm;
using qmtest::censusof;
using qmtest::chosen;
using lines = std::vector<std::string>;

namespace {

lines splitcrlf(const std::string& bytes)
{
    lines out;
    size_t start = 0;
    for (size_t at; (at = bytes.find("\r\n", start)) != std::string::npos; start = at + 2)
        out.push_back(bytes.substr(start, at - start));
    return out;
}

size_t lineat(const lines& ls, const std::string& line)
{
    const auto at = std::find(ls.begin(), ls.end(), line);
    return at == ls.end() ? std::string::npos : static_cast<size_t>(at - ls.begin());
}

lines multiline(std::string_view text, std::string_view first, std::string_view cont)
{
    linewriter w(textencoding::utf8, false);
    w.openmemory();
    writemultiline(w, text, first, cont);
    return splitcrlf(w.memory());
}

// A census entry for source `sourceid` and the individuals chosen.
rewriterequest entryof(const char* sourceid, std::vector<selectionrec> chosen)
{
    rewriterequest r;
    r.entry = censusof(QString::fromLatin1(sourceid), "", "");
    r.entry.selection = std::move(chosen);
    return r;
}

struct run {
    rewriteresult result;
    lines out;
};

run rewrite(const std::string& input, const settings& s, const rewriterequest& r, const flagtable& defs = {})
{
    auto ix = loadgedcombytes(input, defs);
    std::string out;
    run x;
    x.result = rewritebytes(input, out, *ix, s, r);
    x.out = splitcrlf(out);
    return x;
}

class RewriteEdges : public ::testing::Test {
protected:
    qmtest::fixedclock clock{QDateTime(QDate(2026, 5, 4), QTime(7, 8, 9))};
    const lines stamp{"1 CHAN", "2 DATE 04 MAY 2026", "3 TIME 07:08:09"};
};

} // namespace

TEST(RecordFormats, MultiLineTextsSplitAtEveryKindOfLineBreakOneLineValuesNever)
{
    EXPECT_EQ(multiline("a\r\nb\nc\rd", "4 TEXT ", "5 CONT "), (lines{"4 TEXT a", "5 CONT b", "5 CONT c", "5 CONT d"}));
    EXPECT_EQ(multiline("one\r\n\r\nthree", "4 TEXT ", "5 CONT "), (lines{"4 TEXT one", "5 CONT ", "5 CONT three"}));
    EXPECT_EQ(multiline("note\r\n", "3 NOTE ", "4 CONT "), (lines{"3 NOTE note"}));
    EXPECT_EQ(multiline("note\n\n", "3 NOTE ", "4 CONT "), (lines{"3 NOTE note", "4 CONT "}));
    EXPECT_EQ(multiline("", "1 TEXT ", "2 CONT "), (lines{"1 TEXT "}));
    EXPECT_EQ(multiline("", "1 CONT ", "1 CONT "), lines{});
    EXPECT_EQ(multiline("  kept as typed  ", "1 NOTE ", "2 CONT "), (lines{"1 NOTE   kept as typed  "}));

    EXPECT_EQ(oneline(QStringLiteral(" Leeds\r\nYorkshire\nEngland\r ")), "Leeds Yorkshire England");
    EXPECT_EQ(censusyear(QStringLiteral("30 MAR 1851"), 0), "1851");
    EXPECT_EQ(censusyear(QStringLiteral("1851"), 0), "1851");
    EXPECT_EQ(censusyear(QStringLiteral("MAR 18511"), 1851), "1851");
}

TEST(MakeTitle, PlaceholdersBracketsAndSpaces)
{
    const QString deftemplate = QStringLiteral("Census {YEAR} {PLACE} {REF} ({OTHER})");
    const auto title = [](const QString& templ, const QString& other) {
        return maketitle(templ, QStringLiteral("1851"), QStringLiteral("30 MAR 1851"),
                         QStringLiteral("Warrington, Lancashire"), QStringLiteral("43 Knutsford Road"), other,
                         QStringLiteral("HO107/2204/151"), QStringLiteral("UK"));
    };
    const struct {
        QString templ;
        const char* other;
        const char* title;
    } cases[] = {
        {deftemplate, "John Smith", "Census 1851 Warrington, Lancashire HO107/2204/151 (John Smith)"},
        {QStringLiteral("{COUNTRY} {DATE} {ADDR}"), "", "UK 30 MAR 1851 43 Knutsford Road"},
        // An empty {OTHER} leaves no brackets but keeps the space before them.
        {deftemplate, "", "Census 1851 Warrington, Lancashire HO107/2204/151 "},
        {QStringLiteral("{year} {YEAR}"), "", "{year} 1851"}, // case counts
        // Nested empty brackets go and spaces collapse; removing brackets can
        // bring spaces together again.
        {QStringLiteral("A (({OTHER}))    B"), "", "A B"},
        {QStringLiteral("A ( ) B"), "", "A ( ) B"},
        {QStringLiteral("A () () B"), "", "A B"},
    };
    for (const auto& c : cases)
        EXPECT_EQ(title(c.templ, QString::fromLatin1(c.other)), QString::fromLatin1(c.title)) << c.templ.toStdString();

    EXPECT_EQ(maketitle(QStringLiteral("{YEAR}({OTHER})"), {}, {}, {}, {}, {}, {}, {}), QStringLiteral("{No Title}"));
    EXPECT_EQ(maketitle(QString(), {}, {}, {}, {}, {}, {}, {}), QStringLiteral("{No Title}"));
    // A value holding a later placeholder is replaced too; an earlier one stays as typed.
    EXPECT_EQ(maketitle(QStringLiteral("{PLACE}"), {}, {}, QStringLiteral("at {REF}"), {}, {}, QStringLiteral("RG9/1"), {}),
              QStringLiteral("at RG9/1"));
    EXPECT_EQ(maketitle(QStringLiteral("{REF}"), QStringLiteral("1851"), {}, {}, {}, {}, QStringLiteral("{YEAR}"), {}),
              QStringLiteral("{YEAR}"));
}

TEST_F(RewriteEdges, FirstSourceAndFirstImagesGoBeforeTheirFirstFollowers)
{
    // No source and no multimedia record yet: the new source (number 1) goes
    // before the first submitter record, the images before the first note.
    const std::string input = "0 HEAD\r\n0 @I1@ INDI\r\n1 NAME A\r\n0 @N1@ NOTE x\r\n0 @U1@ SUBM\r\n0 TRLR\r\n";
    rewriterequest r = entryof("1", {chosen(1, 0, "Someone", "40", "-")});
    r.entry.title = QStringLiteral("Census 1881 Leeds");
    r.entry.place = QStringLiteral("Leeds\r\nYorkshire");
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
    EXPECT_EQ(std::make_pair(x.result.maxobjectid, x.result.censusblocks), std::make_pair(1, 1));
}

TEST_F(RewriteEdges, TheFirstSharedNoteIsNumberOneAndTheCountersComeBack)
{
    settings s;
    s.fullentry = false;
    s.sharednote = true;
    const run x = rewrite("0 HEAD\r\n0 @I1@ INDI\r\n0 @R1@ REPO\r\n0 TRLR\r\n", s, entryof("7", {chosen(1, 0)}));
    ASSERT_TRUE(x.result.ok);
    EXPECT_EQ(x.result.maxnoteid, 1);
    EXPECT_EQ(lineat(x.out, "0 @N1@ NOTE Census 1881 ") + 6, lineat(x.out, "0 @R1@ REPO"));
    EXPECT_NE(lineat(x.out, "3 NOTE @N1@"), std::string::npos);
    EXPECT_EQ((std::vector<int>{newnotenumber(-1), newnotenumber(0), newnotenumber(12)}), (std::vector<int>{1, 1, 13}));
}

TEST_F(RewriteEdges, IndentedLinesAreRecognisedAndKept)
{
    const run x = rewrite("0 HEAD\r\n  0 @I1@ INDI\r\n\t1 NAME A\r\n  1 CHAN\r\n    2 DATE 1 JAN 2000\r\n  0 TRLR\r\n",
                          settings{}, entryof("1", {chosen(1, 0)}));
    ASSERT_TRUE(x.result.ok);
    EXPECT_EQ(lines(x.out.begin(), x.out.begin() + 4), (lines{"0 HEAD", "  0 @I1@ INDI", "\t1 NAME A", "1 CENS"}));
    EXPECT_EQ(lineat(x.out, "    2 DATE 1 JAN 2000"), std::string::npos);
    EXPECT_EQ(x.out.back(), "  0 TRLR");
}

TEST_F(RewriteEdges, WhatCannotBeFoundStopsTheRunWithTheFileUntouched)
{
    const std::string input = "0 HEAD\r\n0 @I1@ INDI\r\n0 @S1@ SOUR\r\n0 TRLR\r\n";
    run x = rewrite(input, settings{}, entryof("2", {chosen(1, 0), chosen(9, -1)}));
    EXPECT_TRUE(!x.result.ok && x.result.refused);
    EXPECT_TRUE(x.result.message.contains(QStringLiteral("Someone (9)"))) << x.result.message.toStdString();
    EXPECT_TRUE(x.out.empty());

    rewriterequest a;
    a.mode = rewritemode::attachimages;
    a.entry.sourceid = QStringLiteral("5");
    a.entry.title = QStringLiteral("Census 1881");
    a.entry.chosenimages = {imagechoice{}};
    a.entry.chosenimages[0].objectid = 3;
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
    const rewriterequest r = entryof("1", {chosen(1, 0), chosen(2, 1)});
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

    // A flag name the file cannot hold is refused.
    rewriterequest names;
    names.mode = rewritemode::flagchanges;
    names.flagchanges = {{0, 0, true}};
    x = rewrite("0 HEAD\r\n1 CHAR ANSI\r\n0 @I1@ INDI\r\n0 TRLR\r\n", settings{}, names,
                {{"__SPIS_1881", "Spis ludno\xC5\x9B\x63i", "1881", 0, "UK"}});
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
    const auto join = [](std::initializer_list<lines> parts) {
        lines out;
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
    x = rewrite("0 HEAD\r\n0 @I1@ INDI\r\n" + chan + "1 _FLGS\r\n2 __C1891 Census 1891\r\n0 TRLR\r\n", s,
                entryof("1", {chosen(1, 0)}), defs);
    ASSERT_TRUE(x.result.ok);
    EXPECT_EQ(x.result.flaggiven, 1);
    const size_t header = lineat(x.out, "1 _FLGS");
    ASSERT_LE(header + 6, x.out.size());
    EXPECT_LT(lineat(x.out, "1 CENS"), header);
    EXPECT_EQ(lines(x.out.begin() + header, x.out.begin() + header + 6),
              join({{"1 _FLGS", "2 __C1881 Census 1881", "2 __C1891 Census 1891"}, stamp}));
}

// Identifiers other programs write: records are cited as they are named.
TEST_F(RewriteEdges, RecordsAreCitedByTheirOwnIdentifiers)
{
    const std::string input = "0 HEAD\r\n0 @I1@ INDI\r\n1 NAME Ann /Lee/\r\n0 @S0001@ SOUR\r\n1 TITL Census 1881\r\n"
                              "0 @O0003@ OBJE\r\n1 FILE p.jpg\r\n0 TRLR\r\n";
    const auto ix = loadgedcombytes(input, {});
    settings s;
    s.fullentry = false;
    rewriterequest r = entryof("1", {chosen(1, 0, "Lee, Ann", "30")});
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

// An identifier that cannot tell records apart, or a number that is not left,
// refuses the change before anything is written.
TEST(RewriteIdentifiers, ThatCannotServeAreRefused)
{
    const struct {
        const char* records;
        bool fullentry, sharednote;
        const char* refusal; // the start of the message, "" when none
    } rows[] = {
        {"0 @I1@ INDI\r\n0 @I01@ INDI\r\n0 @S1@ SOUR\r\n", true, false,
         "The record number 1 of Lee, Ann belongs to two records"},
        {"0 @I1@ INDI\r\n0 @S1@ SOUR\r\n0 @S1@ SOUR\r\n", false, false, "The source number 1 belongs to two records"},
        {"0 @I1@ INDI\r\n0 @S2147483647@ SOUR\r\n", true, false,
         "The family file has no record number left for a new source"},
        {"0 @I1@ INDI\r\n0 @S1@ SOUR\r\n0 @N2147483647@ NOTE\r\n", false, true,
         "The family file has no record number left for a new note"},
        {"0 @I1@ INDI\r\n0 @S1@ SOUR\r\n0 @N7@ NOTE\r\n", false, true, ""},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.records);
        const auto ix = loadgedcombytes(std::string("0 HEAD\r\n") + row.records + "0 TRLR\r\n", {});
        settings s;
        s.fullentry = row.fullentry;
        s.sharednote = row.sharednote;
        const std::string source = row.fullentry ? std::to_string(ix->nextsourceid) : "1";
        const QString refusal = checkidentifiers(*ix, s, entryof(source.c_str(), {chosen(1, 0, "Lee, Ann", "30")}));
        EXPECT_EQ(refusal.left(static_cast<qsizetype>(std::strlen(row.refusal))), QString::fromUtf8(row.refusal));
        EXPECT_EQ(refusal.isEmpty(), *row.refusal == 0) << refusal.toStdString();
    }
}
