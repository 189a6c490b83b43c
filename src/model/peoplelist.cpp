// What the main window lists from the index: individuals by label, census sources.
#include "model/loadgedcom.h"

#include <algorithm>
#include <numeric>

namespace qm {

namespace {
// With more individuals than this the list of all individuals is not filled.
constexpr size_t maxlisted = 32000;
} // namespace

QString personlabel(const personrec& p, bool idonly)
{
    if (p.hasbirthdate && !idonly)
        return qs(p.name) + QStringLiteral(" (") + qs(p.birthdate) + QLatin1Char(')');
    return qs(p.name) + QStringLiteral(" (ID: ") + QString::number(p.id) + QLatin1Char(')');
}

// Alphabetical order ignoring case, as a sorted list box keeps its items;
// individuals whose labels compare equal stay in file order. The order is the
// same on every system (no locale collation): characters compared after case
// folding, as the place list compares names.
std::vector<int32_t> sortedpeople(const gedcomindex& index, bool idonly)
{
    const size_t n = index.people.size();
    std::vector<QString> keys;
    keys.reserve(n);
    for (const personrec& p : index.people)
        keys.push_back(personlabel(p, idonly).toCaseFolded());
    std::vector<int32_t> order(n);
    std::iota(order.begin(), order.end(), 0);
    std::stable_sort(order.begin(), order.end(), [&](int32_t a, int32_t b) {
        return keys[static_cast<size_t>(a)] < keys[static_cast<size_t>(b)];
    });
    return order;
}

bool peoplelistshown(const gedcomindex& index)
{
    return index.people.size() <= maxlisted;
}

std::vector<sourceitem> censussourcelist(const gedcomindex& index)
{
    std::vector<sourceitem> items;
    items.reserve(index.censussources.size());
    for (int32_t at : index.censussources)
        items.push_back({qs(index.sources[static_cast<size_t>(at)].title), at});
    return items;
}

} // namespace qm
