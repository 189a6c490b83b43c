#include "tools/datecheck.h"

#include "census/censustable.h"
#include "flags/flagalloc.h"
#include "model/gedcomindex.h"
#include "model/labelorder.h"
#include "platform/encoding.h"
#include "settings/settings.h"
#include "writer/openfile.h"

#include <QDir>

#include <algorithm>
#include <cstdlib>
#include <string>
#include <string_view>
#include <unordered_map>

namespace qm {

namespace {

int rowcount()
{
    return static_cast<int>(censustable().size());
}

const censusdef& rowdef(int row)
{
    return censustable()[static_cast<size_t>(row - 1)];
}

// The official days of the table as UTF-8 (compared with the index's texts)
// and as calendar dates.
const std::vector<std::string>& rowdates()
{
    static const std::vector<std::string> dates = [] {
        std::vector<std::string> out;
        for (const censusdef& c : censustable())
            out.push_back(u8(c.date));
        return out;
    }();
    return dates;
}

const std::vector<QDate>& rowdays()
{
    static const std::vector<QDate> days = [] {
        std::vector<QDate> out;
        for (const censusdef& c : censustable())
            out.push_back(recognisedate(c.date, dateorder::dmy).value_or(QDate()));
        return out;
    }();
    return days;
}

// The date of a census event as the rewrite reads it: without the spaces and
// tabs that may end its line, so that every date listed can be replaced.
std::string_view eventdate(std::string_view d)
{
    while (!d.empty() && (d.back() == ' ' || d.back() == '\t'))
        d.remove_suffix(1);
    return d;
}

// Every census event of the file, the individuals' in people order, then the
// families' (the rewrite changes the dates of both): f(date, place, age,
// person), person being the individual's position in people or, for a family,
// -1 - its position in familycensus.
template <typename F>
void foreachcensusevent(const gedcomindex& index, F&& f)
{
    for (size_t k = 0; k < index.people.size(); ++k)
        for (const censusrec& c : index.people[k].census)
            f(eventdate(c.date), c.place, c.age, static_cast<int32_t>(k));
    for (size_t k = 0; k < index.familycensus.size(); ++k) {
        const familycensusrec& c = index.familycensus[k];
        f(eventdate(c.date), c.place, std::string_view(), -1 - static_cast<int32_t>(k));
    }
}

// The names a family's census event is listed under: "Family of " + its
// spouses' names joined by " and ", or "Family F" + its number without them.
std::unordered_map<int32_t, QString> familynames(const gedcomindex& index, const std::vector<int32_t>& families)
{
    std::unordered_map<int32_t, QString> names;
    for (int32_t f : families)
        names.emplace(f, QString());
    for (const personrec& p : index.people)
        for (int32_t f : p.fams)
            if (const auto it = names.find(f); it != names.end())
                it->second += (it->second.isEmpty() ? QStringLiteral("Family of ") : QStringLiteral(" and "))
                    + qs(p.name);
    for (auto& [f, name] : names)
        if (name.isEmpty())
            name = QStringLiteral("Family F") + QString::number(f);
    return names;
}

// The row after `row`, round from the last to the first.
int nextrow(int row)
{
    return row == rowcount() ? 1 : row + 1;
}

// The census whose official day is exactly `date`, searched from the first row
// of the chosen country; -1 when none.
int officialrow(std::string_view date, int start)
{
    const std::vector<std::string>& dates = rowdates();
    int row = start;
    do {
        if (dates[static_cast<size_t>(row - 1)] == date)
            return row;
        row = nextrow(row);
    } while (row != start);
    return noproposal;
}

QString occurences(int32_t count)
{
    return QStringLiteral(" (") + QString::number(count) + QStringLiteral(" occurence")
        + (count < 2 ? QStringLiteral(")") : QStringLiteral("s)"));
}

QString censusname(int row)
{
    const censusdef& c = rowdef(row);
    return c.country + QLatin1Char(' ') + QString::number(c.year) + QStringLiteral(" Census");
}

// "the UK", "the USA", but "Ireland", "Canada".
QString countrywords(const QString& country)
{
    switch (countryoption(country)) {
    case 2:
        return QStringLiteral("Ireland");
    case 3:
        return QStringLiteral("Canada");
    case 1:
        return QStringLiteral("the USA");
    default:
        return QStringLiteral("the UK");
    }
}

// In the order of every list of people ("Ó Súilleabháin" among the O's).
void sortdetails(std::vector<detailentry>& list)
{
    std::vector<detailentry> sorted;
    sorted.reserve(list.size());
    for (size_t k : labelorder(list.size(), [&list](size_t k) { return list[k].text; }))
        sorted.push_back(std::move(list[k]));
    list = std::move(sorted);
}

} // namespace

int countryoption(const QString& country)
{
    const qsizetype i = flagcountries().indexOf(country);
    return i < 0 ? 0 : static_cast<int>(i);
}

countryrows rowsofcountry(const QString& country)
{
    const QString name = flagcountries()[countryoption(country)];
    countryrows r{0, -1};
    for (int row = 1; row <= rowcount(); ++row) {
        if (rowdef(row).country != name)
            continue;
        if (r.first == 0)
            r.first = row;
        r.last = row;
    }
    return r;
}

QString currentcountrycaption(const QString& country)
{
    return QStringLiteral("Census entries found assumed to be for ") + countrywords(country) + QLatin1Char(':');
}

QString othercountrycaption(const QString& country)
{
    return QStringLiteral("Entries assumed to be for countries other than ") + countrywords(country)
        + QLatin1Char(':');
}

std::vector<datechange> analysecensusdates(const gedcomindex& index, const QString& country)
{
    const countryrows range = rowsofcountry(country);
    std::vector<datechange> out;
    // Position in `out` of each date met, by its text in the index.
    std::unordered_map<std::string_view, size_t> seen;
    foreachcensusevent(index, [&](std::string_view date, std::string_view, std::string_view, int32_t) {
        if (date.empty())
            return;
        const auto [it, added] = seen.try_emplace(date, out.size());
        if (!added) {
            ++out[it->second].count;
            return;
        }
        datechange d;
        d.founddate = qs(date);
        d.count = 1;
        d.censusrow = officialrow(date, range.first);
        d.datekind = d.censusrow == noproposal ? 0 : range.contains(d.censusrow) ? 1 : 2;
        out.push_back(std::move(d));
    });
    return out;
}

std::optional<QDate> proposaldate(const QString& founddate, dateorder order)
{
    if (auto d = recognisedate(founddate, order))
        return d;
    if (founddate.size() < 4)
        return std::nullopt;
    const QStringView last = QStringView(founddate).right(4);
    for (QChar c : last)
        if (c < u'0' || c > u'9')
            return std::nullopt;
    const int year = last.toInt();
    if (std::abs(1900 - year) >= 200)
        return std::nullopt;
    return QDate(year, 6, 30);
}

int nearestcensus(const QDate& d, const QString& country)
{
    const int start = rowsofcountry(country).first;
    const std::vector<QDate>& days = rowdays();
    int best = noproposal;
    qint64 bestdistance = 0;
    int row = start;
    do {
        const qint64 distance = std::abs(d.daysTo(days[static_cast<size_t>(row - 1)]));
        if (best == noproposal || distance < bestdistance) {
            best = row;
            bestdistance = distance;
        }
        row = nextrow(row);
    } while (row != start);
    return best;
}

namespace {

// The census proposed for an unrecognised date, or noproposal.
int proposedcensus(const QString& founddate, const QString& country, dateorder order)
{
    const auto day = proposaldate(founddate, order);
    return day ? nearestcensus(*day, country) : noproposal;
}

} // namespace

int censusofdate(std::string_view date, const QString& country, dateorder order)
{
    date = eventdate(date);
    if (date.empty())
        return noproposal;
    if (const int row = officialrow(date, rowsofcountry(country).first); row != noproposal)
        return row;
    return proposedcensus(qs(date), country, order);
}

void proposecensusdates(std::vector<datechange>& changes, const QString& country, dateorder order)
{
    for (datechange& d : changes) {
        if (d.datekind != 0)
            continue;
        d.newdate.clear();
        d.censusrow = proposedcensus(d.founddate, country, order);
        if (d.censusrow != noproposal)
            d.newdate = rowdef(d.censusrow).date;
    }
}

QString datelisttext(const datechange& d)
{
    QString text = d.founddate + occurences(d.count);
    if (d.datekind != 0) {
        if (d.censusrow >= 1 && d.censusrow <= rowcount())
            text += QStringLiteral(" : ") + censusname(d.censusrow);
        return text;
    }
    if (d.censusrow >= 1 && d.censusrow <= rowcount())
        text += QStringLiteral(" : [Suggest replacing with ") + censusname(d.censusrow) + QStringLiteral(" date ")
            + rowdef(d.censusrow).date + QLatin1Char(']');
    else if (d.censusrow == refusedchange)
        text += QStringLiteral(" : [User has requested Quillmark not to replace this date]");
    else
        text += QStringLiteral(" : [Quillmark can not suggest a date to replace this with]");
    return text;
}

datelists makedatelists(const std::vector<datechange>& changes)
{
    datelists out;
    for (size_t k = 0; k < changes.size(); ++k) {
        const datechange& d = changes[k];
        datelistentry e{datelisttext(d), static_cast<int>(k)};
        if (d.datekind == 2) {
            out.other.push_back(std::move(e));
        } else if (d.datekind == 1) {
            out.current.push_back(std::move(e));
        } else {
            out.unknown.push_back(std::move(e));
            if (d.censusrow >= 1)
                out.canchange = true;
        }
    }
    return out;
}

QStringList censuschoices()
{
    QStringList out;
    for (const censusdef& c : censustable())
        out << c.country + QLatin1Char(' ') + QString::number(c.year) + QStringLiteral(" Census (") + c.date
                + QLatin1Char(')');
    return out;
}

std::vector<detailentry> datedetails(const gedcomindex& index, const QString& founddate, bool places)
{
    const std::string date = u8(founddate);
    static const QString noplace = QStringLiteral("<no place recorded>");
    std::vector<detailentry> out;
    if (!places) {
        std::vector<int32_t> families;
        for (const familycensusrec& c : index.familycensus)
            if (eventdate(c.date) == date)
                families.push_back(c.family);
        const std::unordered_map<int32_t, QString> names = familynames(index, families);
        foreachcensusevent(index, [&](std::string_view d, std::string_view place, std::string_view age, int32_t k) {
            if (d != date)
                return;
            const QString placetext = place.empty() ? noplace : qs(place);
            if (k >= 0)
                out.push_back({qs(index.people[static_cast<size_t>(k)].name) + QLatin1Char(' ') + qs(age)
                                   + QLatin1Char(' ') + placetext,
                               k});
            else
                out.push_back({names.at(index.familycensus[static_cast<size_t>(-1 - k)].family) + QLatin1Char(' ')
                                   + placetext,
                               -1});
        });
    } else {
        std::vector<std::pair<std::string_view, int32_t>> counted;
        std::unordered_map<std::string_view, size_t> at;
        foreachcensusevent(index, [&](std::string_view d, std::string_view place, std::string_view, int32_t) {
            if (d != date)
                return;
            const auto [it, added] = at.try_emplace(place, counted.size());
            if (added)
                counted.emplace_back(place, 0);
            ++counted[it->second].second;
        });
        for (const auto& [place, n] : counted)
            out.push_back({(place.empty() ? noplace : qs(place)) + QStringLiteral(" (in ") + QString::number(n)
                               + QStringLiteral(" census events)"),
                           -1});
    }
    sortdetails(out);
    return out;
}

datecheckstate::datecheckstate(const gedcomindex& index, dateorder order) : index_(index), order_(order) {}

void datecheckstate::choosecountry(const QString& country)
{
    country_ = flagcountries()[countryoption(country)];
    changes_ = analysecensusdates(index_, country_);
    proposecensusdates(changes_, country_, order_);
}

QString datecheckstate::edit(int k, suggestion s, int row)
{
    if (k < 0 || k >= static_cast<int>(changes_.size()))
        return {};
    datechange& d = changes_[static_cast<size_t>(k)];
    switch (s) {
    case suggestion::agree:
        break;
    case suggestion::refuse:
        if (d.datekind == 0) {
            d.censusrow = refusedchange;
            d.newdate.clear();
        }
        break;
    case suggestion::changeto:
        if (row < 1 || row > rowcount())
            return choosecensusmessage();
        d.datekind = 0;
        d.censusrow = row;
        d.newdate = rowdef(row).date;
        break;
    }
    return {};
}

std::vector<detailentry> datecheckstate::details(int k, bool places) const
{
    if (k < 0 || k >= static_cast<int>(changes_.size()))
        return {};
    return datedetails(index_, changes_[static_cast<size_t>(k)].founddate, places);
}

rewriterequest datechangerequest(const std::vector<datechange>& changes)
{
    rewriterequest rq;
    rq.mode = rewritemode::censusdates;
    rq.datechanges = changes;
    return rq;
}

namespace {
// Another program's change stops the changes with a message of their own.
saveoutcome withdatesmessage(saveoutcome out, const QString& gedcomfile)
{
    if (out.status == savestatus::changed)
        out.message = datesnotchangedmessage(gedcomfile);
    return out;
}
} // namespace

saveoutcome makedatechanges(const gedcomindex& index, const settings& s, const std::vector<datechange>& changes)
{
    return withdatesmessage(savechange(index, s, datechangerequest(changes)), index.gedcomfile);
}

saveoutcome makedatechanges(openfile& file, const std::vector<datechange>& changes)
{
    return withdatesmessage(file.save(datechangerequest(changes)), file.index()->gedcomfile);
}

QString makechangesquestion()
{
    return QStringLiteral("Are you sure you want to make the changes to dates as specfied in the 'Unknown census "
                          "dates' list? Please note that this will also change any matching dates for occupation "
                          "records linked to the same source. Click No if you don't want to change dates.");
}

QString datesnotchangedmessage(const QString& gedcomfile)
{
    return QDir::toNativeSeparators(gedcomfile)
        + QStringLiteral(" has been modified by another application. Dates will not be changed as a precaution to "
                         "ensure there is no data loss. This form will now close and the file will be reloaded.");
}

QString choosecensusmessage()
{
    return QStringLiteral("You must choose a census date from the 'change to' drop-down list");
}

} // namespace qm
