#include "census/autotext.h"

#include <gtest/gtest.h>

using namespace qm;

// Shows texts readably in failure messages.
[[maybe_unused]] static void PrintTo(const QString& s, std::ostream* os)
{
    *os << '"' << s.toStdString() << '"';
}

namespace {

personrec person(int32_t id, std::string_view name, std::string_view sex, int32_t famc,
                 std::vector<int32_t> fams, std::string_view birthplace = {})
{
    personrec p;
    p.id = id;
    p.name = name;
    p.sex = sex;
    p.famc = famc;
    p.fams = std::move(fams);
    p.birthplace = birthplace;
    p.hasbirthplace = !birthplace.empty();
    return p;
}

selectionrec row(const gedcomindex& index, int32_t at, const char* age, char16_t unit = u'Y',
                 const char* occupation = "")
{
    selectionrec r;
    const personrec& p = index.people[static_cast<size_t>(at)];
    r.id = p.id;
    r.name = qs(p.name);
    r.age = QString::fromLatin1(age);
    r.agetype = QChar(unit);
    r.occupation = QString::fromLatin1(occupation);
    r.personindex = at;
    return r;
}

// John Smith (family 10 with Mary Brown; child of family 5), his wife, their
// children, his mother and brother, a lodger and an unnamed record.
struct household {
    gedcomindex index;
    household()
    {
        auto& p = index.people;
        p.push_back(person(1, "Smith, John", "M", 5, {10}, "Leeds, Yorkshire"));
        p.push_back(person(2, "Brown, Mary", "F", 0, {10}, "York"));
        p.push_back(person(3, "Smith, William", "M", 10, {}));
        p.push_back(person(4, "Smith, Ann", "F", 10, {}));
        p.push_back(person(5, "Smith, Thomas", "M", 10, {}));
        p.push_back(person(6, "Smith, Jane", "F", 10, {}));
        p.push_back(person(7, "Smith, Baby", "", 10, {}));
        p.push_back(person(8, "Jones, Sarah", "F", 0, {5}, "Otley"));
        p.push_back(person(9, "Smith, Robert", "M", 5, {}));
        p.push_back(person(10, "Green, Peter", "M", 0, {}));
        p.push_back(person(11, "<no name>", "F", 10, {}));
        p.push_back(person(12, "Smith, George", "M", 5, {11}));
        p.push_back(person(13, "Smith, Alice", "F", 10, {}));
    }
    std::vector<selectionrec> rows() const
    {
        return {row(index, 0, "45", u'Y', "Weaver"), row(index, 1, "40"), row(index, 2, "15"),
                row(index, 3, "3"),  row(index, 4, "16"), row(index, 5, "4"),
                row(index, 6, "6", u'M'), row(index, 7, "70"), row(index, 8, "38", u'Y', "Carter"),
                row(index, 9, "22", u'Y', "Lodger"), row(index, 10, "10", u'D'),
                row(index, 12, "12", u'Y', "Servant")};
    }
};

settings options(bool condition)
{
    settings s;
    s.occscholar = false;
    s.marriagecondition = condition;
    return s;
}

QStringList lines(const QString& text)
{
    EXPECT_TRUE(text.endsWith(QLatin1String("\r\n")));
    QStringList l = text.split(QStringLiteral("\r\n"));
    l.removeLast();
    return l;
}

} // namespace

TEST(AutoText, HouseholdWithConditionColumn)
{
    household h;
    const QString text = autotext(h.rows(), h.index, "2 JUN 1880", "USA", options(true));
    const QStringList expected = {
        "Name\tRelated\tCond\tAge\tOccupation\tBirth Place",
        "John Smith\tHead\tMar\t45\tWeaver\tLeeds, Yorkshire",
        "Mary Smith\tWife\tMar\t40\t\tYork",
        "William Smith\tSon\tUnm\t15\tScholar\t",
        "Ann Smith\tDau\tUnm\t3\t\t",
        "Thomas Smith\tSon\tUnm\t16\t\t",
        "Jane Smith\tDau\tUnm\t4\tScholar\t",
        "Baby Smith\tSon\tUnm\t6 mths\t\t",
        "Sarah Smith\tMother\tWid\t70\t\tOtley",
        "Robert Smith\tBro\tUnm\t38\tCarter\t",
        "Peter Green\t\t\t22\tLodger\t",
        "\tDau\tUnm\t10 days\t\t",
        "Alice Smith\tDau\tUnm\t12\tServant\t",
    };
    EXPECT_EQ(lines(text), expected);
}

TEST(AutoText, WithoutConditionColumnAndWithAnAlternateSeparator)
{
    household h;
    const auto rows = h.rows();
    settings s = options(false);
    EXPECT_EQ(lines(autotext({rows[0], rows[1]}, h.index, "3 APR 1881", "UK", s)),
              (QStringList{"Name\tRelated\tAge\tOccupation\tBirth Place", "John Smith\tHead\t45\tWeaver\tLeeds, Yorkshire",
                           "Mary Smith\tWife\t40\t\tYork"}));

    s.alternateseparator = true;
    s.alternateseparatorcharacter = "|";
    s.marriagecondition = true;
    EXPECT_EQ(lines(autotext({rows[0], rows[2]}, h.index, "3 APR 1881", "UK", s)),
              (QStringList{"Name|Related|Cond|Age|Occupation|Birth Place", "John Smith|Head|Mar|45|Weaver|Leeds, Yorkshire",
                           "William Smith|Son|Unm|15|Scholar|"}));
    // A separator setting left empty keeps the tab.
    s.alternateseparatorcharacter.clear();
    EXPECT_TRUE(autotext({rows[0]}, h.index, "3 APR 1881", "UK", s).startsWith("Name\tRelated"));
}

TEST(AutoText, UkCensusesOf1841And1891And1901)
{
    household h;
    const auto rows = h.rows();
    const std::vector<selectionrec> family = {rows[0], rows[1], rows[7]};
    EXPECT_EQ(lines(autotext(family, h.index, "6 JUN 1841", "UK", options(true))),
              (QStringList{"Name\tAge\tOccupation\tWhere Born", "John Smith\t45\tWeaver\t", "Mary Smith\t40\t\t",
                           "Sarah Smith\t70\t\t"}));
    const QStringList late = {"Name\tRelated\tCond\tAge\tOccupation\tBirth Place",
                              "John Smith\tHead\tM\t45\tWeaver\tLeeds, Yorkshire", "Mary Smith\tWife\tM\t40\t\tYork",
                              "Sarah Smith\tMother\tW\t70\t\tOtley"};
    EXPECT_EQ(lines(autotext(family, h.index, "5 APR 1891", "UK", options(true))), late);
    EXPECT_EQ(lines(autotext(family, h.index, "31 MAR 1901", "UK", options(true))), late);
    EXPECT_EQ(lines(autotext({rows[0], rows[2]}, h.index, "05 apr 1891", "UK", options(true)))[2],
              "William Smith\tSon\tS\t15\tScholar\t");

    EXPECT_EQ(autotextkind("UK", "06 JUN 1841"), censuskind::uk1841);
    EXPECT_EQ(autotextkind("Ireland", "31 MAR 1901"), censuskind::other);
    EXPECT_EQ(autotextkind("UK", "2 APR 1911"), censuskind::other);
    EXPECT_EQ(autotextkind("UK", "not a date"), censuskind::other);
}

TEST(AutoText, HeadIsMarriedFromTwentyOneYears)
{
    household h;
    auto head = row(h.index, 9, "20");
    auto cond = [&] { return lines(autotext({head}, h.index, "2 JUN 1880", "USA", options(true)))[1]; };
    EXPECT_EQ(cond(), "Peter Green\tHead\tUnm\t20\t\t");
    head.age = "21";
    EXPECT_EQ(cond(), "Peter Green\tHead\tMar\t21\t\t");
    head.age = "300";
    head.agetype = u'M';
    EXPECT_EQ(cond(), "Peter Green\tHead\tUnm\t300 mths\t\t");
}

TEST(AutoText, ScholarAndBirthPlaceOfARow)
{
    household h;
    settings s = options(false);
    s.occscholar = true;
    const auto rows = h.rows();
    EXPECT_EQ(lines(autotext({rows[0], rows[2]}, h.index, "3 APR 1881", "UK", s))[2],
              "William Smith\tSon\t15\t\t");

    // A birth place given in the birth details is the one shown.
    auto son = rows[2];
    son.birthedited = true;
    son.birthdate = "1865";
    son.birthplace = "Bradford";
    EXPECT_EQ(lines(autotext({rows[0], son}, h.index, "2 JUN 1880", "USA", options(false)))[2],
              "William Smith\tSon\t15\tScholar\tBradford");
}

TEST(AutoText, HusbandGivesHisSurnameToLaterRowsOnly)
{
    gedcomindex index;
    index.people.push_back(person(1, "Smith, Mary", "F", 5, {10}));
    index.people.push_back(person(2, "Brown, John", "M", 0, {10}));
    index.people.push_back(person(3, "Jones, Sarah", "F", 0, {5}));
    index.people.push_back(person(4, "Nobody, ", "M", 0, {}));
    const QStringList l = lines(autotext({row(index, 0, "30"), row(index, 1, "32"), row(index, 2, "60"),
                                          row(index, 3, "1")},
                                         index, "2 JUN 1880", "USA", options(false)));
    EXPECT_EQ(l[1], "Mary Smith\tHead\t30\t\t");
    EXPECT_EQ(l[2], "John Brown\tHusb\t32\t\t");
    EXPECT_EQ(l[3], "Sarah Brown\tMother\t60\t\t");
    EXPECT_EQ(l[4], "Nobody\t\t1\t\t"); // nothing after ", "
}

TEST(AutoText, CensusDateChecks)
{
    EXPECT_FALSE(checkautotextdate("3 APR 1881"));
    auto problem = checkautotextdate("");
    ASSERT_TRUE(problem);
    EXPECT_EQ(problem->message, "Before using the Auto-text function, you must first choose a date for the census");
    EXPECT_FALSE(problem->focusdate);
    problem = checkautotextdate("31 FEB 1881");
    ASSERT_TRUE(problem);
    EXPECT_EQ(problem->message, "You have not selected a valid date for the census - reselect the year from the "
                                "list box above to reset to original value");
    EXPECT_TRUE(problem->focusdate);
}

TEST(AutoText, WhoIsAskedForBirthDetails)
{
    household h;
    EXPECT_EQ(checkbirth(row(h.index, 0, "45"), h.index), birthcheck::none); // has a birth place
    auto son = row(h.index, 2, "15");
    EXPECT_EQ(checkbirth(son, h.index), birthcheck::ask);
    son.birthedited = true;
    EXPECT_EQ(checkbirth(son, h.index), birthcheck::none);

    h.index.people[3].hasbirthdate = true;
    EXPECT_EQ(checkbirth(row(h.index, 3, "3"), h.index), birthcheck::none);
    h.index.people[4].birthedited = true;
    EXPECT_EQ(checkbirth(row(h.index, 4, "16"), h.index), birthcheck::none);

    auto stale = row(h.index, 5, "4");
    stale.id = 99;
    EXPECT_EQ(checkbirth(stale, h.index), birthcheck::idmismatch);
    stale = row(h.index, 5, "4");
    stale.personindex = 500;
    EXPECT_EQ(checkbirth(stale, h.index), birthcheck::idmismatch);
    EXPECT_EQ(idmismatchmessage(), "ID doesn't match - something wrong here. Please contact Quillmark author - see "
                                   "help file for details");
}
