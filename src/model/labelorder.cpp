#include "model/labelorder.h"

#include <algorithm>
#include <numeric>

namespace qm {

namespace {

bool plain(const QString& folded)
{
    return std::all_of(folded.begin(), folded.end(), [](QChar c) { return c.unicode() < 0x80; });
}

QString withoutaccents(const QString& folded)
{
    QString base;
    base.reserve(folded.size());
    for (QChar c : folded.normalized(QString::NormalizationForm_D))
        if (c.category() != QChar::Mark_NonSpacing)
            base += c;
    return base;
}

} // namespace

QString labelkey(const QString& label)
{
    const QString folded = label.toCaseFolded();
    if (plain(folded))
        return folded;
    // A label without accents sorts before the same letters with them.
    return withoutaccents(folded) + QChar(u'\0') + folded;
}

QString namesearchkey(const QString& text)
{
    const QString folded = text.toCaseFolded();
    return plain(folded) ? folded : withoutaccents(folded);
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
