// What the main window lists from the index: individuals by label, census sources.
#include "model/loadgedcom.h"

#include <algorithm>
#include <numeric>

namespace qm {

namespace {
// With more individuals than this the list of all individuals is not filled.
constexpr size_t maxlisted = 32000;

// The label case-folded; a label with accented letters sorts by its letters
// without their accents first (Émile among the E's, not after Z), then by the
// accented form, so that equal base names still have a fixed order.
QString sortkey(const QString& label)
{
    const QString folded = label.toCaseFolded();
    const bool ascii = std::all_of(folded.begin(), folded.end(), [](QChar c) { return c.unicode() < 0x80; });
    if (ascii)
        return folded;
    QString base;
    base.reserve(folded.size());
    for (QChar c : folded.normalized(QString::NormalizationForm_D))
        if (c.category() != QChar::Mark_NonSpacing)
            base += c;
    return base + QChar(u'\0') + folded;
}
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
// folding, accents set aside first.
std::vector<int32_t> sortedpeople(const gedcomindex& index, bool idonly)
{
    const size_t n = index.people.size();
    std::vector<QString> keys;
    keys.reserve(n);
    for (const personrec& p : index.people)
        keys.push_back(sortkey(personlabel(p, idonly)));
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
