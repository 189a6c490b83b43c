#include "tools/coverage.h"

#include "census/censustable.h"
#include "model/dayrange.h"
#include "model/labelorder.h"
#include "model/placecountry.h"
#include "platform/encoding.h"
#include "tools/datecheck.h"

#include <algorithm>
#include <unordered_map>

namespace qm {

namespace {

// The longest life taken for granted when only one end of it is known.
constexpr daynumber lifespan = 40177; // 110 years

// The census date check's rows are numbered from 1.
const censusdef& censusofrow(int row)
{
    return censustable()[static_cast<size_t>(row - 1)];
}

std::string_view withoutendspaces(std::string_view s)
{
    while (!s.empty() && (s.back() == ' ' || s.back() == '\t'))
        s.remove_suffix(1);
    return s;
}

// What a census or residence date tells, worked out once per distinct date.
struct eventdating {
    int8_t column = -1; // the chosen country's census the date is dated as, -1 none
    // The country whose census day the date is, when that census is another
    // country's: the event's country when its place tells none.
    countrycode daycountry = countrycode::unknown;
    bool alive = false;             // the date tells a time the individual was alive
    daynumber bornby = nodayafter;  // born on or before this day
    daynumber diedafter = nodaybefore; // died on or after this day
    uint32_t periodcolumns = 0;     // FROM x TO y: the columns whose day the period surely covers
};

class coveragerun {
public:
    coveragerun(const gedcomindex& index, const QString& country, bool residence, dateorder order)
        : index_(index), residence_(residence), order_(order)
    {
        const countryrows rows = rowsofcountry(country);
        country_ = censusofrow(rows.first).country;
        code_ = countryofname(country_);
        for (int row = rows.first; row <= rows.last; ++row) {
            const censusdef& c = censusofrow(row);
            out_.censusrows.push_back(row - 1);
            days_.push_back(readdayrange(u8(c.date)).first);
        }
        rowfirst_ = rows.first;
        out_.country = country_;
    }

    censuscoverage run();

private:
    const eventdating& dating(std::string_view date);
    eventdating workoutdating(std::string_view date);
    countrycode countryof(std::string_view place);
    int columnofyear(int year) const;
    void person(const personrec& p, coveragecell* cells, int16_t& birthyear);

    const gedcomindex& index_;
    bool residence_;
    dateorder order_;
    QString country_;
    countrycode code_ = countrycode::uk;
    int rowfirst_ = 1;
    std::vector<daynumber> days_; // census day of each column
    censuscoverage out_;
    std::unordered_map<std::string_view, eventdating> datings_;
    std::unordered_map<std::string_view, countrycode> countries_;
    std::string_view lastplace_;
    countrycode lastcountry_ = countrycode::unknown;
};

int coveragerun::columnofyear(int year) const
{
    for (size_t c = 0; c < out_.censusrows.size(); ++c)
        if (censustable()[static_cast<size_t>(out_.censusrows[c])].year == year)
            return static_cast<int>(c);
    return -1;
}

eventdating coveragerun::workoutdating(std::string_view date)
{
    eventdating d;
    const dayrange r = readdayrange(date);
    if (r.valid) {
        d.alive = true;
        d.bornby = r.period ? r.fromlast : r.last;
        d.diedafter = r.period ? r.tofirst : r.first;
        if (r.period)
            for (size_t c = 0; c < days_.size(); ++c)
                if (days_[c] >= r.fromlast && days_[c] <= r.tofirst)
                    d.periodcolumns |= 1u << c;
    }
    // A period is no census day, though its last year may be near one.
    const int row = r.period ? noproposal : censusofdate(date, country_, order_);
    if (row == noproposal)
        return d;
    const censusdef& census = censusofrow(row);
    if (census.country == country_) {
        d.column = static_cast<int8_t>(row - rowfirst_);
        return d;
    }
    // Another country's census: C's census of the same year, the table's
    // year for that census's own day, else the year of the date.
    const bool officialday = u8(census.date) == date;
    int year = census.year;
    if (officialday) {
        d.daycountry = countryofname(census.country);
    } else {
        const auto day = proposaldate(qs(date), order_);
        year = day ? day->year() : 0;
    }
    d.column = static_cast<int8_t>(columnofyear(year));
    return d;
}

const eventdating& coveragerun::dating(std::string_view date)
{
    date = withoutendspaces(date);
    const auto it = datings_.find(date);
    if (it != datings_.end())
        return it->second;
    return datings_.emplace(date, workoutdating(date)).first->second;
}

countrycode coveragerun::countryof(std::string_view place)
{
    // An individual's events often share one place text.
    if (place.data() == lastplace_.data() && place.size() == lastplace_.size())
        return lastcountry_;
    auto it = countries_.find(place);
    if (it == countries_.end())
        it = countries_.emplace(place, placecountry(index_, place)).first;
    lastplace_ = place;
    lastcountry_ = it->second;
    return lastcountry_;
}

void coveragerun::person(const personrec& p, coveragecell* cells, int16_t& birthyear)
{
    const dayrange birth = p.hasbirthdate ? readdayrange(p.birthdate) : dayrange{};
    const dayrange death = p.hasdeathdate ? readdayrange(p.deathdate) : dayrange{};
    birthyear = birth.valid ? static_cast<int16_t>(std::clamp(birth.year, 0, 9999)) : 0;

    uint32_t recorded = 0, elsewhere = 0;
    bool dated = birth.valid || death.valid;
    daynumber bornby = birth.valid ? birth.last : nodayafter;
    daynumber diedafter = death.valid ? death.first : nodaybefore;
    const auto event = [&](std::string_view date, std::string_view place, bool counts) {
        if (date.empty())
            return;
        const eventdating& d = dating(date);
        if (d.alive) {
            dated = true;
            bornby = std::min(bornby, d.bornby);
            diedafter = std::max(diedafter, d.diedafter);
        }
        if (d.column < 0 && d.periodcolumns == 0)
            return;
        countrycode where = countryof(place);
        if (where == countrycode::unknown)
            where = d.daycountry;
        const bool abroad = where != countrycode::unknown && where != code_;
        if (abroad)
            elsewhere |= d.periodcolumns;
        if (d.column >= 0) {
            const uint32_t bit = 1u << d.column;
            if (abroad)
                elsewhere |= bit;
            else if (counts)
                recorded |= bit;
        }
    };
    for (const censusrec& c : p.census)
        event(c.date, c.place, true);
    for (const residencerec& r : p.residences)
        event(r.date, r.place, residence_);

    // The life's bounds: born in [bornfrom, bornby], died in [diedafter, diedby].
    daynumber bornfrom = birth.valid ? birth.first : nodaybefore;
    daynumber diedby = death.valid ? death.last : nodayafter;
    bornby = std::min(bornby, diedby);
    diedafter = std::max(diedafter, bornfrom);
    // Day numbers of real dates lie far from the ends of their type.
    if (diedafter != nodaybefore)
        bornfrom = std::max(bornfrom, diedafter - lifespan);
    if (bornby != nodayafter)
        diedby = std::min(diedby, bornby + lifespan);

    for (size_t c = 0; c < days_.size(); ++c) {
        const daynumber day = days_[c];
        const uint32_t bit = 1u << c;
        coveragecell cell;
        if (recorded & bit)
            cell = coveragecell::recorded;
        else if (elsewhere & bit)
            cell = coveragecell::elsewhere;
        else if (!dated)
            cell = coveragecell::uncertain;
        else if (bornfrom > day || diedby <= day)
            cell = coveragecell::notalive;
        else if ((birth.valid && bornby > day) || (death.valid && diedafter <= day))
            cell = coveragecell::uncertain;
        else
            cell = coveragecell::missing;
        cells[c] = cell;
    }
}

censuscoverage coveragerun::run()
{
    const size_t n = index_.people.size(), columns = days_.size();
    out_.people = n;
    out_.cells.resize(n * columns);
    out_.birthyears.resize(n);
    out_.recorded.assign(columns, 0);
    out_.missing.assign(columns, 0);
    for (size_t k = 0; k < n; ++k) {
        coveragecell* cells = out_.cells.data() + k * columns;
        person(index_.people[k], cells, out_.birthyears[k]);
        for (size_t c = 0; c < columns; ++c) {
            out_.recorded[c] += cells[c] == coveragecell::recorded;
            out_.missing[c] += cells[c] == coveragecell::missing;
        }
    }
    return std::move(out_);
}

} // namespace

std::string_view coverageword(coveragecell c)
{
    switch (c) {
    case coveragecell::recorded:
        return "recorded";
    case coveragecell::notalive:
        return "not alive";
    case coveragecell::uncertain:
        return "uncertain";
    case coveragecell::elsewhere:
        return "elsewhere";
    case coveragecell::missing:
        break;
    }
    return "missing";
}

QString censuscoverage::year(size_t column) const
{
    return QString::number(censustable()[static_cast<size_t>(censusrows[column])].year);
}

bool censuscoverage::hasgap(size_t person) const
{
    const coveragecell* row = cells.data() + person * columns();
    return std::find(row, row + columns(), coveragecell::missing) != row + columns();
}

censuscoverage computecoverage(const gedcomindex& index, const QString& country, bool residence, dateorder order)
{
    return coveragerun(index, country, residence, order).run();
}

std::vector<std::array<int32_t, coveragecellkinds>> countcells(const censuscoverage& c,
                                                               const std::vector<int32_t>& people)
{
    std::vector<std::array<int32_t, coveragecellkinds>> out(c.columns(), std::array<int32_t, coveragecellkinds>{});
    for (const int32_t k : people)
        for (size_t col = 0; col < c.columns(); ++col)
            ++out[col][static_cast<size_t>(c.cell(static_cast<size_t>(k), col))];
    return out;
}

std::vector<int32_t> relativesof(const gedcomindex& index, int32_t k, relation r)
{
    const size_t n = index.people.size();
    if (k < 0 || static_cast<size_t>(k) >= n)
        return {};
    // The members of each family: its spouses (FAMS) and its children (FAMC).
    std::unordered_map<int32_t, std::vector<int32_t>> spouses, children;
    for (size_t j = 0; j < n; ++j) {
        const personrec& p = index.people[j];
        for (const int32_t f : p.fams)
            if (f != 0)
                spouses[f].push_back(static_cast<int32_t>(j));
        if (p.famc != 0)
            children[p.famc].push_back(static_cast<int32_t>(j));
    }
    static const std::vector<int32_t> none;
    const auto members = [](const std::unordered_map<int32_t, std::vector<int32_t>>& m,
                            int32_t f) -> const std::vector<int32_t>& {
        const auto it = m.find(f);
        return it == m.end() ? none : it->second;
    };
    std::vector<char> seen(n, 0);
    std::vector<int32_t> todo{k};
    seen[static_cast<size_t>(k)] = 1;
    while (!todo.empty()) {
        const personrec& p = index.people[static_cast<size_t>(todo.back())];
        todo.pop_back();
        std::vector<int32_t> next;
        if (r != relation::descendants && p.famc != 0)
            for (const int32_t j : members(spouses, p.famc))
                next.push_back(j);
        for (const int32_t f : p.fams) {
            if (f == 0)
                continue;
            if (r != relation::ancestors)
                for (const int32_t j : members(children, f))
                    next.push_back(j);
            if (r == relation::related) {
                for (const int32_t j : members(spouses, f))
                    next.push_back(j);
            }
        }
        if (r == relation::related && p.famc != 0)
            for (const int32_t j : members(children, p.famc))
                next.push_back(j);
        for (const int32_t j : next) {
            if (!seen[static_cast<size_t>(j)]) {
                seen[static_cast<size_t>(j)] = 1;
                todo.push_back(j);
            }
        }
    }
    std::vector<int32_t> out;
    for (size_t j = 0; j < n; ++j)
        if (seen[j])
            out.push_back(static_cast<int32_t>(j));
    return out;
}

std::vector<int32_t> coverageorder(const gedcomindex& index, const censuscoverage& c, coveragesort sort)
{
    std::vector<int32_t> sorted;
    sorted.reserve(c.people);
    for (const size_t k : labelorder(c.people, [&](size_t k) { return qs(index.people[k].name); }))
        sorted.push_back(static_cast<int32_t>(k));
    if (sort == coveragesort::birthyear)
        std::stable_sort(sorted.begin(), sorted.end(), [&c](int32_t a, int32_t b) {
            const int ya = c.birthyears[static_cast<size_t>(a)], yb = c.birthyears[static_cast<size_t>(b)];
            return (ya == 0 ? 10000 : ya) < (yb == 0 ? 10000 : yb);
        });
    return sorted;
}

std::vector<int32_t> filtercoverage(const gedcomindex& index, const censuscoverage& c, const coveragefilter& f,
                                    const std::vector<int32_t>& ordered)
{
    std::vector<char> wantedrelative;
    if (f.relativeof >= 0) {
        wantedrelative.assign(c.people, 0);
        for (const int32_t k : relativesof(index, f.relativeof, f.relatives))
            wantedrelative[static_cast<size_t>(k)] = 1;
    }
    const QString wanted = namesearchkey(f.name.trimmed());
    std::vector<int32_t> rows;
    rows.reserve(ordered.size());
    for (const int32_t k : ordered) {
        const auto at = static_cast<size_t>(k);
        if (at >= c.people || (!wantedrelative.empty() && !wantedrelative[at]) || (f.gapsonly && !c.hasgap(at)))
            continue;
        if (!wanted.isEmpty() && !namesearchkey(qs(index.people[at].name)).contains(wanted))
            continue;
        rows.push_back(k);
    }
    return rows;
}

std::vector<int32_t> coveragerows(const gedcomindex& index, const censuscoverage& c, const coveragefilter& f,
                                  coveragesort sort)
{
    return filtercoverage(index, c, f, coverageorder(index, c, sort));
}

namespace {

void appendcsvtext(std::string& out, std::string_view text)
{
    const bool formula = !text.empty() && (text.front() == '=' || text.front() == '+' || text.front() == '-'
                                           || text.front() == '@');
    const bool quoted = text.find_first_of(",\"") != std::string_view::npos || text.starts_with(' ')
        || text.ends_with(' ');
    if (quoted)
        out += '"';
    if (formula)
        out += '\'';
    for (const char c : text) {
        if (c == '"')
            out += '"';
        out += static_cast<unsigned char>(c) < 0x20 ? ' ' : c;
    }
    if (quoted)
        out += '"';
}

} // namespace

void appendcoveragecsvheading(std::string& out, const censuscoverage& c, const std::vector<size_t>& columns)
{
    out += "id,name";
    for (const size_t col : columns) {
        out += ',';
        out += c.year(col).toStdString();
    }
    out += '\n';
}

void appendcoveragecsvrow(std::string& out, const personrec& p, const censuscoverage& c, size_t person,
                          const std::vector<size_t>& columns)
{
    out += std::to_string(p.id);
    out += ',';
    appendcsvtext(out, p.name);
    for (const size_t col : columns) {
        out += ',';
        out += coverageword(c.cell(person, col));
    }
    out += '\n';
}

} // namespace qm
