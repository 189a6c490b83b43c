#include "model/labelorder.h"

#include <algorithm>
#include <numeric>

namespace qm {

QString labelkey(const QString& label)
{
    const QString folded = label.toCaseFolded();
    const bool plain = std::all_of(folded.begin(), folded.end(), [](QChar c) { return c.unicode() < 0x80; });
    if (plain)
        return folded;
    QString base;
    base.reserve(folded.size());
    for (QChar c : folded.normalized(QString::NormalizationForm_D))
        if (c.category() != QChar::Mark_NonSpacing)
            base += c;
    // A label without accents sorts before the same letters with them.
    return base + QChar(u'\0') + folded;
}

std::vector<size_t> labelorder(size_t n, const std::function<QString(size_t)>& label)
{
    std::vector<QString> keys;
    keys.reserve(n);
    for (size_t i = 0; i < n; ++i)
        keys.push_back(labelkey(label(i)));
    std::vector<size_t> order(n);
    std::iota(order.begin(), order.end(), size_t{0});
    std::stable_sort(order.begin(), order.end(), [&keys](size_t a, size_t b) { return keys[a] < keys[b]; });
    return order;
}

} // namespace qm
