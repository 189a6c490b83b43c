#include "census/householdcheck.h"

#include "model/loadgedcom.h"
#include "settings/settings.h"
#include "support/censusentries.h"
#include "support/testfiles.h"

#include <QLocale>
#include <QTemporaryDir>

#include <gtest/gtest.h>

using namespace qm;

namespace {

// A hand-made family around the 1881 census (3 APR 1881). John and Mary are
// husband and wife with four children; Samuel, John's father, died in 1875;
// Cousin Harry is joined to them only through Samuel's other son's family;
// Lodger Pratt and Eliza (a second record of Mary, never joined) stand alone.
// Jane already has a census event of 1881, Kate a residence fact of it, and
// Bob a citation of the census source S5 under another date.
const std::string family =
    "0 HEAD\r\n1 CHAR UTF-8\r\n"
    "0 @I1@ INDI\r\n1 NAME John /Smith/\r\n1 BIRT\r\n2 DATE 12 MAR 1840\r\n1 FAMC @F2@\r\n1 FAMS @F1@\r\n"
    "0 @I2@ INDI\r\n1 NAME Mary /Brown/\r\n1 BIRT\r\n2 DATE ABT 1842\r\n1 FAMS @F1@\r\n"
    "0 @I3@ INDI\r\n1 NAME Ann /Smith/\r\n1 BIRT\r\n2 DATE BET 1870 AND 1872\r\n1 FAMC @F1@\r\n"
    "0 @I4@ INDI\r\n1 NAME Tom /Smith/\r\n1 BIRT\r\n2 DATE 1885\r\n1 FAMC @F1@\r\n"
    "0 @I5@ INDI\r\n1 NAME Samuel /Smith/\r\n1 BIRT\r\n2 DATE 1801\r\n1 DEAT\r\n2 DATE 1875\r\n1 FAMS @F2@\r\n"
    "0 @I6@ INDI\r\n1 NAME Lodger /Pratt/\r\n1 BIRT\r\n2 DATE 1850\r\n"
    "0 @I7@ INDI\r\n1 NAME Jane /Smith/\r\n1 FAMC @F1@\r\n1 CENS\r\n2 DATE 3 APR 1881\r\n2 PLAC Leeds\r\n"
    "0 @I8@ INDI\r\n1 NAME Kate /Smith/\r\n1 FAMC @F1@\r\n1 RESI\r\n2 DATE 3 APR 1881\r\n2 PLAC Leeds\r\n"
    "0 @I9@ INDI\r\n1 NAME Bob /Smith/\r\n1 FAMC @F1@\r\n1 CENS\r\n2 DATE 1881\r\n2 SOUR @S5@\r\n"
    "0 @I10@ INDI\r\n1 NAME Walter /Smith/\r\n1 FAMC @F2@\r\n1 FAMS @F3@\r\n"
    "0 @I11@ INDI\r\n1 NAME Harry /Smith/\r\n1 FAMC @F3@\r\n"
    "0 @I12@ INDI\r\n1 NAME Eliza /Brown/\r\n1 BIRT\r\n2 DATE 1842\r\n"
    "0 @I13@ INDI\r\n1 NAME Ellen /Smith/\r\n1 BIRT\r\n2 DATE AFT 1875\r\n1 FAMC @F1@\r\n"
    "0 @F1@ FAM\r\n1 HUSB @I1@\r\n1 WIFE @I2@\r\n1 CHIL @I3@\r\n1 CHIL @I4@\r\n1 CHIL @I7@\r\n1 CHIL @I8@\r\n"
    "1 CHIL @I9@\r\n1 CHIL @I13@\r\n"
    "0 @F2@ FAM\r\n1 HUSB @I5@\r\n1 CHIL @I1@\r\n1 CHIL @I10@\r\n"
    "0 @F3@ FAM\r\n1 HUSB @I10@\r\n1 CHIL @I11@\r\n"
    "0 @S5@ SOUR\r\n1 TITL Census 1881 Leeds\r\n"
    "0 TRLR\r\n";

struct row {
    int32_t id;
    const char* age;
    char16_t agetype = u'Y';
};

class HouseholdCheck : public ::testing::Test {
protected:
    void SetUp() override
    {
        QLocale::setDefault(QLocale(QLocale::English, QLocale::UnitedKingdom));
        ASSERT_TRUE(dir.isValid());
        const QString path = dir.filePath(QStringLiteral("family.ged"));
        qmtest::writefile(path, family);
        loadresult loaded = loadgedcom(path, {});
        ASSERT_TRUE(loaded.index) << loaded.error.toStdString();
        ix = std::move(loaded.index);
        entry = qmtest::censusof(QStringLiteral("6"), "Census 1881 Leeds", "Leeds", "3 APR 1881");
        entry.year = 1881;
    }
    void TearDown() override { QLocale::setDefault(QLocale::c()); }

    int32_t positionof(int32_t id) const
    {
        for (size_t k = 0; k < ix->people.size(); ++k)
            if (ix->people[k].id == id)
                return static_cast<int32_t>(k);
        return -1;
    }

    std::vector<householdfinding> check(std::initializer_list<row> rows)
    {
        entry.selection.clear();
        for (const row& r : rows)
            entry.selection.push_back(qmtest::chosen(r.id, positionof(r.id), "", r.age, "", r.agetype));
        return householdcheck(*ix, s, entry);
    }

    // The findings as "row:kind" words, for one comparison per case.
    static std::string kinds(const std::vector<householdfinding>& found)
    {
        static const char* names[] = {"age", "diedbefore", "notborn", "entered", "twice", "unrelated"};
        std::string out;
        for (const householdfinding& f : found)
            out += (out.empty() ? "" : " ") + std::to_string(f.row + 1) + ':' + names[static_cast<int>(f.kind)];
        return out;
    }

    QTemporaryDir dir;
    std::unique_ptr<gedcomindex> ix;
    settings s;
    censusentry entry;
};

} // namespace

TEST_F(HouseholdCheck, AgeAgainstTheBirthDate)
{
    // Each case: Walter (John's brother, no birth date), then the row under
    // test, so that the household is related and only the age can be found.
    struct agecase {
        row r;
        bool found;
        const char* why;
    };
    const agecase cases[] = {
        {{1, "41"}, false, "exact date, right age"},
        {{1, "43"}, false, "exact date, two years out"},
        {{1, "44"}, true, "exact date, three years over"},
        {{1, "38"}, true, "exact date, three years under"},
        {{2, "36"}, false, "ABT 1842 allows 38 or 39, two years less"},
        {{2, "42"}, true, "ABT 1842, three years over"},
        {{3, "8"}, false, "BET 1870 AND 1872 allows 8 to 11"},
        {{3, "11"}, false, "BET 1870 AND 1872, the oldest"},
        {{3, "12"}, true, "BET: no slack beyond the bounds"},
        {{3, "7"}, true, "BET: no slack below them either"},
        {{13, "5"}, false, "AFT 1875 allows 5 or less"},
        {{13, "6"}, true, "AFT 1875: older than the bound"},
        {{1, "500", u'M'}, false, "months: 41 years 8 months"},
        {{1, "30", u'M'}, true, "months: 2 years"},
        {{1, ""}, false, "no age typed"},
    };
    for (const agecase& c : cases) {
        const auto found = check({{10, ""}, c.r});
        const std::string expect = c.found ? "2:age" : "";
        EXPECT_EQ(kinds(found), expect) << c.why;
    }
    // The message names the individual, the age typed and the ages the tree gives.
    const auto found = check({{1, "54"}, {2, "39"}});
    ASSERT_EQ(found.size(), 1u);
    EXPECT_EQ(findingline(found[0]).toStdString(),
              "Row 1: Smith, John (ID: 1) is entered as aged 54, but by the tree was born on 12 Mar 1840 and in this "
              "census would be aged 41.");
    EXPECT_EQ(found[0].severity, findingseverity::warning);
}

TEST_F(HouseholdCheck, RoundedAgesOf1841)
{
    // Samuel, born 1801, is 39 or 40 on 6 JUN 1841; the enumerator wrote 35.
    entry.entrydate = QStringLiteral("6 JUN 1841");
    entry.year = 1841;
    EXPECT_EQ(kinds(check({{5, "35"}, {1, "1"}})), "") << "35 in 1841 stands for 35 to 39";
    EXPECT_EQ(kinds(check({{5, "30"}, {1, "1"}})), "1:age");
    s.country = QStringLiteral("USA");
    EXPECT_EQ(kinds(check({{5, "35"}, {1, "1"}})), "1:age") << "only the UK census rounded";
}

TEST_F(HouseholdCheck, DeadOrNotYetBorn)
{
    const auto found = check({{1, "41"}, {5, "80"}, {4, "1"}});
    EXPECT_EQ(kinds(found), "2:diedbefore 3:notborn");
    EXPECT_EQ(found[0].message.toStdString(),
              "Smith, Samuel (ID: 5) died in 1875 by the tree, before the census day 3 APR 1881.");
    EXPECT_EQ(found[1].message.toStdString(),
              "Smith, Tom (ID: 4) was born in 1885 by the tree, after the census day 3 APR 1881.");
}

TEST_F(HouseholdCheck, EnteredTwice)
{
    // A census event of this census day; a residence fact only when residence facts are written.
    EXPECT_EQ(kinds(check({{1, "41"}, {7, "5"}, {8, "3"}})), "2:entered");
    s.residence = true;
    const auto found = check({{1, "41"}, {7, "5"}, {8, "3"}});
    EXPECT_EQ(kinds(found), "2:entered 3:entered");
    EXPECT_EQ(found[1].message.toStdString(),
              "Smith, Kate (ID: 8) already has a residence fact of this census dated 3 APR 1881 at Leeds: is this "
              "household entered twice?");
    // Citing an existing census source: its citations count whatever their date.
    s.residence = false;
    EXPECT_EQ(kinds(check({{1, "41"}, {9, "6"}})), "");
    s.fullentry = false;
    entry.sourceid = QStringLiteral("5");
    EXPECT_EQ(kinds(check({{1, "41"}, {9, "6"}})), "2:entered");
}

TEST_F(HouseholdCheck, SameIndividualInTwoRows)
{
    const auto found = check({{1, "41"}, {2, "39"}, {1, "41"}});
    EXPECT_EQ(kinds(found), "3:twice");
    EXPECT_EQ(found[0].message.toStdString(), "Smith, John (ID: 1) is in row 1 as well.");
}

TEST_F(HouseholdCheck, UnrelatedIsInformation)
{
    // Harry is John's nephew through Walter, a long chain: related.
    EXPECT_EQ(kinds(check({{1, "41"}, {11, "5"}})), "");
    // A lodger and a second record never joined to the family are found, as information only.
    const auto found = check({{1, "41"}, {2, "39"}, {6, "31"}, {12, "39"}});
    EXPECT_EQ(kinds(found), "3:unrelated 4:unrelated");
    EXPECT_EQ(found[0].severity, findingseverity::information);
    EXPECT_FALSE(anywarning(found));
    // Two people unrelated to each other in a household of two are each found.
    EXPECT_EQ(kinds(check({{6, "31"}, {12, "39"}})), "1:unrelated 2:unrelated");
    // One person alone is related to no one, and that is no finding.
    EXPECT_EQ(kinds(check({{6, "31"}})), "");
}

TEST_F(HouseholdCheck, UnrecognisedDatesFindNothing)
{
    entry.entrydate = QStringLiteral("sometime");
    EXPECT_EQ(kinds(check({{1, "90"}, {5, "80"}, {4, "1"}})), "");
}
