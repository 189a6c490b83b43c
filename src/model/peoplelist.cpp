// What the main window lists from the index: individuals by label, census
// sources by title, both in the one list order (model/labelorder.h).
#include "model/loadgedcom.h"

#include "model/labelorder.h"

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

std::vector<int32_t> sortedpeople(const gedcomindex& index, bool idonly)
{
    const std::vector<size_t> order = labelorder(index.people.size(),
                                                 [&](size_t k) { return personlabel(index.people[k], idonly); });
    return std::vector<int32_t>(order.begin(), order.end());
}

bool peoplelistshown(const gedcomindex& index)
{
    return index.people.size() <= maxlisted;
}

std::vector<sourceitem> censussourcelist(const gedcomindex& index)
{
    const std::vector<int32_t>& census = index.censussources;
    const std::vector<size_t> order = labelorder(census.size(), [&](size_t k) {
        return qs(index.sources[static_cast<size_t>(census[k])].title);
    });
    std::vector<sourceitem> items;
    items.reserve(order.size());
    for (size_t k : order)
        items.push_back({qs(index.sources[static_cast<size_t>(census[k])].title), census[k]});
    return items;
}

} // namespace qm
