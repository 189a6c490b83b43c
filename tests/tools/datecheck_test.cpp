// The census date check: sorting the census event dates of a file, the
// proposals, the list texts, the user's edits, the details and the rewrite of
// the accepted changes (with occupation dates cited from the same source).
#include "tools/datecheck.h"

#include "census/censustable.h"
#include "model/loadgedcom.h"
#include "platform/clock.h"
#include "settings/settings.h"
#include "support/goldenfiles.h"
#include "support/testfiles.h"

#include <QDir>
#include <QTemporaryDir>

#include <gtest/gtest.h>

#include <tuple>

using namespace qm;

namespace {

// A family file with one individual per list of census dates (I1, I2 ...),
// each event at "Leeds" aged 30 unless the date list says otherwise.
std::string family(const std::vector<std::vector<std::string>>& people)
{
    std::string out = "0 HEAD\r\n1 CHAR UTF-8\r\n";
    int id = 0;
    for (const auto& dates : people) {
        ++id;
        out += "0 @I" + std::to_string(id) + "@ INDI\r\n1 NAME Person" + std::to_string(id) + " /Smith/\r\n";
        for (const std::string& d : dates)
            out += "1 CENS\r\n2 DATE " + d + "\r\n2 PLAC Leeds\r\n2 AGE 30\r\n";
    }
    return out + "0 TRLR\r\n";
}

std::unique_ptr<gedcomindex> load(const std::string& bytes)
{
    return loadgedcombytes(bytes, flagtable{});
}

// The entry with this date, or null.
const datechange* entry(const std::vector<datechange>& changes, const char* date)
{
    for (const datechange& d : changes)
        if (d.founddate == QLatin1String(date))
            return &d;
    return nullptr;
}

// The proposal for one date under a country: its census row, or -1.
int proposed(const char* date, const char* country = "UK")
{
    auto ix = load(family({{date}}));
    datecheckstate s(*ix, dateorder::dmy);
    s.choosecountry(QLatin1String(country));
    EXPECT_EQ(s.changes().size(), 1u);
    return s.changes().empty() ? -99 : s.changes()[0].censusrow;
}

int row(const char* country, int year)
{
    return findcensusrow(QLatin1String(country), year) + 1;
}

template <class List>
QStringList texts(const List& list)
{
    QStringList out;
    for (const auto& e : list)
        out << e.text;
    return out;
}

} // namespace

TEST(DateCheck, CountryRowsAndCaptions)
{
    const std::pair<const char*, std::pair<int, int>> ranges[] = {
        {"UK", {1, 7}}, {"USA", {8, 22}}, {"Ireland", {23, 24}}, {"Canada", {25, 33}}};
    for (const auto& [country, range] : ranges) {
        const auto r = rowsofcountry(QLatin1String(country));
        EXPECT_EQ(std::make_pair(r.first, r.last), range) << country;
    }
    EXPECT_EQ(countryoption(QStringLiteral("France")), 0);
    EXPECT_EQ(countryoption(QStringLiteral("Canada")), 3);
    // "the UK", "the USA", but plain "Ireland" and "Canada".
    EXPECT_EQ(currentcountrycaption(QStringLiteral("Ireland")),
              QStringLiteral("Census entries found assumed to be for Ireland:"));
    EXPECT_EQ(othercountrycaption(QStringLiteral("Canada")),
              QStringLiteral("Entries assumed to be for countries other than Canada:"));
    EXPECT_EQ(censuschoices().at(26), QStringLiteral("Canada 1851 Census (12 JAN 1852)"));
}

TEST(DateCheck, SortsDatesIntoKindsAndCountsThem)
{
    auto ix = load(family({{"1851", "30 MAR 1851", "1 JUN 1850"}, {"1851", "31 MAR 1901"}, {"1851", "6 JUN 1841"}}));
    const auto changes = analysecensusdates(*ix, QStringLiteral("UK"));
    ASSERT_EQ(changes.size(), 5u);
    // In the order first met: date, count, kind, census row.
    QStringList got;
    for (const datechange& c : changes)
        got << QStringLiteral("%1|%2|%3|%4").arg(c.founddate).arg(c.count).arg(c.datekind).arg(c.censusrow);
    EXPECT_EQ(got, (QStringList{QStringLiteral("1851|3|0|-1"), QStringLiteral("30 MAR 1851|1|1|2"),
                                QStringLiteral("1 JUN 1850|1|2|%1").arg(row("USA", 1850)),
                                QStringLiteral("31 MAR 1901|1|1|%1").arg(row("UK", 1901)), QStringLiteral("6 JUN 1841|1|1|1")}));

    // "31 MAR 1901" is the census of each country that held one on that day.
    for (const char* c : {"UK", "Ireland", "Canada"}) {
        const auto k = analysecensusdates(*ix, QLatin1String(c));
        EXPECT_EQ(entry(k, "31 MAR 1901")->datekind, 1) << c;
        EXPECT_EQ(entry(k, "31 MAR 1901")->censusrow, row(c, 1901)) << c;
    }
    EXPECT_EQ(entry(analysecensusdates(*ix, QStringLiteral("USA")), "31 MAR 1901")->datekind, 2);
    // Under the USA, 1 JUN 1850 is its own census and 30 MAR 1851 another country's.
    const auto usa = analysecensusdates(*ix, QStringLiteral("USA"));
    EXPECT_EQ(entry(usa, "1 JUN 1850")->datekind, 1);
    EXPECT_EQ(entry(usa, "30 MAR 1851")->datekind, 2);
}

TEST(DateCheck, EventsWithoutADateAreLeftOutAndLineEndSpacesIgnored)
{
    auto ix = load("0 HEAD\r\n0 @I1@ INDI\r\n1 CENS\r\n2 PLAC Leeds\r\n1 CENS\r\n2 DATE 1881\r\n"
                   "1 CENS\r\n2 DATE 1881 \t\r\n1 CENS\r\n2 DATE 3 APR 1881 \r\n1 CENS\r\n2 DATE  \r\n0 TRLR\r\n");
    const auto changes = analysecensusdates(*ix, QStringLiteral("UK"));
    ASSERT_EQ(changes.size(), 2u);
    EXPECT_TRUE(changes[0].founddate == QStringLiteral("1881") && changes[0].count == 2);
    EXPECT_TRUE(changes[1].founddate == QStringLiteral("3 APR 1881") && changes[1].datekind == 1);
    EXPECT_EQ(datedetails(*ix, QStringLiteral("1881"), false).size(), 2u);
}

TEST(DateCheck, ProposesTheNearestCensus)
{
    // Calendar dates, whatever their letter case. A year: 30 June of it, so
    // ABT 1851 is nearer the UK's 1851 census (92 days) than Canada's (196
    // days), whichever country is chosen. Far from any census, but within 200
    // years of 1900, the nearest; beyond, or no date, no proposal.
    const struct {
        const char* date;
        const char* country;
        int row;
    } cases[] = {{"30 Mar 1851", "UK", row("UK", 1851)},     {"3 apr 1881", "UK", row("UK", 1881)},
                 {"APR 1881", "UK", row("UK", 1881)},        {"ABT 1851", "UK", row("UK", 1851)},
                 {"ABT 1851", "Canada", row("UK", 1851)},    {"1852", "Canada", row("Canada", 1851)},
                 {"1850", "USA", row("USA", 1850)},          {"ABT 1701", "UK", row("USA", 1790)},
                 {"ABT 2099", "UK", row("USA", 1930)},       {"ABT 1650", "UK", noproposal},
                 {"ABT 2100", "UK", noproposal},             {"about", "UK", noproposal},
                 {"851", "UK", noproposal},                  {"18x1", "UK", noproposal}};
    for (const auto& c : cases)
        EXPECT_EQ(proposed(c.date, c.country), c.row) << c.date << " " << c.country;
}

TEST(DateCheck, TiesGoToTheCensusMetFirstFromTheChosenCountry)
{
    // 2 APR 1871 is the census day of the UK and of Canada: a date one day off
    // is as near to both.
    // From Ireland's or the USA's rows Canada's census is met before the walk
    // wraps round to the UK's. 31 MAR 1901: UK, Ireland and Canada.
    const QDate d(1871, 4, 3), e(1901, 4, 1);
    const std::tuple<QDate, const char*, int> cases[] = {
        {d, "UK", row("UK", 1871)},       {d, "Canada", row("Canada", 1871)},  {d, "Ireland", row("Canada", 1871)},
        {d, "USA", row("Canada", 1871)}, {e, "Ireland", row("Ireland", 1901)}, {e, "USA", row("Ireland", 1901)}};
    for (const auto& [date, country, census] : cases)
        EXPECT_EQ(nearestcensus(date, QLatin1String(country)), census) << country;
}

TEST(DateCheck, ListTexts)
{
    auto ix = load(family({{"1851", "1851", "1851", "ABT 1650", "1 JUN 1850", "30 MAR 1851"}, {"ABT 1650"}}));
    datecheckstate s(*ix, dateorder::dmy);
    s.choosecountry(QStringLiteral("UK"));
    const datelists l = s.lists();
    EXPECT_EQ(texts(l.unknown),
              (QStringList{QStringLiteral("1851 (3 occurences) : [Suggest replacing with UK 1851 Census date 30 MAR 1851]"),
                           QStringLiteral("ABT 1650 (2 occurences) : [Quillmark can not suggest a date to replace this with]")}));
    EXPECT_EQ(texts(l.other), QStringList{QStringLiteral("1 JUN 1850 (1 occurence) : USA 1850 Census")});
    EXPECT_EQ(texts(l.current), QStringList{QStringLiteral("30 MAR 1851 (1 occurence) : UK 1851 Census")});
    EXPECT_TRUE(l.unknown[1].item == 1 && l.other[0].item == 2 && l.canchange);

    // Nothing to propose: nothing to change.
    auto none = load(family({{"ABT 1650", "6 JUN 1841"}}));
    datecheckstate t(*none, dateorder::dmy);
    t.choosecountry(QStringLiteral("UK"));
    EXPECT_FALSE(t.lists().canchange);
}

TEST(DateCheck, EditsAndTheirUndoingByChoosingTheCountryAgain)
{
    auto ix = load(family({{"1851", "1 JUN 1850", "6 JUN 1841"}}));
    datecheckstate s(*ix, dateorder::dmy);
    s.choosecountry(QStringLiteral("UK"));

    EXPECT_EQ(s.edit(0, suggestion::refuse), QString());
    EXPECT_TRUE(s.changes()[0].censusrow == refusedchange && s.changes()[0].newdate.isEmpty());
    EXPECT_EQ(s.lists().unknown[0].text,
              QStringLiteral("1851 (1 occurence) : [User has requested Quillmark not to replace this date]"));
    EXPECT_FALSE(s.lists().canchange);
    // Agreeing afterwards does not bring the proposal back...
    s.edit(0, suggestion::agree);
    EXPECT_EQ(s.changes()[0].censusrow, refusedchange);
    // ... choosing the country again does.
    s.choosecountry(QStringLiteral("UK"));
    EXPECT_EQ(s.changes()[0].newdate, QStringLiteral("30 MAR 1851"));

    // Refusing a recognised date changes nothing.
    s.edit(2, suggestion::refuse);
    EXPECT_TRUE(s.changes()[2].censusrow == 1 && s.changes()[2].datekind == 1);

    // "Change to:" needs a census, and moves a recognised date to the unknown ones.
    EXPECT_EQ(s.edit(1, suggestion::changeto, 0), choosecensusmessage());
    EXPECT_EQ(s.changes()[1].datekind, 2);
    EXPECT_EQ(s.edit(1, suggestion::changeto, 2), QString());
    EXPECT_TRUE(s.changes()[1].datekind == 0 && s.changes()[1].applies());
    const datelists l = s.lists();
    EXPECT_TRUE(l.unknown.size() == 2u && l.other.empty());
    EXPECT_EQ(l.unknown[1].text,
              QStringLiteral("1 JUN 1850 (1 occurence) : [Suggest replacing with UK 1851 Census date 30 MAR 1851]"));
}

TEST(DateCheck, Details)
{
    const std::string file = "0 HEAD\r\n1 CHAR UTF-8\r\n"
                             "0 @I1@ INDI\r\n1 NAME Zoe /Adams/\r\n1 CENS\r\n2 DATE 1851\r\n2 PLAC York\r\n2 AGE 3\r\n"
                             "0 @I2@ INDI\r\n1 NAME Al /Brown/\r\n1 CENS\r\n2 DATE 1851\r\n2 AGE 40\r\n"
                             "1 CENS\r\n2 DATE 1851\r\n2 PLAC York\r\n"
                             "1 CENS\r\n2 DATE 1861\r\n2 PLAC Hull\r\n1 FAMS @F1@\r\n"
                             "0 @I3@ INDI\r\n1 NAME Cy /Adams/\r\n1 CENS\r\n2 DATE 1851\r\n2 PLAC bath\r\n2 AGE 7\r\n"
                             "1 FAMS @F1@\r\n"
                             "0 @I4@ INDI\r\n1 NAME Ed /\xC3\x93 Neill/\r\n1 CENS\r\n2 DATE 1851\r\n2 PLAC \xC3\x93mey\r\n"
                             "0 @F1@ FAM\r\n1 HUSB @I2@\r\n1 WIFE @I3@\r\n1 CENS\r\n2 DATE 1851\r\n2 PLAC York\r\n"
                             "0 @F2@ FAM\r\n1 CENS\r\n2 DATE 1851\r\n"
                             "0 TRLR\r\n";
    auto ix = load(file);
    datecheckstate s(*ix, dateorder::dmy);
    s.choosecountry(QStringLiteral("UK"));
    // The families' census events are counted and listed with the individuals'.
    EXPECT_EQ(s.changes()[0].count, 7);
    const auto people = s.details(0, false);
    ASSERT_EQ(people.size(), 7u);
    const QString name1 = qs(ix->people[0].name), name2 = qs(ix->people[1].name), name3 = qs(ix->people[2].name);
    EXPECT_EQ(texts(people).mid(0, 6), (QStringList{name3 + QStringLiteral(" 7 bath"), name1 + QStringLiteral(" 3 York"),
                                  name2 + QStringLiteral("  York"), // no age
                                  name2 + QStringLiteral(" 40 <no place recorded>"),
                                  QStringLiteral("Family F2 <no place recorded>"),
                                  QStringLiteral("Family of ") + name2 + QStringLiteral(" and ") + name3
                                      + QStringLiteral(" York")}));
    EXPECT_TRUE(people[0].person == 2 && people[4].person == -1 && people[6].person == 3);

    // Letters with accents among their plain letters, not after Z.
    EXPECT_EQ(texts(s.details(0, true)), (QStringList{QStringLiteral("<no place recorded> (in 2 census events)"),
                                       QStringLiteral("bath (in 1 census events)"),
                                       QString::fromUtf8("\xC3\x93mey (in 1 census events)"),
                                       QStringLiteral("York (in 3 census events)")}));
    EXPECT_TRUE(s.details(9, true).empty());
}

// The accepted replacements written to the file, with the occupation dates
// that cite the census event's source (whatever lines come between), and
// only those of an individual with that census event: tools/datechanges.ged,
// from tools/datechanges_input.ged (a date refused, another country's, one
// with a space at the line end, a family's event, an occupation citing another
// source and one of an individual without the census event).
TEST(DateCheck, MakesTheChangesWithLinkedOccupationDates)
{
    QTemporaryDir dir;
    ASSERT_TRUE(dir.isValid());
    const QString path = dir.filePath(QStringLiteral("family.ged"));
    qmtest::writefile(path, qmtest::readfile(QStringLiteral(QM_TESTDATA_DIR "/tools/datechanges_input.ged")));
    loadresult r = loadgedcom(path, flagtable{});
    ASSERT_TRUE(r.index);
    settings s = defaultsettings();
    s.backupfolder = dir.filePath(QStringLiteral("backups"));
    QDir().mkpath(s.backupfolder);
    s.logpath = dir.filePath(QStringLiteral("censuslog.txt"));
    s.keeplog = true;
    setclockfortests(QDateTime(QDate(2026, 12, 6), QTime(10, 0, 0)));

    datecheckstate st(*r.index, dateorder::dmy);
    st.choosecountry(QStringLiteral("UK"));
    st.edit(3, suggestion::refuse); // 1881: kept as it is
    const saveoutcome out = makedatechanges(*r.index, s, st.changes());
    setclockfortests(QDateTime());
    ASSERT_TRUE(out.saved()) << out.message.toStdString();
    EXPECT_EQ(out.rewrite.censusdateschanged, 3); // one line ended with a space; one a family's
    EXPECT_EQ(out.rewrite.occdateschanged, 1);
    EXPECT_TRUE(QFile::exists(out.backuppath));
    EXPECT_TRUE(qmtest::matchesgolden(QStringLiteral("tools/datechanges.ged"), qmtest::readfile(path)));
    const std::string log = qmtest::readfile(s.logpath);
    EXPECT_NE(log.find("Changed 3 census events dated ABT 1851 to 30 MAR 1851"), std::string::npos) << log;
    EXPECT_EQ(log.find("1881"), std::string::npos) << log;

    // A file changed since it was read is left alone, with the check's own message.
    const std::string now = qmtest::readfile(path);
    qmtest::writefile(path, now + "\r\n");
    const saveoutcome late = makedatechanges(*r.index, s, st.changes());
    EXPECT_EQ(late.status, savestatus::changed);
    EXPECT_EQ(late.message, datesnotchangedmessage(path));
    EXPECT_EQ(qmtest::readfile(path), now + "\r\n");
}
