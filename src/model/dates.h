#pragma once
// Dates: recognising the dates users type and families files hold, writing
// dates the GEDCOM way, and turning a GEDCOM date into the words shown for an
// individual ("on 3 Mar 1851", "in 1851 (approx.)") with the ages the
// individual could have at a census.
//
// Recognised texts (letter case never matters, surrounding spaces ignored):
//   day month year    "4 APR 1881", "04 april 1881", "4-Apr-1881", "4 Sept. 1881"
//   month day year    "April 4 1881", "Apr 4, 1881"
//   month year        "APR 1881" (the first of the month)
//   numeric           "4/4/1881", "04.04.1881", "4-4-1881": day, month and year in
//                     the order of the user's locale; "1881-04-04" (year first,
//                     four digits) is read as year-month-day under any locale.
// Month names are English: the full name or any beginning of it of at least
// three letters. The year has four digits: "4/4/81" is not a date, since a
// family historian's years span centuries. Anything else ("ABT 1881", "1881",
// "31 FEB 1881", "4 Apr") is not a date.

#include <QDate>
#include <QLocale>
#include <QString>
#include <QStringView>
#include <QTime>

#include <optional>

namespace qm {

struct personrec;

enum class dateorder { dmy, mdy, ymd };

// The order of day, month and year in the locale's short date format.
dateorder localedateorder(const QLocale& locale = QLocale());

std::optional<QDate> recognisedate(QStringView text, dateorder order);
// Under the order of the default locale (QLocale()).
std::optional<QDate> recognisedate(QStringView text);

// "JAN" ... "DEC" for 1 ... 12, empty otherwise.
QString englishmonth(int month);

// "04 APR 1881": two-digit day, English month abbreviation, four-digit year,
// whatever the locale. Also the form of change stamps and citation entry dates.
QString formatgedcomdate(const QDate& date);
// "SEP 1850".
QString formatgedcommonth(const QDate& date);
// "14:05:09" (24-hour), the time of change stamps.
QString formatgedcomtime(const QTime& time);

// Age in whole years on census day of someone born on birth. Not lowered below
// the plain difference of the years when that is 0 or less.
int completedyears(const QDate& birth, const QDate& census);

struct datephraseresult {
    QString phrase;            // "on 3 Mar 1851", "between 1850 and 1852", "in 1851 (approx.)"
    bool agecomputed = false;
    QString agephrase;         // " and in this census would be aged 29 or 30 (approx.)", or empty
    int earliestyear = -9999;  // years of the earliest and latest birth dates the date allows;
    int latestyear = 9999;     // -9999 and 9999 when no age could be worked out
};

// The words for a GEDCOM date and the possible ages at the census day. Ages
// come only from plain, ABT, EST and CAL dates, and only with a census day.
datephraseresult datephrase(QStringView date, const std::optional<QDate>& census, dateorder order);
// census: the text of the census date box, recognised under the default locale.
datephraseresult datephrase(QStringView date, const QString& censusdatetext);

// Only the years of datephrase, for filtering long lists of individuals.
struct datephraseyears {
    bool agecomputed = false;
    int earliestyear = -9999;
    int latestyear = 9999;
};
datephraseyears dateyears(QStringView date, const std::optional<QDate>& census, dateorder order);

// The line shown for an individual: "John Smith was born in 1851 (approx.) in
// Leeds and in this census would be aged 29 or 30 (approx.)." Empty when the
// individual has neither birth date nor birth place.
QString personinfo(const personrec& person, const std::optional<QDate>& census, dateorder order);
QString personinfo(const personrec& person, const QString& censusdatetext);

// The days a GEDCOM date allows. Plain, ABT, EST and CAL dates: the days of
// their day, month or year, as their age phrase counts them. BET ... AND and
// FROM ... TO: from the first date's first day to the second date's last.
// AFT: the days after the date; BEF: the days before it; FROM or TO alone: from
// or up to the date. An end the date leaves open is empty. Nothing for a date
// these words do not give (a date phrase, no four-digit year, BET without AND).
struct dayspan {
    std::optional<QDate> earliest, latest;
    bool approximate = false; // ABT, EST or CAL
    bool bounded = false;     // BET, AFT, BEF, FROM or TO: the date states bounds, not a day
};
std::optional<dayspan> datespan(QStringView date, dateorder order);

struct datecheck {
    bool isdate = false;
    // The text the census date box is to hold instead of what was typed, when
    // that differs: the official census date when the typed one is that day,
    // otherwise the typed date written "04 APR 1881".
    std::optional<QString> newtext;
};

// Checks and normalises the census date text against the official date of the
// chosen census (empty when none is chosen).
datecheck validdate(const QString& text, const QString& officialdate, dateorder order);
datecheck validdate(const QString& text, const QString& officialdate);

} // namespace qm
