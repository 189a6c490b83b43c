#include "census/householdcheck.h"

#include "model/dates.h"
#include "model/gedcomindex.h"
#include "platform/encoding.h"
#include "settings/settings.h"

#include <QHash>

#include <algorithm>
#include <cstring>
#include <unordered_map>

namespace qm {

namespace {

// Ages may be typed as much as this many years from those the birth date allows.
constexpr int agetolerance = 2;

// Union-find over family numbers: two individuals are related when their
// families (as a child, as a spouse) fall into one set.
class families {
public:
    explicit families(const gedcomindex& ix)
    {
        for (const personrec& p : ix.people) {
            int first = -1;
            const auto join = [&](int32_t family) {
                if (family == 0)
                    return;
                const int f = node(family);
                if (first < 0)
                    first = f;
                else
                    parent_[static_cast<size_t>(find(f))] = find(first);
            };
            join(p.famc);
            for (int32_t f : p.fams)
                join(f);
        }
    }

    // The set of an individual's families, or -1 when it has none.
    int of(const personrec& p)
    {
        int32_t family = p.famc;
        if (family == 0 && !p.fams.empty())
            family = p.fams[0];
        const auto it = nodes_.find(family);
        return family == 0 || it == nodes_.end() ? -1 : find(it->second);
    }

private:
    int node(int32_t family)
    {
        const auto [it, added] = nodes_.emplace(family, static_cast<int>(parent_.size()));
        if (added)
            parent_.push_back(it->second);
        return it->second;
    }
    int find(int f)
    {
        while (parent_[static_cast<size_t>(f)] != f) {
            parent_[static_cast<size_t>(f)] = parent_[static_cast<size_t>(parent_[static_cast<size_t>(f)])];
            f = parent_[static_cast<size_t>(f)];
        }
        return f;
    }

    std::unordered_map<int32_t, int> nodes_;
    std::vector<int> parent_;
};

QString who(const selectionrec& r, const personrec& p)
{
    const QString name = r.name.isEmpty() ? qs(p.name) : r.name;
    return name + QStringLiteral(" (ID: ") + QString::number(p.id) + u')';
}

// The age as typed, in words: "54", "6 months", "1 day".
QString typedage(const selectionrec& r)
{
    const QString n = r.age.trimmed();
    if (r.agetype == u'M')
        return n + (n == QLatin1String("1") ? QStringLiteral(" month") : QStringLiteral(" months"));
    if (r.agetype == u'D')
        return n + (n == QLatin1String("1") ? QStringLiteral(" day") : QStringLiteral(" days"));
    return n;
}

// The typed age in whole years.
int typedyears(const selectionrec& r)
{
    const int n = r.age.trimmed().toInt();
    return r.agetype == u'M' ? n / 12 : r.agetype == u'D' ? n / 365 : n;
}

// "50", "29 or 30", "28 to 31", "31 or more", "30 or less".
QString agesphrase(const std::optional<int>& youngest, const std::optional<int>& oldest)
{
    if (youngest && oldest)
        return *youngest == *oldest     ? QString::number(*youngest)
               : *oldest == *youngest + 1 ? QStringLiteral("%1 or %2").arg(*youngest).arg(*oldest)
                                          : QStringLiteral("%1 to %2").arg(*youngest).arg(*oldest);
    return youngest ? QStringLiteral("%1 or more").arg(*youngest) : QStringLiteral("%1 or less").arg(*oldest);
}

class checker {
public:
    checker(const gedcomindex& ix, const settings& s, const censusentry& e)
        : ix_(ix), s_(s), e_(e), order_(localedateorder()), census_(recognisedate(e.entrydate.trimmed(), order_))
    {
    }

    std::vector<householdfinding> run();

private:
    void add(int row, findingkind kind, const QString& message)
    {
        out_.push_back({row, kind, kind == findingkind::unrelated ? findingseverity::information : findingseverity::warning,
                        message});
    }
    const personrec* person(const selectionrec& r) const;
    void dates(int row, const selectionrec& r, const personrec& p);
    void entered(int row, const selectionrec& r, const personrec& p);
    bool thiscensus(const QString& date, const std::vector<int32_t>& sources) const;

    const gedcomindex& ix_;
    const settings& s_;
    const censusentry& e_;
    dateorder order_;
    std::optional<QDate> census_;
    std::vector<householdfinding> out_;
};

const personrec* checker::person(const selectionrec& r) const
{
    const auto k = static_cast<size_t>(r.personindex);
    if (r.personindex >= 0 && k < ix_.people.size() && ix_.people[k].id == r.id)
        return &ix_.people[k];
    for (const personrec& p : ix_.people)
        if (p.id == r.id)
            return &p;
    return nullptr;
}

void checker::dates(int row, const selectionrec& r, const personrec& p)
{
    const QString day = e_.entrydate.trimmed();
    if (p.hasdeathdate) {
        const QString death = qs(p.deathdate);
        const std::optional<dayspan> d = datespan(death, order_);
        if (d && d->latest && *d->latest < *census_) {
            add(row, findingkind::diedbefore,
                QStringLiteral("%1 died %2 by the tree, before the census day %3.")
                    .arg(who(r, p), datephrase(death, census_, order_).phrase, day));
        }
    }
    if (!p.hasbirthdate)
        return;
    const QString birth = qs(p.birthdate);
    const std::optional<dayspan> b = datespan(birth, order_);
    if (!b)
        return;
    const QString phrase = datephrase(birth, census_, order_).phrase;
    if (b->earliest && *b->earliest > *census_) {
        add(row, findingkind::notborn,
            QStringLiteral("%1 was born %2 by the tree, after the census day %3.").arg(who(r, p), phrase, day));
        return;
    }
    if (r.age.trimmed().isEmpty())
        return;
    // The ages the birth date allows: from the latest birth day's to the earliest's.
    std::optional<int> youngest, oldest;
    if (b->latest)
        youngest = std::max(0, completedyears(std::min(*b->latest, *census_), *census_));
    if (b->earliest)
        oldest = completedyears(*b->earliest, *census_);
    const int slack = b->bounded ? 0 : agetolerance;
    int low = typedyears(r), high = low;
    if (e_.year == 1841 && s_.country == QLatin1String("UK") && r.agetype == u'Y' && low >= 15 && low % 5 == 0)
        high = low + 4;
    const bool tooyoung = youngest && high < *youngest - slack;
    const bool tooold = oldest && low > *oldest + slack;
    if (tooyoung || tooold)
        add(row, findingkind::age,
            QStringLiteral("%1 is entered as aged %2, but by the tree was born %3 and in this census would be aged %4.")
                .arg(who(r, p), typedage(r), phrase, agesphrase(youngest, oldest)));
}

bool checker::thiscensus(const QString& date, const std::vector<int32_t>& sources) const
{
    if (census_ && recognisedate(date, order_) == census_)
        return true;
    // Citing an existing census source: its citations are of this census whatever their dates.
    const int32_t cited = e_.sourceid.trimmed().toInt();
    return !s_.fullentry && cited > 0 && std::find(sources.begin(), sources.end(), cited) != sources.end();
}

void checker::entered(int row, const selectionrec& r, const personrec& p)
{
    const auto found = [&](const char* what, const QString& date, const QString& place) {
        QString where = date.isEmpty() ? QString() : QStringLiteral(" dated ") + date;
        if (!place.isEmpty())
            where += QStringLiteral(" at ") + place;
        add(row, findingkind::entered,
            QStringLiteral("%1 already has a %2 of this census%3: is this household entered twice?")
                .arg(who(r, p), QLatin1String(what), where));
    };
    for (const censusrec& c : p.census) {
        const QString date = qs(c.date).trimmed();
        if (thiscensus(date, std::vector<int32_t>(c.sourceids.begin(), c.sourceids.end()))) {
            found("census event", date, qs(c.place).trimmed());
            return;
        }
    }
    if (!s_.residence)
        return;
    for (const residencerec& f : p.residences) {
        const QString date = qs(f.date).trimmed();
        if (thiscensus(date, std::vector<int32_t>(f.sourceids.begin(), f.sourceids.end()))) {
            found("residence fact", date, qs(f.place).trimmed());
            return;
        }
    }
}

std::vector<householdfinding> checker::run()
{
    const std::vector<selectionrec>& rows = e_.selection;
    std::vector<const personrec*> people;
    QHash<int32_t, int> firstrow;
    for (size_t k = 0; k < rows.size(); ++k) {
        people.push_back(person(rows[k]));
        if (people.back() && !firstrow.contains(people.back()->id))
            firstrow.insert(people.back()->id, static_cast<int>(k));
    }
    // The parts of the tree the household's individuals belong to.
    std::vector<int> part(rows.size(), -1);
    if (firstrow.size() > 1) {
        families tree(ix_);
        for (size_t k = 0; k < rows.size(); ++k)
            if (people[k])
                part[k] = tree.of(*people[k]);
    }

    for (size_t k = 0; k < rows.size(); ++k) {
        const personrec* p = people[k];
        if (!p)
            continue;
        const int row = static_cast<int>(k);
        const selectionrec& r = rows[k];
        // A second row of the same individual: the first row has the other findings.
        if (const int first = firstrow.value(p->id); first != row) {
            add(row, findingkind::twice, QStringLiteral("%1 is in row %2 as well.").arg(who(r, *p)).arg(first + 1));
            continue;
        }
        if (census_)
            dates(row, r, *p);
        entered(row, r, *p);
        if (firstrow.size() < 2)
            continue;
        bool related = false;
        for (size_t j = 0; j < rows.size() && !related; ++j)
            related = people[j] && people[j]->id != p->id && part[k] >= 0 && part[j] == part[k];
        if (!related)
            add(row, findingkind::unrelated,
                QStringLiteral("%1 is not related in the tree to anyone else of this household: no chain of "
                               "parent, child, sibling or spouse links joins them.")
                    .arg(who(r, *p)));
    }
    return std::move(out_);
}

} // namespace

std::vector<householdfinding> householdcheck(const gedcomindex& index, const settings& s, const censusentry& entry)
{
    checker c(index, s, entry);
    return c.run();
}

bool anywarning(const std::vector<householdfinding>& findings)
{
    return std::any_of(findings.begin(), findings.end(),
                       [](const householdfinding& f) { return f.severity == findingseverity::warning; });
}

QString findingline(const householdfinding& f)
{
    return QStringLiteral("Row %1: %2").arg(f.row + 1).arg(f.message);
}

} // namespace qm
