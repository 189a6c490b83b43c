#pragma once
// The census date check: every distinct date of the census events in a family
// file, sorted into the official days of the chosen country's censuses, the
// official days of other countries' censuses, and dates that are no census day;
// for each of the last the nearest census day is proposed. The user may agree,
// refuse or pick another census for each date; the accepted replacements are
// written by the rewrite in its census-dates mode (which also changes matching
// occupation dates cited from the same source).
//
// Census rows are numbered from 1 (row 1 is censustable()[0]), as in the lists
// and the census combo box.

#include "model/dates.h"
#include "writer/censusentry.h"
#include "writer/saveroad.h"

#include <QString>
#include <QStringList>

#include <cstdint>
#include <optional>
#include <string_view>
#include <vector>

namespace qm {

struct gedcomindex;
class openfile;
struct settings;

// censusrow of an unrecognised date for which no census can be proposed, and
// of one whose change the user refused.
constexpr int noproposal = -1;
constexpr int refusedchange = -2;

// Option of the "Country" setting: "USA" 1, "Ireland" 2, "Canada" 3, anything else 0 ("UK").
int countryoption(const QString& country);

// First and last census rows of a country (1-based, inclusive); an unknown
// country has the UK's rows.
struct countryrows {
    int first = 1;
    int last = 7;
    bool contains(int row) const { return row >= first && row <= last; }
};
countryrows rowsofcountry(const QString& country);

// "Census entries found assumed to be for the UK:" / "... for Ireland:".
QString currentcountrycaption(const QString& country);
// "Entries assumed to be for countries other than the UK:".
QString othercountrycaption(const QString& country);

// Every distinct census event date, of individuals and of families (the
// rewrite changes both), with its count and the census whose
// official day it is (searched from the country's first row, wrapping round),
// before any proposal. A date is read without the spaces that may end its
// line (the rewrite reads it so); events without a date are left out.
std::vector<datechange> analysecensusdates(const gedcomindex& index, const QString& country);

// The day a proposal is measured from: the date itself when it is a calendar
// date, else 30 June of the year its last four characters give when that year
// is within 200 years of 1900; none otherwise.
std::optional<QDate> proposaldate(const QString& founddate, dateorder order);
// The census (row) whose day is fewest days from d, rows walked from the
// country's first row round the table; the first met wins a tie.
int nearestcensus(const QDate& d, const QString& country);
// The census (row) whose official day a census event date is, exactly as the
// analysis finds it (from the country's first row round the table), else the
// census proposed for it; noproposal when neither. The date is read without
// the spaces that may end its line.
int censusofdate(std::string_view date, const QString& country, dateorder order);
// Fills the proposal of every unrecognised date.
void proposecensusdates(std::vector<datechange>& changes, const QString& country, dateorder order);

// The text of an entry in its list, such as
// "1851 (3 occurences) : [Suggest replacing with UK 1851 Census date 30 MAR 1851]".
QString datelisttext(const datechange& d);

// The three lists as they are shown: each entry's text and its position in the changes.
struct datelistentry {
    QString text;
    int item = -1;
};
struct datelists {
    std::vector<datelistentry> unknown; // changelst: datekind 0
    std::vector<datelistentry> current; // currentlst: datekind 1
    std::vector<datelistentry> other;   // countrylst: datekind 2
    bool canchange = false;             // some unrecognised date has a proposal
};
datelists makedatelists(const std::vector<datechange>& changes);

// Texts of the census combo box, row 1 first: "UK 1851 Census (30 MAR 1851)".
QStringList censuschoices();

// The details of one date: each census event with it (individual's name, age,
// place; person = position in `people`; a family's event as "Family of " + its
// spouses' names and the place, person -1), or each distinct place with the
// number of its events. In the order of every list of people.
struct detailentry {
    QString text;
    int32_t person = -1;
};
std::vector<detailentry> datedetails(const gedcomindex& index, const QString& founddate, bool places);

enum class suggestion { agree = 0, refuse = 1, changeto = 2 };

// The check's working state: the chosen country and the changes found for it,
// with the user's edits, until a country is chosen again.
class datecheckstate {
public:
    explicit datecheckstate(const gedcomindex& index, dateorder order = localedateorder());

    // Analyses the file for the country and proposes replacements; discards every edit.
    void choosecountry(const QString& country);
    const QString& country() const { return country_; }
    const std::vector<datechange>& changes() const { return changes_; }
    datelists lists() const { return makedatelists(changes_); }

    // Applies the edit frame's choice to entry k; row is the census chosen with
    // "Change to:" (0 when none). Returns "" or the message for the user.
    QString edit(int k, suggestion s, int row = 0);
    std::vector<detailentry> details(int k, bool places) const;

private:
    const gedcomindex& index_;
    dateorder order_;
    QString country_;
    std::vector<datechange> changes_;
};

// The rewrite request of "Make Suggested Changes".
rewriterequest datechangerequest(const std::vector<datechange>& changes);
// Writes the accepted replacements through the save road.
saveoutcome makedatechanges(const gedcomindex& index, const settings& s, const std::vector<datechange>& changes);
saveoutcome makedatechanges(openfile& file, const std::vector<datechange>& changes);

// Question asked before the changes are made.
QString makechangesquestion();
// The family file changed since it was read: nothing is written.
QString datesnotchangedmessage(const QString& gedcomfile);
// "Change to:" without a census chosen.
QString choosecensusmessage();

} // namespace qm
