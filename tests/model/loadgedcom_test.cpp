#include "model/loadgedcom.h"

#include "support/testfiles.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QTemporaryDir>

#include <gtest/gtest.h>

using namespace qm;

namespace {

std::unique_ptr<gedcomindex> load(const std::string& text, const flagtable& defs = {})
{
    return loadgedcombytes(text, defs);
}

// A header and the given records, with LF line ends.
std::string ged(const std::string& records)
{
    return "0 HEAD\n1 CHAR ANSI\n" + records + "0 TRLR\n";
}

std::string sv(std::string_view v)
{
    return std::string(v);
}

// A census event's fields as "date|place|address|age".
std::string fields(const censusrec& c)
{
    return sv(c.date) + '|' + sv(c.place) + '|' + sv(c.address) + '|' + sv(c.age);
}

} // namespace

TEST(LoadGedcom, RecordNumbersAndNextSource)
{
    auto ix = load(ged("0 @I12@ INDI\n0 @S7@ SOUR\n0 @S3@ SOUR\n0 @O9@ OBJE\n0 @O4@ OBJE\n0 @N5@ NOTE\n"));
    ASSERT_EQ(ix->people.size(), 1u);
    EXPECT_EQ(ix->people[0].id, 12);
    ASSERT_EQ(ix->sources.size(), 2u);
    EXPECT_EQ(ix->sources[0].id, 7);
    EXPECT_EQ(ix->nextsourceid, 8);
    EXPECT_EQ(ix->maxobjectid, 9);
    EXPECT_EQ(ix->maxnoteid, 5);
    EXPECT_TRUE(ix->hashead);

    auto none = load(ged("0 @I1@ INDI\n"));
    EXPECT_EQ(none->nextsourceid, 1);
    EXPECT_EQ(none->maxobjectid, 0);
    EXPECT_EQ(none->maxnoteid, -1);
}

TEST(LoadGedcom, NameRule)
{
    const auto nameof = [](const std::string& nameline) {
        auto ix = load(ged("0 @I1@ INDI\n" + nameline + "\n"));
        return sv(ix->people.at(0).name);
    };
    EXPECT_EQ(nameof("1 NAME John Henry /Smith/"), "Smith, John Henry");
    EXPECT_EQ(nameof("1 NAME /Smith/"), "Smith");
    EXPECT_EQ(nameof("1 NAME  John   /Smith/"), "Smith, John");
    // Faults of the plain rule, mended: no slash, a lone final slash, no
    // closing slash, a suffix after the surname.
    EXPECT_EQ(nameof("1 NAME John Henry"), "John Henry");
    EXPECT_EQ(nameof("1 NAME John/"), "John");
    EXPECT_EQ(nameof("1 NAME /"), "<no name>");
    EXPECT_EQ(nameof("1 NAME John /Smith"), "Smith, John");
    EXPECT_EQ(nameof("1 NAME John /Smith/ Jr"), "Smith, John Jr");
    EXPECT_EQ(nameof("1 NAME"), "<no name>");
    EXPECT_EQ(nameof("1 NAME    "), "<no name>");

    auto ix = load(ged("0 @I1@ INDI\n1 NAME Ann /First/\n1 NAME Ann /Second/\n0 @I2@ INDI\n1 SEX F\n"));
    EXPECT_EQ(sv(ix->people[0].name), "First, Ann");
    EXPECT_EQ(sv(ix->people[1].name), "<no name>");
    EXPECT_EQ(personlabel(ix->people[1], false), QStringLiteral("<no name> (ID: 2)"));
}

TEST(LoadGedcom, LabelsWithBirthDateOrId)
{
    auto ix = load(ged("0 @I4@ INDI\n1 NAME John /Smith/\n1 BIRT\n2 DATE 3 MAR 1851\n2 PLAC Leeds\n"
                       "1 BIRT\n2 DATE 1 JAN 1900\n1 DEAT\n2 DATE 1920\n1 SEX M\n"));
    const personrec& p = ix->people.at(0);
    EXPECT_TRUE(p.hasbirthdate && p.hasbirthplace && p.hasdeathdate && !p.birthedited);
    EXPECT_EQ(sv(p.birthdate) + '|' + sv(p.birthplace) + '|' + sv(p.deathdate) + '|' + sv(p.sex), "3 MAR 1851|Leeds|1920|M");
    EXPECT_EQ(personlabel(p, false), QStringLiteral("Smith, John (3 MAR 1851)"));
    EXPECT_EQ(personlabel(p, true), QStringLiteral("Smith, John (ID: 4)"));
}

TEST(LoadGedcom, EventDetailsEndAtTheNextLevelOneLine)
{
    // The DATE and PLAC after another event, or after a NAME that follows the
    // birth, are not the birth's; nor is a DATE deeper down.
    auto ix = load(ged("0 @I1@ INDI\n1 BIRT\n2 SOUR @S1@\n3 DATE 1999\n1 CHR\n2 DATE 5 MAY 1850\n2 PLAC York\n"
                       "0 @I2@ INDI\n1 BIRT\n1 NAME A /B/\n2 DATE 1850\n"
                       "0 @I3@ INDI\n1 DEAT\n0 @I4@ INDI\n2 DATE 1900\n"));
    EXPECT_FALSE(ix->people[0].hasbirthdate);
    EXPECT_FALSE(ix->people[0].hasbirthplace);
    EXPECT_FALSE(ix->people[1].hasbirthdate);
    EXPECT_FALSE(ix->people[3].hasdeathdate);
    // A birth DATE line with no value ends the wait for a date.
    auto e = load(ged("0 @I1@ INDI\n1 BIRT\n2 DATE\n2 DATE 1850\n"));
    EXPECT_FALSE(e->people[0].hasbirthdate);
}

TEST(LoadGedcom, SourcesTitlesAndCensusSources)
{
    auto ix = load(ged("0 @S1@ SOUR\n1 ABBR Parish register\n1 TITL 1851 Census\n"
                       "0 @S2@ SOUR\n1 TITL   1881 CENSUS of Leeds  \n1 ABBR Other\n1 OBJE @O3@\n1 OBJE @O5@\n"
                       "0 @S3@ SOUR\n1 TITL Censuses of Wales\n"));
    ASSERT_EQ(ix->sources.size(), 3u);
    EXPECT_EQ(sv(ix->sources[0].title), "Parish register");
    EXPECT_FALSE(ix->sources[0].iscensus);
    EXPECT_EQ(sv(ix->sources[1].title), "1881 CENSUS of Leeds");
    EXPECT_TRUE(ix->sources[1].iscensus);
    EXPECT_EQ(ix->sources[1].objectids, (std::vector<int32_t>{3, 5}));
    EXPECT_TRUE(ix->sources[2].iscensus);
    EXPECT_EQ(ix->censussources, (std::vector<int32_t>{1, 2}));
    const auto items = censussourcelist(*ix);
    ASSERT_EQ(items.size(), 2u);
    EXPECT_EQ(items[0].title, QStringLiteral("1881 CENSUS of Leeds"));
    EXPECT_EQ(items[0].source, 1);
}

TEST(LoadGedcom, CensusEventsAndCitations)
{
    auto ix = load(ged("0 @I1@ INDI\n1 NAME A /B/\n2 SOUR @S9@\n1 CENS\n2 DATE 30 MAR 1851\n2 DATE 31 MAR 1851\n"
                       "2 PLAC Leeds, Yorkshire\n2 ADDR 1 High St\n2 AGE 27\n2 SOUR @S4@\n3 PAGE 1\n2 SOUR @S5@\n"
                       "1 OCCU Weaver\n2 SOUR @S6@\n1 CENS\n2 DATE\n2 AGE\n1 CENS Y\n2 SOUR @S7@\n"));
    const personrec& p = ix->people.at(0);
    EXPECT_EQ(p.sourceids, (std::vector<int32_t>{9, 4, 5, 6, 7}));
    EXPECT_EQ(p.citecount(), 5);
    ASSERT_EQ(p.census.size(), 3u);
    EXPECT_EQ(fields(p.census[0]), "31 MAR 1851|Leeds, Yorkshire|1 High St|27");
    EXPECT_EQ(p.census[0].sourceids, (std::vector<int32_t>{4, 5}));
    EXPECT_EQ(fields(p.census[1]), "|||");
    EXPECT_TRUE(p.census[1].sourceids.empty());
    EXPECT_EQ(p.census[2].sourceids, (std::vector<int32_t>{7}));
    EXPECT_EQ(ix->censusevents, 3);
}

TEST(LoadGedcom, ResidenceFacts)
{
    // Their date and place; a residence's citations are the record's, not a census event's.
    auto ix = load(ged("0 @I1@ INDI\n1 RESI\n2 DATE 3 APR 1881\n2 PLAC Leeds\n2 SOUR @S4@\n1 CENS\n2 DATE 1891\n"
                       "1 RESI\n2 ADDR 1 High St\n1 BIRT\n2 DATE 1850\n1 RESI\n2 DATE FROM 1885 TO 1905\n"));
    const personrec& p = ix->people.at(0);
    ASSERT_EQ(p.residences.size(), 3u);
    EXPECT_EQ(sv(p.residences[0].date), "3 APR 1881");
    EXPECT_EQ(sv(p.residences[0].place), "Leeds");
    EXPECT_TRUE(p.residences[1].date.empty() && p.residences[1].place.empty());
    EXPECT_EQ(sv(p.residences[2].date), "FROM 1885 TO 1905");
    EXPECT_EQ(sv(p.birthdate), "1850");
    ASSERT_EQ(p.census.size(), 1u);
    EXPECT_EQ(sv(p.census[0].date), "1891");
    EXPECT_TRUE(p.census[0].sourceids.empty());
    EXPECT_EQ(p.sourceids, (std::vector<int32_t>{4}));
}

TEST(LoadGedcom, FamiliesAndFlags)
{
    flagtable defs;
    defs.push_back({"__C1881", "Census 1881", "3 APR 1881", 0, "UK"});
    auto ix = load(ged("0 @I1@ INDI\n1 FAMC @F2@\n1 FAMC @F3@\n1 FAMS @F10@\n1 FAMS @F11@\n1 FAMS @F12@\n"
                       "1 FAMS @F13@\n1 _FLGS\n2 __C1891 Census 1891 \n2 __C1881 Census 1881\n2 __NONAME\n"
                       "2 SOUR @S1@\n"
                       "0 @I2@ INDI\n1 _FLGS\n2 __C1891 Census 1891\n1 CENS\n2 __C1881 x\n"),
                   defs);
    const personrec& p = ix->people.at(0);
    EXPECT_EQ(p.famc, 3);
    EXPECT_EQ(p.fams, (std::vector<int32_t>{10, 11, 12, 13}));
    ASSERT_EQ(ix->flags.size(), 2u);
    EXPECT_TRUE(ix->flags[1].code == "__C1891" && ix->flags[1].name == "Census 1891") << ix->flags[1].code;
    EXPECT_EQ(std::make_pair(ix->flags[0].count, ix->flags[1].count), std::make_pair(1, 2));
    EXPECT_EQ(p.flagids, (std::vector<int32_t>{1, 0}));
    EXPECT_EQ(ix->people[1].flagids, (std::vector<int32_t>{1}));
}

TEST(LoadGedcom, ObjectRecords)
{
    auto ix = load(ged("0 @O2@ OBJE\n1 FORM jpg\n1 TITL Page 1\n1 _FILE C:\\a.jpg\n1 _DATE 1 JAN 2000\n"
                       "1 TITL Page 2\n2 _ASID 3\n2 _ASID 12\n2 _ASID x\n0 @O1@ OBJE\n"));
    ASSERT_EQ(ix->objects.size(), 2u);
    const objectrec& o = ix->objects[0];
    EXPECT_EQ(sv(o.form) + '|' + sv(o.title) + '|' + sv(o.file) + '|' + sv(o.date), "jpg|Page 2|C:\\a.jpg|1 JAN 2000");
    EXPECT_EQ(o.maxasid, 12);
    EXPECT_EQ(ix->objects[1].maxasid, 0);
    EXPECT_EQ(ix->maxobjectid, 2);
}

TEST(LoadGedcom, PlacesGroupIgnoringCase)
{
    auto ix = load(ged("0 @I1@ INDI\n1 BIRT\n2 PLAC Leeds\n1 RESI\n2 PLAC  leeds \n0 @F1@ FAM\n1 MARR\n2 PLAC York\n"
                       "0 @S1@ SOUR\n2 PLAC bath\n2 PLAC    \n3 PLAC Hull\n2 PLACE Nowhere\n"));
    ASSERT_EQ(ix->places.size(), 3u);
    EXPECT_EQ(sv(ix->places[0].name), "bath");
    EXPECT_EQ(sv(ix->places[1].name), "Leeds");
    EXPECT_EQ(ix->places[1].count, 2);
    EXPECT_EQ(sv(ix->places[2].name), "York");
    EXPECT_EQ(findplace(*ix, "LEEDS"), 1);
    EXPECT_EQ(findplace(*ix, "Hull"), -1);

    insertplace(*ix, "HULL");
    insertplace(*ix, "york");
    insertplace(*ix, "");
    ASSERT_EQ(ix->places.size(), 4u);
    EXPECT_EQ(sv(ix->places[1].name), "HULL");
    EXPECT_EQ(ix->places[3].count, 2);
    EXPECT_EQ(findplace(*ix, "hull"), 1);
}

TEST(LoadGedcom, PlacesFoldNonAsciiLetters)
{
    // "Zürich" and "ZÜRICH" in a Windows-1252 file are one group.
    auto ix = load(ged("0 @I1@ INDI\n1 BIRT\n2 PLAC Z\xFCrich\n1 DEAT\n2 PLAC Z\xDCRICH\n1 BURI\n2 PLAC Aachen\n"));
    ASSERT_EQ(ix->places.size(), 2u);
    EXPECT_EQ(sv(ix->places[1].name), "Z\xC3\xBCrich");
    EXPECT_EQ(ix->places[1].count, 2);
    EXPECT_EQ(findplace(*ix, "z\xC3\xBCRICH"), 1);
}

TEST(LoadGedcom, PeopleListOrderAndLimit)
{
    auto ix = load(ged("0 @I1@ INDI\n1 NAME Zoe /smith/\n0 @I2@ INDI\n1 NAME Al /Brown/\n"
                       "0 @I3@ INDI\n1 NAME Ann /SMITH/\n0 @I4@ INDI\n1 NAME ann /smith/\n0 @I5@ INDI\n1 NAME /brown/\n"));
    EXPECT_EQ(sortedpeople(*ix, true), (std::vector<int32_t>{4, 1, 2, 3, 0}));
    // Accented names sort among their plain letters (the record number then decides).
    auto accents = load(ged("0 @I1@ INDI\n1 NAME Louise /Durand/\n0 @I2@ INDI\n1 NAME \xC3\x89mile /Durand/\n"
                            "0 @I3@ INDI\n1 NAME Emile /Durand/\n0 @I4@ INDI\n1 NAME Zo\xC3\xAB /Ashworth/\n"
                            "0 @I5@ INDI\n1 NAME Zoe /Ashworth/\n"));
    EXPECT_EQ(sortedpeople(*accents, true), (std::vector<int32_t>{3, 4, 1, 2, 0}));

    gedcomindex big;
    big.people.resize(32000);
    EXPECT_TRUE(peoplelistshown(big));
    big.people.resize(32001);
    EXPECT_FALSE(peoplelistshown(big));
    EXPECT_TRUE(nopeoplemessage().startsWith(QStringLiteral("There are no individuals recorded in the selected file.")));
}

TEST(LoadGedcom, Encodings)
{
    const std::string body = "0 @I1@ INDI\n1 NAME Ren\xE9 /M\xFCller/\n1 BIRT\n2 PLAC K\xF6ln\n";
    auto ansi = load("0 HEAD\n1 CHAR ANSI\n" + body);
    EXPECT_EQ(ansi->encoding, textencoding::windows1252);
    EXPECT_EQ(sv(ansi->people[0].name), "M\xC3\xBCller, Ren\xC3\xA9");
    EXPECT_EQ(sv(ansi->people[0].birthplace), "K\xC3\xB6ln");

    auto utf8 = load("\xEF\xBB\xBF" "0 HEAD\n1 CHAR UTF-8\n0 @I1@ INDI\n1 NAME Ren\xC3\xA9 /M\xC3\xBCller/\n");
    EXPECT_EQ(utf8->encoding, textencoding::utf8);
    EXPECT_TRUE(utf8->bom);
    EXPECT_EQ(sv(utf8->people[0].name), "M\xC3\xBCller, Ren\xC3\xA9");

    // UTF-16 both ways round, with and without a byte-order mark.
    const QString text = QStringLiteral("0 HEAD\r\n1 CHAR UNICODE\r\n0 @I7@ INDI\r\n1 NAME Ren\u00E9 /M\u00FCller/\r\n");
    for (bool le : {true, false}) {
        for (bool bom : {true, false}) {
            std::string bytes;
            if (bom)
                bytes = le ? "\xFF\xFE" : "\xFE\xFF";
            for (QChar c : text) {
                const char lo = static_cast<char>(c.unicode() & 0xFF), hi = static_cast<char>(c.unicode() >> 8);
                bytes += le ? std::string{lo, hi} : std::string{hi, lo};
            }
            auto ix = load(bytes);
            SCOPED_TRACE(std::string(le ? "LE" : "BE") + (bom ? " BOM" : ""));
            EXPECT_TRUE(isutf16(ix->encoding));
            ASSERT_EQ(ix->people.size(), 1u);
            EXPECT_EQ(ix->people[0].id, 7);
            EXPECT_EQ(sv(ix->people[0].name), "M\xC3\xBCller, Ren\xC3\xA9");
        }
    }
}

TEST(LoadGedcom, LineEndsAndIndentation)
{
    const std::string records = "0 @I1@ INDI|  1 NAME A /B/|\t1 BIRT| \t 2 DATE 1850|0 @I2@ INDI|1 SEX F";
    for (const std::string eol : {"\r\n", "\n", "\r", "\n\r"}) {
        std::string text = "0 HEAD|" + records;
        for (size_t at; (at = text.find('|')) != std::string::npos;)
            text.replace(at, 1, eol);
        auto ix = load(text); // and no line end after the last line
        SCOPED_TRACE(eol == "\r" ? "CR" : eol == "\n" ? "LF" : eol == "\r\n" ? "CRLF" : "LFCR");
        ASSERT_EQ(ix->people.size(), 2u);
        EXPECT_EQ(sv(ix->people[0].name), "B, A");
        EXPECT_EQ(sv(ix->people[0].birthdate), "1850");
        EXPECT_EQ(sv(ix->people[1].sex), "F");
    }
    auto mixed = load("0 HEAD\r\n0 @I1@ INDI\n1 SEX M\r0 @I2@ INDI\n\r0 @I3@ INDI\r\n\r\n\n0 @I4@ INDI");
    EXPECT_EQ(mixed->people.size(), 4u);
}

TEST(LoadGedcom, BadInputLoadsWithoutHarm)
{
    // Identifiers without a closing "@", or not numbers, or too big.
    auto ix = load(ged("0 @I12 INDI\n0 @IX1@ INDI\n0 @I99999999999@ INDI\n0 @I\n0 @\n0\n1\n2 \n0 @I5@ INDI\n"
                       "1 FAMC @\n1 FAMS @F\n2 SOUR @S\n1 CENS\n2 SOUR @Sabc@\n"));
    ASSERT_EQ(ix->people.size(), 5u);
    EXPECT_EQ(std::vector<int32_t>({ix->people[0].id, ix->people[1].id, ix->people[2].id, ix->people[3].id}),
              (std::vector<int32_t>{12, 0, 0, 0}));
    EXPECT_EQ(ix->people[4].fams, (std::vector<int32_t>{0}));
    EXPECT_EQ(ix->people[4].census.at(0).sourceids, (std::vector<int32_t>{0}));

    // NUL bytes, an over-long line (cut, the lines after it still read),
    // a source number at the top of the range.
    auto n = load(ged("0 @I1@ INDI\n1 NAME A" + std::string(1, '\0') + "B /C/\n"));
    EXPECT_EQ(sv(n->people[0].name), std::string("C, A\0B", 6));
    auto longline = load(ged("0 @I1@ INDI\n1 NAME " + std::string(3 << 20, 'x') + "\n0 @S2147483647@ SOUR\n"
                             "0 @I2@ INDI\n"));
    EXPECT_EQ(longline->people.size(), 2u);
    EXPECT_LE(longline->people[0].name.size(), size_t(1) << 20);
    EXPECT_EQ(longline->nextsourceid, 2147483647);

    auto empty = load("");
    EXPECT_FALSE(empty->hashead);
    EXPECT_TRUE(empty->people.empty());
}

TEST(LoadGedcom, CountsPastSixteenBits)
{
    std::string recs = "0 @I1@ INDI\n1 _FLGS\n";
    for (int i = 0; i < 40000; ++i)
        recs += "2 __F" + std::to_string(i % 3) + " F\n";
    recs += "1 CENS\n";
    for (int i = 0; i < 40000; ++i)
        recs += "1 FAMS @F" + std::to_string(i) + "@\n";
    recs += "1 CENS\n";
    for (int i = 0; i < 40000; ++i)
        recs += "2 SOUR @S" + std::to_string(i) + "@\n";
    for (int i = 0; i < 40000; ++i)
        recs += "0 @I" + std::to_string(i + 2) + "@ INDI\n";
    auto ix = load(ged(recs));
    ASSERT_EQ(ix->people.size(), 40001u);
    const personrec& p = ix->people[0];
    EXPECT_EQ(p.flagids.size(), 40000u);
    EXPECT_EQ(ix->flags.at(0).count, 13334);
    EXPECT_EQ(p.fams.size(), 40000u);
    EXPECT_EQ(p.fams.back(), 39999);
    EXPECT_EQ(p.citecount(), 40000);
    EXPECT_EQ(p.census.at(1).citecount(), 40000);
    EXPECT_EQ(ix->people.back().id, 40001);
    EXPECT_FALSE(peoplelistshown(*ix));
}

TEST(LoadGedcom, FromFile)
{
    QTemporaryDir dir;
    const QString path = dir.filePath(QStringLiteral("family.ged"));
    qmtest::writefile(path, ged("0 @I1@ INDI\n"));
    const loadresult r = loadgedcom(path, {});
    ASSERT_TRUE(r.index) << r.error.toStdString();
    EXPECT_EQ(r.index->people.size(), 1u);
    EXPECT_EQ(r.index->gedcomfile, QFileInfo(path).absoluteFilePath());
    EXPECT_EQ(r.index->gedcomdate, stampof(path));
    EXPECT_TRUE(r.index->gedcomdate.exists);
    EXPECT_GE(r.ms, 0);

    // A missing file, or a folder, fails cleanly: no index, a message.
    for (const QString& bad : {dir.filePath(QStringLiteral("gone.ged")), dir.path()}) {
        const loadresult failed = loadgedcom(bad, {});
        EXPECT_TRUE(!failed.index && !failed.error.isEmpty()) << bad.toStdString();
    }
    EXPECT_EQ(r.index->people.size(), 1u); // the earlier index is untouched
}

TEST(LoadGedcom, ManyPlacesAndALastRecordWithoutTrailer)
{
    // Enough distinct names to make the place lookup grow several times, each
    // met in two spellings; the file ends inside an individual.
    std::string recs = "0 HEAD\n0 @F1@ FAM\n";
    for (int i = 0; i < 5000; ++i)
        recs += "2 PLAC Place " + std::to_string(i) + "\n2 PLAC PLACE " + std::to_string(i) + " \n";
    recs += "0 @I1@ INDI\n1 FAMS @F1@\n1 CENS\n2 PLAC place 7\n2 SOUR @S3@";
    auto ix = load(recs);
    ASSERT_EQ(ix->places.size(), 5000u);
    for (size_t i = 0; i < ix->places.size(); ++i) {
        EXPECT_TRUE(ix->places[i].name.starts_with("Place "));
        EXPECT_EQ(ix->places[i].count, ix->places[i].name == "Place 7" ? 3 : 2);
        if (i > 0) {
            EXPECT_LT(placekey(ix->places[i - 1].name), placekey(ix->places[i].name));
        }
    }
    const personrec& p = ix->people.at(0);
    EXPECT_EQ(p.fams, (std::vector<int32_t>{1}));
    ASSERT_EQ(p.census.size(), 1u);
    EXPECT_EQ(sv(p.census[0].place), "place 7");
    EXPECT_EQ(p.census[0].sourceids, (std::vector<int32_t>{3}));
}
