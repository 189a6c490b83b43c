#include "flags/flagtable.h"

#include "platform/encoding.h"
#include "platform/settingsstore.h"

#include <QTemporaryDir>

#include <gtest/gtest.h>

#include <optional>
#include <tuple>

using namespace qm;

namespace {

TEST(CodeForFlag, CapitalAsciiCodeOfAtMostFifteenCharacters)
{
    const std::vector<std::pair<QString, std::string>> cases{
        {"Ab-c", "__ABC"},
        {"a b", "__A_B"},
        {"St. John's 1881", "__ST_JOHNS_1881"}, // 15 characters: kept whole
        {"Census Ireland 1901", "__CENSUS_IRELAN"},
        {"", "__"},
        {"\t-./", "__"},
        // Folds that are not the letter's own base: ligatures, ß, ð, µ, ¥.
        {QStringLiteral("ŠšŸÿÐÝ"), "__SSYYDY"},
        {QStringLiteral("Œ Æ ß"), "__O_A_S"},
        {QStringLiteral("ðµ¥"), "__OUY"},
        {QStringLiteral("Łódź × ÷ 1881"), "__OD___1881"}, // outside the list: dropped
        // One name typed, read from UTF-8 and Windows-1252 files, and with combining accents.
        {QStringLiteral("Zoë Müller"), "__ZOE_MULLER"},
        {qs("Zo\xc3\xab M\xc3\xbcller"), "__ZOE_MULLER"},
        {qs(toutf8("Zo\xeb M\xfcller", textencoding::windows1252)), "__ZOE_MULLER"},
        {QStringLiteral("Zoe\u0308 Mu\u0308ller"), "__ZOE_MULLER"},
        {qs(toutf8("\x8c\x9a\xa5\xb5", textencoding::windows1252)), "__OSYU"},
    };
    for (const auto& [name, code] : cases)
        EXPECT_EQ(codeforflag(name), code) << name.toStdString();
}

TEST(FindEntryFlag, MatchesYearOrFullDateOfTheCountry)
{
    flagtable t{{"__FREE", "Free", "", 0, ""},
                {"__US_1880", "US 1880", "1880", 0, "USA"},
                {"__C1881", "Census 1881", "1881", 0, "UK"},
                {"__C1891", "Census 1891", "5 APR 1891", 0, "UK"},
                {"__IRL1901", "Ireland 1901", "1901", 0, "Ireland"}};
    const std::tuple<const char*, const char*, std::optional<size_t>> cases[] = {
        {"3 APR 1881", "UK", 2u},          {"5 APR 1891", "UK", 3u},
        {"6 APR 1891", "UK", std::nullopt}, {"31 MAR 1901", "UK", std::nullopt}, // another country's flag
        {"31 MAR 1901", "Ireland", 4u},    {"1 JUN 1880", "USA", 1u},
        {"", "UK", std::nullopt},          {"7 APR 1861", "UK", std::nullopt}};
    t[0].country = "UK"; // a flag of the country without a date is never the entry's
    for (const auto& [date, country, flag] : cases)
        EXPECT_EQ(findentryflag(t, date, country), flag) << date << " " << country;
}

class FlagDefsTest : public ::testing::Test {
protected:
    void SetUp() override
    {
        ASSERT_TRUE(dir.isValid());
        store = settingsstore::onfile(dir.filePath("settings.ini"));
    }
    void define(int n, const QString& code, const QString& name, const QString& date, const QString& country)
    {
        const QString g = "Flags/" + QString::number(n);
        store->write(g, "Code", code);
        store->write(g, "Name", name);
        store->write(g, "Date", date);
        store->write(g, "Country", country);
    }
    QString value(int n, const char* name) const
    {
        return store->read("Flags/" + QString::number(n), name).value_or("<none>");
    }

    QTemporaryDir dir;
    std::unique_ptr<settingsstore> store;
};

TEST_F(FlagDefsTest, DefinitionsAreReadInOrderAndAreNoUse)
{
    flagtable t;
    EXPECT_TRUE(loadflagdefs(*store, t)) << "no groups: no error";
    EXPECT_TRUE(t.empty());
    define(1, "__C1881", QStringLiteral("Census 1881 é"), "1881", "UK");
    define(2, "__C1891", "Census 1891", "5 APR 1891", "UK");
    define(4, "__LATE", "After a gap", "1901", "UK");
    EXPECT_TRUE(loadflagdefs(*store, t));
    ASSERT_EQ(t.size(), 2u) << "reading stops at the first missing group";
    EXPECT_EQ(std::tie(t[0].code, t[0].name, t[0].date, t[0].count, t[0].country),
              std::make_tuple("__C1881", "Census 1881 \xc3\xa9", "1881", 0, "UK"));
    EXPECT_EQ(t[1].date, "5 APR 1891");
    // The loader then notes the same flag met in the file.
    EXPECT_EQ(noteflag(t, "__C1891", "other name"), 1u);
    EXPECT_TRUE(t[1].count == 1 && t[1].name == "Census 1891");
}

// A faulty group is skipped and the store renumbered without it: a code
// too short or holding a space, an empty name, a name of more than one line,
// a short country, a value missing, a date neither a year nor a day.
TEST_F(FlagDefsTest, FaultyGroupsAreSkippedAndTheStoreRenumbered)
{
    define(1, "__", "Short code", "1881", "UK");
    define(2, "__A", "", "1881", "UK");
    define(3, "__B", "B", "1881", "U");
    define(4, "__C", "C", "1881", "UK");
    store->write("Flags/5", "Code", "__D");
    define(6, "__E F", "Space in code", "1881", "UK");
    define(7, "__G", "Line\r\n0 @I1@ INDI", "1881", "UK");
    define(8, "__C1871", "Census 1871", "187", "UK");
    define(9, "__H", "H", "1891", "UK");
    flagtable t;
    EXPECT_FALSE(loadflagdefs(*store, t));
    ASSERT_EQ(t.size(), 2u);
    EXPECT_TRUE(t[0].code == "__C" && t[1].code == "__H");
    EXPECT_EQ(value(1, "Code") + value(2, "Code") + value(2, "Date"), "__C__H1891");
    EXPECT_FALSE(store->groupexists("Flags/3"));
    EXPECT_TRUE(flagloaderrormessage().startsWith("There was an error loading in the flags"));

    flagtable again;
    EXPECT_TRUE(loadflagdefs(*store, again));
    EXPECT_EQ(again.size(), 2u);
}

TEST_F(FlagDefsTest, SaveKeepsOnlyAllocatedFlagsAndClearsStaleGroups)
{
    define(1, "__OLD", "Old", "1841", "UK");
    define(2, "__OLD2", "Old 2", "1851", "UK");
    define(5, "__STALE", "Beyond a gap", "1861", "UK");
    saveflagdefs(*store, {{"__FILEONLY", "Only in the file", "", 0, ""}, {"__C1881", "Census 1881", "3 APR 1881", 7, "UK"}});
    EXPECT_EQ(value(1, "Code") + value(1, "Name") + value(1, "Date") + value(1, "Country"),
              "__C1881Census 18813 APR 1881UK");
    EXPECT_FALSE(store->read("Flags/1", "Count").has_value());
    EXPECT_FALSE(store->groupexists("Flags/2"));
    EXPECT_FALSE(store->groupexists("Flags/5"));

    flagtable back;
    EXPECT_TRUE(loadflagdefs(*store, back));
    ASSERT_EQ(back.size(), 1u);
    EXPECT_EQ(back[0].count, 0);
}

} // namespace
