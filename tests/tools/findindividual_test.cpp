#include "tools/findindividual.h"

#include "model/loadgedcom.h"

#include <gtest/gtest.h>

using namespace qm;

namespace {

std::unique_ptr<gedcomindex> load(const std::string& body)
{
    return loadgedcombytes("0 HEAD\r\n1 CHAR UTF-8\r\n" + body + "0 TRLR\r\n", flagtable{});
}

std::vector<int32_t> ids(const gedcomindex& x, const std::vector<int32_t>& positions)
{
    std::vector<int32_t> out;
    for (int32_t k : positions)
        out.push_back(x.people[static_cast<size_t>(k)].id);
    return out;
}

// Father @I1@ and mother @I2@ of @F1@; their children @I3@ and @I4@; @I3@
// married to @I5@ in @F2@ with their child @I6@.
const char* family = "0 @I1@ INDI\r\n1 NAME William /Ashworth/\r\n1 BIRT\r\n2 DATE ABT 1808\r\n1 FAMS @F1@\r\n"
                     "0 @I2@ INDI\r\n1 NAME Hannah /Greenwood/\r\n1 FAMS @F1@\r\n"
                     "0 @I3@ INDI\r\n1 NAME John /Ashworth/\r\n1 BIRT\r\n2 DATE 3 JAN 1831\r\n2 PLAC Heptonstall\r\n"
                     "1 CENS\r\n2 DATE 6 JUN 1841\r\n2 PLAC Heptonstall\r\n2 ADDR Slack\r\n2 AGE 10\r\n"
                     "1 CENS\r\n2 DATE (1851)\r\n2 PLAC Hebden Bridge\r\n"
                     "1 FAMC @F1@\r\n1 FAMS @F2@\r\n"
                     "0 @I4@ INDI\r\n1 NAME Mary /Ashworth/\r\n1 FAMC @F1@\r\n"
                     "0 @I5@ INDI\r\n1 NAME Ann /Sutcliffe/\r\n1 FAMS @F2@\r\n"
                     "0 @I6@ INDI\r\n1 NAME Tom /Ashworth/\r\n1 FAMC @F2@\r\n";

} // namespace

TEST(FindIndividual, CensusDateAndAgeTexts)
{
    // A date shows its year (4 characters) when it ends with one, else as it is.
    const std::pair<const char*, const char*> dates[] = {
        {"30 MAR 1851", "1851"}, {"ABT 1851", "1851"}, {"(1851)", "1851"}, {"(JUN)", "JUN"},
        {"123", "123"}, {"census night", "census night"}, {"1851 census", "1851 census"}, {"", ""}};
    for (const auto& [in, out] : dates)
        EXPECT_EQ(censusdatetext(QString::fromUtf8(in)), QString::fromUtf8(out)) << in;
    const std::pair<const char*, const char*> ages[] = {
        {"1m", "1 month"}, {"5M", "5 months"}, {"1d", "1 day"}, {"3D", "3 days"}, {"45y", "45"}, {"45Y", "45"},
        {"45", "45"}, {"", "?"}, {"  ", "?"}, {"CHILD", "CHILD"}, {"y", "y"}, {"45y 3m", "45y 3m"}};
    for (const auto& [in, out] : ages)
        EXPECT_EQ(censusagetext(QString::fromUtf8(in)), QString::fromUtf8(out)) << in;
}

TEST(FindIndividual, CensusLines)
{
    const auto x = load(family);
    ASSERT_TRUE(x);
    EXPECT_EQ(censuslines(x->people[2]),
              (QStringList{QStringLiteral("1841: aged 10 at Heptonstall (Slack)"),
                           QStringLiteral("1851: aged ? at Hebden Bridge")}));
    EXPECT_EQ(censuslines(x->people[0]), QStringList{QStringLiteral("(Does not have any census events recorded)")});
}

TEST(FindIndividual, Relatives)
{
    const auto x = load(family);
    ASSERT_TRUE(x);
    const relatives john = findrelatives(*x, 2);
    EXPECT_EQ(ids(*x, john.parents), (std::vector<int32_t>{1, 2}));
    EXPECT_EQ(ids(*x, john.spouses), std::vector<int32_t>{5});
    EXPECT_EQ(ids(*x, john.children), std::vector<int32_t>{6});
    const relatives william = findrelatives(*x, 0);
    EXPECT_TRUE(william.parents.empty());
    EXPECT_EQ(ids(*x, william.children), (std::vector<int32_t>{3, 4}));
    // A sibling is none of the three.
    const relatives mary = findrelatives(*x, 3);
    EXPECT_EQ(ids(*x, mary.parents), (std::vector<int32_t>{1, 2}));
    EXPECT_TRUE(mary.spouses.empty() && mary.children.empty());
    EXPECT_TRUE(findrelatives(*x, 99).parents.empty());
}

// A record that makes @I2@ both a parent and a spouse of @I1@ (and of a
// family listed twice): listed once per link, never as a child.
TEST(FindIndividual, ParentAndSpouse)
{
    const auto x = load("0 @I1@ INDI\r\n1 NAME A /X/\r\n1 FAMC @F1@\r\n1 FAMS @F1@\r\n1 FAMS @F2@\r\n"
                        "0 @I2@ INDI\r\n1 NAME B /X/\r\n1 FAMC @F2@\r\n1 FAMS @F1@\r\n1 FAMS @F2@\r\n"
                        "0 @I3@ INDI\r\n1 NAME C /X/\r\n1 FAMS @F2@\r\n1 FAMS @F2@\r\n");
    ASSERT_TRUE(x);
    const relatives a = findrelatives(*x, 0);
    EXPECT_EQ(ids(*x, a.parents), std::vector<int32_t>{2});
    EXPECT_EQ(ids(*x, a.spouses), (std::vector<int32_t>{2, 2, 3, 3}));
    EXPECT_TRUE(a.children.empty());
}

TEST(FindIndividual, ListAndSearches)
{
    const auto x = load(family);
    ASSERT_TRUE(x);
    const std::vector<listentry> list = findlist(*x, false, {});
    ASSERT_EQ(list.size(), size_t(6));
    EXPECT_EQ(list[1].text, QStringLiteral("Ashworth, Mary (ID: 4)"));
    EXPECT_EQ(list[3].text, QStringLiteral("Ashworth, William (ABT 1808)"));
    EXPECT_EQ(findlist(*x, true, {})[0].text, QStringLiteral("Ashworth, John (ID: 3)"));

    EXPECT_EQ(findbyname(list, QStringLiteral("GREEN")), 4);
    EXPECT_EQ(findbyname(list, QString()), 0);
    EXPECT_EQ(findbyname(list, QStringLiteral("Worth")), -1); // the start only
    EXPECT_EQ(findbyname({}, QString()), -1);

    EXPECT_EQ(findbyid(*x, list, 5), 5);
    EXPECT_EQ(findbyid(*x, list, 7), -1);
    EXPECT_EQ(personofid(*x, 6), 5);
    EXPECT_EQ(personofid(*x, 0), -1);
}

// Above 32,000 individuals the main window's entries are taken as they are.
TEST(FindIndividual, LargeFileTakesMainList)
{
    std::string body;
    for (int i = 1; i <= 32001; ++i)
        body += "0 @I" + std::to_string(i) + "@ INDI\r\n1 NAME P" + std::to_string(i) + " /X/\r\n";
    const auto x = load(body);
    ASSERT_TRUE(x);
    ASSERT_EQ(x->people.size(), size_t(32001));
    const std::vector<listentry> main = {{QStringLiteral("X, P9 (ID: 9)"), 8}, {QStringLiteral("X, P10 (ID: 10)"), 9}};
    const std::vector<listentry> list = findlist(*x, false, main);
    ASSERT_EQ(list.size(), size_t(2));
    EXPECT_TRUE(list[1].text == main[1].text && list[1].person == 9);
    // An individual of the file that the list does not hold is not found.
    EXPECT_EQ(findbyid(*x, list, 11), -1);
    EXPECT_EQ(findbyid(*x, list, 10), 1);
}
