// The loader: what it keeps of each record, the name rule, places, the people
// list's order, every encoding and line end, input that must do no harm, and
// the bundled sample file (users try the program on it first).
#include "model/loadgedcom.h"

#include "support/testfiles.h"

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

std::string ids(const indexlist<int32_t>& list)
{
    std::string s;
    for (int32_t id : list)
        s += (s.empty() ? "" : ",") + std::to_string(id);
    return s;
}

// What the loader kept of an individual, in one line to be compared whole:
// the parts it has, in a fixed order.
std::string describe(const personrec& p)
{
    std::string s = std::to_string(p.id) + " " + sv(p.name);
    if (p.hasbirthdate)
        s += " born " + sv(p.birthdate);
    if (p.hasbirthplace)
        s += " at " + sv(p.birthplace);
    if (p.hasdeathdate)
        s += " died " + sv(p.deathdate);
    if (!p.sex.empty())
        s += " sex " + sv(p.sex);
    if (p.famc)
        s += " famc " + std::to_string(p.famc);
    if (!p.fams.empty())
        s += " fams " + ids(p.fams);
    if (!p.sourceids.empty())
        s += " cites " + ids(p.sourceids);
    if (!p.flagids.empty())
        s += " flags " + ids(p.flagids);
    for (const censusrec& c : p.census)
        s += " | CENS " + sv(c.date) + ";" + sv(c.place) + ";" + sv(c.address) + ";" + sv(c.age) + ";" + ids(c.sourceids);
    for (const residencerec& r : p.residences)
        s += " | RESI " + sv(r.date) + ";" + sv(r.place);
    return s;
}

std::vector<std::string> describeall(const gedcomindex& ix)
{
    std::vector<std::string> out;
    for (const personrec& p : ix.people)
        out.push_back(describe(p));
    return out;
}

using strings = std::vector<std::string>;

} // namespace

TEST(LoadGedcom, RecordNumbersAndNextSource)
{
    auto ix = load(ged("0 @I12@ INDI\n0 @S7@ SOUR\n0 @S3@ SOUR\n0 @O9@ OBJE\n0 @O4@ OBJE\n0 @N5@ NOTE\n"));
    EXPECT_EQ(describeall(*ix), strings{"12 <no name>"});
    ASSERT_EQ(ix->sources.size(), 2u);
    EXPECT_EQ(ix->sources[0].id, 7);
    EXPECT_EQ((std::vector<int>{ix->nextsourceid, ix->maxobjectid, ix->maxnoteid, ix->hashead}),
              (std::vector<int>{8, 9, 5, 1}));
    auto none = load(ged("0 @I1@ INDI\n"));
    EXPECT_EQ((std::vector<int>{none->nextsourceid, none->maxobjectid, none->maxnoteid}), (std::vector<int>{1, 0, -1}));
}

TEST(LoadGedcom, NameRule)
{
    const auto nameof = [](const std::string& nameline) {
        return sv(load(ged("0 @I1@ INDI\n" + nameline + "\n"))->people.at(0).name);
    };
    // Faults of the plain rule, mended: no slash, a lone final slash, no
    // closing slash, a suffix after the surname.
    const std::pair<const char*, const char*> rows[] = {
        {"1 NAME John Henry /Smith/", "Smith, John Henry"}, {"1 NAME /Smith/", "Smith"},
        {"1 NAME  John   /Smith/", "Smith, John"},          {"1 NAME John Henry", "John Henry"},
        {"1 NAME John/", "John"},                           {"1 NAME /", "<no name>"},
        {"1 NAME John /Smith", "Smith, John"},              {"1 NAME John /Smith/ Jr", "Smith, John Jr"},
        {"1 NAME", "<no name>"},                            {"1 NAME    ", "<no name>"},
    };
    for (const auto& [line, name] : rows)
        EXPECT_EQ(nameof(line), name) << line;

    auto ix = load(ged("0 @I1@ INDI\n1 NAME Ann /First/\n1 NAME Ann /Second/\n0 @I2@ INDI\n1 SEX F\n"));
    EXPECT_EQ(describeall(*ix), (strings{"1 First, Ann", "2 <no name> sex F"}));
    EXPECT_EQ(personlabel(ix->people[1], false), QStringLiteral("<no name> (ID: 2)"));
}

TEST(LoadGedcom, BirthDeathAndLabels)
{
    auto ix = load(ged("0 @I4@ INDI\n1 NAME John /Smith/\n1 BIRT\n2 DATE 3 MAR 1851\n2 PLAC Leeds\n"
                       "1 BIRT\n2 DATE 1 JAN 1900\n1 DEAT\n2 DATE 1920\n1 SEX M\n"));
    EXPECT_EQ(describe(ix->people.at(0)), "4 Smith, John born 3 MAR 1851 at Leeds died 1920 sex M");
    EXPECT_FALSE(ix->people[0].birthedited);
    EXPECT_EQ(personlabel(ix->people[0], false), QStringLiteral("Smith, John (3 MAR 1851)"));
    EXPECT_EQ(personlabel(ix->people[0], true), QStringLiteral("Smith, John (ID: 4)"));

    // An event's details end at the next level-1 line: the DATE and PLAC after
    // another event, or after a NAME that follows the birth, are not the
    // birth's; nor is a DATE deeper down; an empty DATE ends the wait.
    ix = load(ged("0 @I1@ INDI\n1 BIRT\n2 SOUR @S1@\n3 DATE 1999\n1 CHR\n2 DATE 5 MAY 1850\n2 PLAC York\n"
                  "0 @I2@ INDI\n1 BIRT\n1 NAME A /B/\n2 DATE 1850\n0 @I3@ INDI\n1 DEAT\n0 @I4@ INDI\n2 DATE 1900\n"
                  "0 @I5@ INDI\n1 BIRT\n2 DATE\n2 DATE 1850\n"));
    EXPECT_EQ(describeall(*ix),
              (strings{"1 <no name> cites 1", "2 B, A", "3 <no name>", "4 <no name>", "5 <no name>"}));
}

TEST(LoadGedcom, SourcesTitlesAndCensusSources)
{
    auto ix = load(ged("0 @S1@ SOUR\n1 ABBR Parish register\n1 TITL 1851 Census\n"
                       "0 @S2@ SOUR\n1 TITL   1881 CENSUS of Leeds  \n1 ABBR Other\n1 OBJE @O3@\n1 OBJE @O5@\n"
                       "0 @S3@ SOUR\n1 TITL Censuses of Wales\n"
                       "0 @S4@ SOUR\n1 TITL census 1851 Eire\n0 @S5@ SOUR\n1 TITL Census 1841 Eire\n"));
    strings got;
    for (const sourcerec& s : ix->sources)
        got.push_back(sv(s.title) + (s.iscensus ? " census " : " ") + ids(s.objectids));
    EXPECT_EQ(got, (strings{"Parish register ", "1881 CENSUS of Leeds census 3,5", "Censuses of Wales census ",
                            "census 1851 Eire census ", "Census 1841 Eire census "}));
    EXPECT_EQ(ix->censussources, (std::vector<int32_t>{1, 2, 3, 4}));
    // The list of existing census sources is in the one list order, whatever
    // the locale: letter case set aside.
    strings listed;
    for (const sourceitem& item : censussourcelist(*ix))
        listed.push_back(item.title.toStdString() + " " + std::to_string(item.source));
    EXPECT_EQ(listed, (strings{"1881 CENSUS of Leeds 1", "Census 1841 Eire 4", "census 1851 Eire 3",
                               "Censuses of Wales 2"}));
}

TEST(LoadGedcom, CensusEventsResidencesAndCitations)
{
    // A residence's citations are the record's, not a census event's.
    auto ix = load(ged("0 @I1@ INDI\n1 NAME A /B/\n2 SOUR @S9@\n1 CENS\n2 DATE 30 MAR 1851\n2 DATE 31 MAR 1851\n"
                       "2 PLAC Leeds, Yorkshire\n2 ADDR 1 High St\n2 AGE 27\n2 SOUR @S4@\n3 PAGE 1\n2 SOUR @S5@\n"
                       "1 OCCU Weaver\n2 SOUR @S6@\n1 CENS\n2 DATE\n2 AGE\n1 CENS Y\n2 SOUR @S7@\n"
                       "0 @I2@ INDI\n1 RESI\n2 DATE 3 APR 1881\n2 PLAC Leeds\n2 SOUR @S4@\n1 CENS\n2 DATE 1891\n"
                       "1 RESI\n2 ADDR 1 High St\n1 BIRT\n2 DATE 1850\n1 RESI\n2 DATE FROM 1885 TO 1905\n"));
    EXPECT_EQ(describeall(*ix),
              (strings{"1 B, A cites 9,4,5,6,7 | CENS 31 MAR 1851;Leeds, Yorkshire;1 High St;27;4,5 | CENS ;;;; "
                       "| CENS ;;;;7",
                       "2 <no name> born 1850 cites 4 | CENS 1891;;;; | RESI 3 APR 1881;Leeds | RESI ; "
                       "| RESI FROM 1885 TO 1905;"}));
    EXPECT_EQ(ix->people[0].citecount(), 5);
    EXPECT_EQ(ix->censusevents, 4);
}

TEST(LoadGedcom, FamiliesFlagsAndObjects)
{
    flagtable defs;
    defs.push_back({"__C1881", "Census 1881", "3 APR 1881", 0, "UK"});
    auto ix = load(ged("0 @I1@ INDI\n1 FAMC @F2@\n1 FAMC @F3@\n1 FAMS @F10@\n1 FAMS @F11@\n1 FAMS @F12@\n"
                       "1 FAMS @F13@\n1 _FLGS\n2 __C1891 Census 1891 \n2 __C1881 Census 1881\n2 __NONAME\n"
                       "2 SOUR @S1@\n0 @I2@ INDI\n1 _FLGS\n2 __C1891 Census 1891\n1 CENS\n2 __C1881 x\n"
                       "0 @O2@ OBJE\n1 FORM jpg\n1 TITL Page 1\n1 _FILE C:\\a.jpg\n1 _DATE 1 JAN 2000\n"
                       "1 TITL Page 2\n2 _ASID 3\n2 _ASID 12\n2 _ASID x\n0 @O1@ OBJE\n"),
                   defs);
    EXPECT_EQ(describeall(*ix),
              (strings{"1 <no name> famc 3 fams 10,11,12,13 cites 1 flags 1,0", "2 <no name> flags 1 | CENS ;;;;"}));
    ASSERT_EQ(ix->flags.size(), 2u);
    EXPECT_TRUE(ix->flags[1].code == "__C1891" && ix->flags[1].name == "Census 1891") << ix->flags[1].code;
    EXPECT_EQ(std::make_pair(ix->flags[0].count, ix->flags[1].count), std::make_pair(1, 2));

    ASSERT_EQ(ix->objects.size(), 2u);
    const objectrec& o = ix->objects[0];
    EXPECT_EQ(sv(o.form) + '|' + sv(o.title) + '|' + sv(o.file) + '|' + sv(o.date), "jpg|Page 2|C:\\a.jpg|1 JAN 2000");
    EXPECT_EQ(std::make_tuple(o.maxasid, ix->objects[1].maxasid, ix->maxobjectid), std::make_tuple(12, 0, 2));
}

TEST(LoadGedcom, PlacesGroupIgnoringCaseAndNonAsciiLetters)
{
    // "Zürich" and "ZÜRICH" in a Windows-1252 file are one group.
    auto ix = load(ged("0 @I1@ INDI\n1 BIRT\n2 PLAC Leeds\n1 RESI\n2 PLAC  leeds \n0 @F1@ FAM\n1 MARR\n2 PLAC York\n"
                       "0 @S1@ SOUR\n2 PLAC bath\n2 PLAC    \n3 PLAC Hull\n2 PLACE Nowhere\n"
                       "0 @I2@ INDI\n1 BIRT\n2 PLAC Z\xFCrich\n1 DEAT\n2 PLAC Z\xDCRICH\n"));
    const auto places = [&] {
        strings out;
        for (const placerec& p : ix->places)
            out.push_back(sv(p.name) + " " + std::to_string(p.count));
        return out;
    };
    EXPECT_EQ(places(), (strings{"bath 1", "Leeds 2", "York 1", "Z\xC3\xBCrich 2"}));
    EXPECT_EQ(findplace(*ix, "LEEDS"), 1);
    EXPECT_EQ(findplace(*ix, "z\xC3\xBCRICH"), 3);
    EXPECT_EQ(findplace(*ix, "Hull"), -1);

    for (const char* typed : {"HULL", "york", ""})
        insertplace(*ix, typed);
    EXPECT_EQ(places(), (strings{"bath 1", "HULL 1", "Leeds 2", "York 2", "Z\xC3\xBCrich 2"}));
    EXPECT_EQ(findplace(*ix, "hull"), 1);
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
    const std::string name = "M\xC3\xBCller, Ren\xC3\xA9";
    auto ansi = load("0 HEAD\n1 CHAR ANSI\n0 @I1@ INDI\n1 NAME Ren\xE9 /M\xFCller/\n1 BIRT\n2 PLAC K\xF6ln\n");
    EXPECT_EQ(ansi->encoding, textencoding::windows1252);
    EXPECT_EQ(describe(ansi->people.at(0)), "1 " + name + " at K\xC3\xB6ln");

    auto utf8 = load("\xEF\xBB\xBF" "0 HEAD\n1 CHAR UTF-8\n0 @I1@ INDI\n1 NAME Ren\xC3\xA9 /M\xC3\xBCller/\n");
    EXPECT_TRUE(utf8->encoding == textencoding::utf8 && utf8->bom);
    EXPECT_EQ(describeall(*utf8), strings{"1 " + name});

    // UTF-16 both ways round, with and without a byte-order mark.
    const QString text = QStringLiteral("0 HEAD\r\n1 CHAR UNICODE\r\n0 @I7@ INDI\r\n1 NAME Ren\u00E9 /M\u00FCller/\r\n");
    for (bool le : {true, false}) {
        for (bool bom : {true, false}) {
            SCOPED_TRACE(std::string(le ? "LE" : "BE") + (bom ? " BOM" : ""));
            std::string bytes = !bom ? "" : le ? "\xFF\xFE" : "\xFE\xFF";
            for (QChar c : text) {
                const char lo = static_cast<char>(c.unicode() & 0xFF), hi = static_cast<char>(c.unicode() >> 8);
                bytes += le ? std::string{lo, hi} : std::string{hi, lo};
            }
            auto ix = load(bytes);
            EXPECT_TRUE(isutf16(ix->encoding));
            EXPECT_EQ(describeall(*ix), strings{"7 " + name});
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
        SCOPED_TRACE(eol == "\r" ? "CR" : eol == "\n" ? "LF" : eol == "\r\n" ? "CRLF" : "LFCR");
        EXPECT_EQ(describeall(*load(text)), (strings{"1 B, A born 1850", "2 <no name> sex F"})); // no end after the last
    }
    EXPECT_EQ(load("0 HEAD\r\n0 @I1@ INDI\n1 SEX M\r0 @I2@ INDI\n\r0 @I3@ INDI\r\n\r\n\n0 @I4@ INDI")->people.size(), 4u);
}

TEST(LoadGedcom, BadInputLoadsWithoutHarm)
{
    // Identifiers without a closing "@", or not numbers, or too big.
    auto ix = load(ged("0 @I12 INDI\n0 @IX1@ INDI\n0 @I99999999999@ INDI\n0 @I\n0 @\n0\n1\n2 \n0 @I5@ INDI\n"
                       "1 FAMC @\n1 FAMS @F\n2 SOUR @S\n1 CENS\n2 SOUR @Sabc@\n"));
    EXPECT_EQ(describeall(*ix), (strings{"12 <no name>", "0 <no name>", "0 <no name>", "0 <no name>",
                                         "5 <no name> fams 0 cites 0,0 | CENS ;;;;0"}));

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
    EXPECT_EQ(std::make_tuple(p.flagids.size(), p.fams.size(), p.fams.back(), ix->flags.at(0).count),
              std::make_tuple(size_t(40000), size_t(40000), 39999, 13334));
    EXPECT_EQ(std::make_pair(p.citecount(), p.census.at(1).citecount()), std::make_pair(40000, 40000));
    EXPECT_EQ(ix->people.back().id, 40001);
    EXPECT_FALSE(peoplelistshown(*ix));
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
        EXPECT_TRUE(i == 0 || placekey(ix->places[i - 1].name) < placekey(ix->places[i].name)) << i;
    }
    EXPECT_EQ(describeall(*ix), strings{"1 <no name> fams 1 cites 3 | CENS ;place 7;;;3"});
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
}

// The bundled sample: a CR LF, UTF-8 Family Historian file with the
// households its README promises, the 1881 one left for the user to enter.
TEST(SampleFile, LoadsTheFamiliesItDescribes)
{
    const std::string bytes = qmtest::readfile(qmtest::samplefile());
    EXPECT_EQ(bytes.rfind("0 HEAD\r\n1 SOUR FAMILY_HISTORIAN\r\n", 0), 0u);
    EXPECT_NE(bytes.find("\r\n1 CHAR UTF-8\r\n"), std::string::npos);
    EXPECT_TRUE(bytes.ends_with("\r\n0 TRLR\r\n"));
    int64_t crlf = 0;
    for (size_t at = 0; (at = bytes.find("\r\n", at)) != std::string::npos; at += 2)
        ++crlf;
    EXPECT_GT(crlf, 1000);
    EXPECT_EQ(std::count(bytes.begin(), bytes.end(), '\n'), crlf) << "no bare LF";

    const loadresult r = loadgedcom(qmtest::samplefile(), flagtable{});
    ASSERT_TRUE(r.index) << r.error.toStdString();
    const gedcomindex& ix = *r.index;
    EXPECT_EQ(ix.encoding, textencoding::utf8);
    EXPECT_EQ((std::vector<size_t>{ix.people.size(), ix.sources.size(), ix.censussources.size(), ix.objects.size()}),
              (std::vector<size_t>{40, 11, 9, 2}));
    EXPECT_EQ((std::vector<int>{ix.maxobjectid, ix.maxnoteid, ix.nextsourceid}), (std::vector<int>{2, 1, 12}));
    const auto person = [&](int32_t id) {
        const auto at = std::find_if(ix.people.begin(), ix.people.end(), [&](const personrec& p) { return p.id == id; });
        return at == ix.people.end() ? std::string() : describe(*at);
    };
    EXPECT_EQ(person(21), "21 Durand, \xc3\x89mile born ABT 1835 at Rouen, Seine-Inf\xc3\xa9rieure, France died 11 DEC 1895 "
                          "sex M fams 5 cites 6 | CENS 2 APR 1871;Halifax, Yorkshire, England;14 Clare Road;36;6");
    EXPECT_EQ(person(29), "29 Ashworth, Frederick born 14 FEB 1881 at Hebden Bridge, Yorkshire, England sex M famc 7 "
                          "cites 10,8 flags 1 | CENS 5 APR 1891;Hebden Bridge, Yorkshire, England;27 Hangingroyd Lane;10;8");
    const std::string john = person(3);
    EXPECT_TRUE(john.starts_with("3 Ashworth, John born 3 JAN 1831 at Heptonstall, Yorkshire, England sex M famc 1 fams 3 "
                                 "cites 9,9,1,2,2,3,5,7,7 flags 0 | CENS"))
        << john;
    EXPECT_EQ(std::count(john.begin(), john.end(), '|'), 5) << "five census events";
    EXPECT_EQ(ix.flags.at(0).code, "__CENSUS_1881");
    for (int32_t id : {11, 27, 28, 29}) // the 1881 household, left for the user to enter
        EXPECT_TRUE(!person(id).empty() && person(id).find("CENS 3 APR 1881") == std::string::npos) << id;
    strings sources;
    for (const sourcerec& s : ix.sources)
        if (s.id >= 8 && s.id <= 10)
            sources.push_back(std::to_string(s.id) + (s.iscensus ? " census " : " ") + ids(s.objectids));
    EXPECT_EQ(sources, (strings{"8 census 1", "9 ", "10 "}));
    EXPECT_EQ(ix.objects[0].maxasid, 1);
    EXPECT_EQ(ix.objects[0].date, "5 APR 1891");
}
