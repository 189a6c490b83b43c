#include "census/validateentry.h"

#include "model/gedcomindex.h"
#include "platform/scriptedprompts.h"
#include "settings/settings.h"
#include "support/censusentries.h"

#include <QLocale>

#include <gtest/gtest.h>

using namespace qm;

namespace {

class ValidateEntry : public ::testing::Test {
protected:
    void SetUp() override
    {
        QLocale::setDefault(QLocale(QLocale::English, QLocale::UnitedKingdom));
        f.fullentry = true;
        f.yeartext = QStringLiteral("1881");
        f.officialdate = QStringLiteral("3 APR 1881");
        f.datetext = QStringLiteral("3 APR 1881");
        f.place = QStringLiteral("Leeds");
        f.title = QStringLiteral("Census 1881 Leeds");
        f.reference = QStringLiteral("RG11/4");
        f.sourceid = QStringLiteral("7");
        f.sourcetext = QStringLiteral("John Smith Head 40");
        f.selection = {qmtest::chosen(1, 0, "", "40")};
    }
    void TearDown() override { QLocale::setDefault(QLocale::c()); }

    entrycheck check(prompts* p = nullptr) const { return validateentry(f, s, p); }
    QString first() const { return check().message; }

    entryform f;
    settings s;
};

} // namespace

TEST_F(ValidateEntry, ChecksInTheirOrder)
{
    // Everything wrong at once: each fix reveals the next check's message.
    f.selection.clear();
    f.place = QStringLiteral("   ");
    f.title = QStringLiteral(" short ");
    f.yeartext.clear();
    f.datetext = QStringLiteral("31 FEB 1881");
    EXPECT_EQ(first(), QStringLiteral("The census entry must refer to at least 1 person!"));
    SetUp();
    f.place = QStringLiteral("   ");
    f.title = QStringLiteral(" short ");
    EXPECT_EQ(first(), QStringLiteral("Location must be specified"));
    EXPECT_EQ(check().focus, entryfield::place);
    f.place = QStringLiteral("Leeds");
    EXPECT_EQ(first(), QStringLiteral("You must provide a full title for the entry"));
    EXPECT_EQ(check().focus, entryfield::title);
    f.title = QStringLiteral("Census 1881 Leeds");
    f.yeartext.clear();
    EXPECT_EQ(first(), QStringLiteral("You must select a census year from the list"));
    f.yeartext = QStringLiteral("1881");
    f.datetext = QStringLiteral("31 FEB 1881");
    EXPECT_EQ(first(), QStringLiteral("Invalid date - reselect the year from the list box above to reset to original value"));
    EXPECT_EQ(check().focus, entryfield::date);
    f.datetext.clear();
    EXPECT_FALSE(check().ok) << "an empty date is not a date";
}

TEST_F(ValidateEntry, TitleAndWhereWithinSourceLengths)
{
    f.title = QStringLiteral("  12345678901  ");
    EXPECT_EQ(first(), QStringLiteral("You must provide a full title for the entry"));
    f.title = QStringLiteral("123456789012");
    EXPECT_TRUE(check().ok);

    f.fullentry = false;
    f.title.clear(); // not looked at when citing an existing source
    f.reference = QStringLiteral("ab  ");
    EXPECT_EQ(first(), QStringLiteral("You must enter the text for the 'Where within Source' entry"));
    EXPECT_EQ(check().focus, entryfield::wherewithinsource);
    f.reference = QStringLiteral("abc");
    f.sourceid.clear();
    EXPECT_EQ(first(), QStringLiteral("You must select a source from the drop-down list"));
    f.sourceid = QStringLiteral("3");
    EXPECT_TRUE(check().ok);
}

TEST_F(ValidateEntry, AcceptsCompleteEntryAndNormalisesItsDate)
{
    entrycheck c = check();
    EXPECT_TRUE(c.ok) << c.message.toStdString();
    EXPECT_EQ(c.entrydate, QStringLiteral("3 APR 1881"));
    EXPECT_FALSE(c.datechanged);

    f.datetext = QStringLiteral("4 apr 1881");
    c = check();
    ASSERT_TRUE(c.ok);
    EXPECT_EQ(c.entrydate, QStringLiteral("04 APR 1881"));
    EXPECT_TRUE(c.datechanged);
}

TEST_F(ValidateEntry, EmptySourceTextIsAskedAbout)
{
    scriptedprompts p;
    f.sourcetext = QStringLiteral(" ab ");
    p.expect(answer::no, QStringLiteral("The Source Text hasn't been filled in."));
    entrycheck c = check(&p);
    EXPECT_FALSE(c.ok);
    EXPECT_TRUE(c.message.isEmpty());
    const message& asked = p.history().at(0).m;
    EXPECT_EQ(asked.title, QStringLiteral("Save census"));
    EXPECT_EQ(asked.choice, buttons::yesno);
    EXPECT_EQ(asked.defaultanswer, answer::no);

    p.expect(answer::yes);
    EXPECT_TRUE(check(&p).ok);

    s.nosourcetextwarning = false;
    EXPECT_TRUE(check(&p).ok);
    f.sourcetext = QStringLiteral("abc");
    s.nosourcetextwarning = true;
    EXPECT_TRUE(check(&p).ok);
    EXPECT_EQ(p.unexpected(), 0);
    EXPECT_TRUE(check().ok) << "without prompts the question is not asked";
}

TEST(CheckHousehold, RowsGivenByRecordNumber)
{
    auto row = [](int id, const char* age, char16_t type = u'Y', int index = 0) {
        return qmtest::chosen(id, index, "Smith, John", age, "", type);
    };
    EXPECT_EQ(checkhousehold({row(1, "40"), row(2, "3", u'M', 1), row(3, "123", u'D', 2)}), QString());
    EXPECT_EQ(checkhousehold({row(9, "4", u'Y', -1)}),
              QStringLiteral("There is no individual with the record number 9 in the family file"));
    EXPECT_EQ(checkhousehold({row(1, "40"), row(1, "40")}),
              QStringLiteral("The individual Smith, John (1) is in the census entry more than once"));
    EXPECT_TRUE(checkhousehold({row(1, " ")}).startsWith(noagemessage()));
    EXPECT_TRUE(checkhousehold({row(1, "1000")}).startsWith(QStringLiteral("The age of Smith, John (1) must be a number")));
    EXPECT_TRUE(checkhousehold({row(1, "4x")}).startsWith(QStringLiteral("The age of")));
    EXPECT_TRUE(checkhousehold({row(1, "4", u'y')}).startsWith(QStringLiteral("The age type of Smith, John (1)")));
}

TEST(CheckHousehold, CitedSourceMustBeACensusSource)
{
    gedcomindex ix;
    sourcerec census;
    census.id = 4;
    census.iscensus = true;
    sourcerec parish;
    parish.id = 5;
    ix.sources = {parish, census};
    EXPECT_EQ(findcensussource(ix, QStringLiteral(" 4")), 1);
    EXPECT_EQ(findcensussource(ix, QStringLiteral("5")), -1);
    EXPECT_EQ(findcensussource(ix, QStringLiteral("6")), -1);
    EXPECT_EQ(findcensussource(ix, QStringLiteral("x")), -1);
}
