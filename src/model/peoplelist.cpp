// What the main window lists from the index: individuals by label, census sources.
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
    std::vector<sourceitem> items;
    items.reserve(index.censussources.size());
    for (int32_t at : index.censussources)
        items.push_back({qs(index.sources[static_cast<size_t>(at)].title), at});
    return items;
}

} // namespace qm
