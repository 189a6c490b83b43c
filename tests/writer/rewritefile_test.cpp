// The family file rewrite against golden files: a small input file and a
// request give an expected file, compared whole.

#include "writer/rewritefile.h"

#include "model/loadgedcom.h"
#include "support/savefolder.h"
#include "support/censusentries.h"
#include "support/goldenfiles.h"

#include <functional>

using namespace qm;
using qmtest::censusof;
using qmtest::chosen;
using qmtest::readfile;
using qmtest::writefile;

namespace {

const flagtable flagdefs{{"__CENSUS_1881", "Census 1881", "1881", 0, "UK"},
                         {"__CENSUS_1851", "Census 1851", "30 MAR 1851", 0, "UK"}};

// The census entry most cases start from: three individuals of family.ged,
// one with an occupation, one with a one-character occupation, one given
// birth details whose record is the last before the trailer.
censusentry baseentry(const gedcomindex& ix)
{
    censusentry e = censusof(QString::number(ix.nextsourceid), "Census 1881 Leeds RG11/4523/12 (John Smith)",
                             "Leeds, Yorkshire");
    e.address = QStringLiteral("12 High Street");
    e.reference = QStringLiteral("RG11/4523/12");
    e.sourcetext = QStringLiteral("John Smith\tHead\t61\r\n\r\nTom Smith\tSon\t9");
    e.notetext = QStringLiteral("Page torn\n");
    e.year = 1881;
    e.selection.push_back(chosen(1, -1, "Smith, John", "61", "Weaver"));
    e.selection.push_back(chosen(3, -1, "Smith, Tom", "9", "-"));
    selectionrec ann = chosen(4, -1, "Lee, Ann", "3", "", u'M');
    ann.birthedited = true;
    ann.birthdate = QStringLiteral("1880 ");
    ann.birthplace = QStringLiteral(" Leeds");
    e.selection.push_back(ann);
    for (auto& s : e.selection)
        for (size_t i = 0; i < ix.people.size(); ++i)
            if (ix.people[i].id == s.id)
                s.personindex = static_cast<int32_t>(i);
    return e;
}

imagechoice image(int32_t id, const char* form, const char* title, bool isnew)
{
    imagechoice c;
    c.objectid = id;
    c.form = QString::fromUtf8(form);
    c.title = QString::fromUtf8(title);
    c.file = QStringLiteral("C:\\images\\leeds-%1.jpg").arg(id);
    c.date = QStringLiteral("3 APR 1881");
    c.isnew = isnew;
    return c;
}

struct goldencase {
    const char* name;
    const char* input;
    std::function<void(const gedcomindex&, settings&, rewriterequest&)> setup;
};

const goldencase goldencases[] = {
    {"fullentry", "family.ged",
     [](const gedcomindex& ix, settings&, rewriterequest& r) { r.entry = baseentry(ix); }},
    {"fullentry_options", "family.ged",
     [](const gedcomindex& ix, settings& s, rewriterequest& r) {
         s.opt1entrydate = s.opt1whereinsource = s.opt1publicationinfo = true;
         s.entrydatetoday = true;
         s.certainty = 3;
         s.birthsecondaryevidence = true;
         s.occage = true;
         s.occplace = false;
         s.residence = true;
         s.sourcetype = QStringLiteral("Census Return");
         r.entry = baseentry(ix);
         r.entry.chosenimages = {image(2, " JPG ", "Leeds p12", true), image(1, "jpg", "Page one", false),
                                 image(3, "", "Leeds p12", true)};
     }},
    {"fullentry_sourcenote", "family.ged",
     [](const gedcomindex& ix, settings& s, rewriterequest& r) {
         s.sourcenote = true;
         s.sourcetype.clear();
         s.asid = false;
         s.birthdate = false;
         r.entry = baseentry(ix);
         r.entry.sourcetext.clear();
         r.entry.notetext = QStringLiteral("  ");
         r.entry.address.clear();
         r.entry.chosenimages = {image(2, "png", "Leeds p12", true)};
     }},
    {"fullentry_sourcenote_withnote", "family.ged",
     [](const gedcomindex& ix, settings& s, rewriterequest& r) {
         s.sourcenote = true;
         r.entry = baseentry(ix);
         r.entry.notetext = QStringLiteral("First\r\nSecond\rThird\r\n");
     }},
    {"method2", "family.ged",
     [](const gedcomindex& ix, settings& s, rewriterequest& r) {
         s.fullentry = false;
         s.sourceinnote = true;
         s.certainty = 2;
         s.birthsecondaryevidence = true;
         r.entry = baseentry(ix);
         r.entry.sourceid = QStringLiteral("2");
         r.entry.title = QStringLiteral("Census 1881 Leeds");
         r.entry.reference = QStringLiteral("Folio 12");
         r.entry.chosenimages = {image(1, "jpg", "Page one", false), image(2, "jpg", "Leeds p12", true)};
     }},
    {"method2_sharednote", "family.ged",
     [](const gedcomindex& ix, settings& s, rewriterequest& r) {
         s.fullentry = false;
         s.sharednote = true;
         s.image2event = true;
         s.occage = true;
         r.entry = baseentry(ix);
         r.entry.sourceid = QStringLiteral("2");
         r.entry.title = QStringLiteral("Census 1881 Leeds");
         r.entry.reference = QStringLiteral("Folio 12");
         r.entry.chosenimages = {image(2, "jpg", "Leeds p12", true)};
     }},
    {"flaguse", "family.ged",
     [](const gedcomindex& ix, settings& s, rewriterequest& r) {
         s.flaguse = true;
         r.entry = baseentry(ix);
         r.entry.selection.pop_back();
         r.entry.selection.push_back(chosen(2, 1, "Renee, Mary", "30", "Weaver"));
     }},
    {"attachimages", "family.ged",
     [](const gedcomindex&, settings&, rewriterequest& r) {
         r.mode = rewritemode::attachimages;
         r.entry.sourceid = QStringLiteral("2");
         r.entry.title = QStringLiteral("Census 1881 Leeds");
         r.entry.chosenimages = {image(2, "jpg", "Leeds p12", true), image(3, "jpg", "Leeds p12", true)};
     }},
    {"censusdates", "family.ged",
     [](const gedcomindex&, settings&, rewriterequest& r) {
         r.mode = rewritemode::censusdates;
         datechange d;
         d.founddate = QStringLiteral("30 Mar 1851");
         d.newdate = QStringLiteral("30 MAR 1851");
         d.count = 1;
         datechange official; // an official date is never rewritten
         official.founddate = QStringLiteral("3 APR 1881");
         official.newdate = QStringLiteral("4 APR 1881");
         official.datekind = 1;
         r.datechanges = {d, official};
     }},
    {"flagchanges", "family.ged",
     [](const gedcomindex&, settings&, rewriterequest& r) {
         r.mode = rewritemode::flagchanges;
         // people: I1, I2, I3, I4; flags: 0 __CENSUS_1881, 1 __CENSUS_1851
         r.flagchanges = {{0, 0, true}, {1, 1, false}, {2, 0, false}, {3, 1, true}, {3, 0, true}};
     }},
    {"notrlr_fullentry", "notrlr.ged",
     [](const gedcomindex&, settings&, rewriterequest& r) {
         // The anchor source (S4) is missing and the file has no trailer:
         // the new source goes at the end, after the last individual's block.
         r.entry = censusof(QStringLiteral("5"), "Census 1881 Leeds (Jane Doe)", "Leeds");
         r.entry.sourcetext = QString::fromUtf8("Jane Doe\tHead\t40\tZo\xC3\xAB's mother");
         r.entry.selection.push_back(chosen(1, 0, "Doe, Jane", "40", "Laundress"));
         r.entry.chosenimages = {image(1, "jpg", "Leeds p1", true)};
     }},
    {"notrlr_sharednote", "notrlr.ged",
     [](const gedcomindex&, settings& s, rewriterequest& r) {
         s.fullentry = false;
         s.sharednote = true;
         r.entry = censusof(QStringLiteral("1"), "Census 1881 Leeds", "Leeds");
         r.entry.reference = QStringLiteral("Folio 3");
         r.entry.sourcetext = QStringLiteral("Jane Doe\r\n");
         r.entry.notetext = QStringLiteral("Faint");
         r.entry.selection.push_back(chosen(1, 0, "Doe, Jane", "40"));
     }},
};

class RewriteGolden : public ::testing::TestWithParam<goldencase> {
protected:
    qmtest::fixedclock clock{QDateTime(QDate(2026, 12, 4), QTime(13, 5, 9))};
};

} // namespace

// Each case runs through the real file path: the family file is both input
// and output, as when the save reads its own file.
TEST_P(RewriteGolden, WritesTheExpectedFile)
{
    const goldencase& c = GetParam();
    const std::string input = readfile(QStringLiteral(QM_TESTDATA_DIR "/writer/") + QString::fromLatin1(c.input));
    ASSERT_FALSE(input.empty());
    auto ix = loadgedcombytes(input, flagdefs);
    settings s;
    rewriterequest r;
    c.setup(*ix, s, r);

    QTemporaryDir dir;
    const QString path = dir.filePath(QStringLiteral("family.ged"));
    writefile(path, input);
    const rewriteresult res = rewritefile(path, path, *ix, s, r);
    ASSERT_TRUE(res.ok) << res.message.toStdString();
    EXPECT_TRUE(qmtest::matchesgolden(QStringLiteral("writer/%1.ged").arg(QString::fromLatin1(c.name)), readfile(path)));

    // The run in memory writes the same bytes.
    std::string inmemory;
    ASSERT_TRUE(rewritebytes(input, inmemory, *ix, s, r).ok);
    EXPECT_TRUE(qmtest::samebytes(readfile(path), inmemory));
}

INSTANTIATE_TEST_SUITE_P(Cases, RewriteGolden, ::testing::ValuesIn(goldencases),
                         [](const auto& info) { return std::string(info.param.name); });
