#pragma once
// The one order of every list of people: All Individuals, who could be alive
// at a census, Immediate Family, Find, and the census date check's details;
// and of the list of existing census sources.
// Ascending and ignoring letter case, as a sorted list box keeps its items,
// and the same on every system whatever its locale: labels are compared by
// their case-folded characters with accents set aside first ("Ébert" among
// the E's, "van Dyke" among the V's), then with their accents; labels still
// equal keep the order they came in (file order). No locale collation: its
// order differs from system to system, and Qt's sort keys are wrong on some.

#include <QString>

#include <cstddef>
#include <functional>
#include <vector>

namespace qm {

// The key a label is ordered by: keys compare as plain strings.
QString labelkey(const QString& label);
// A text case-folded with its accents set aside ("Ébert" -> "ebert"): the
// form in which a name search compares names.
QString namesearchkey(const QString& text);

// The positions 0 .. n-1 in the order of their labels, label(i) giving the
// label of position i; equal labels keep the order of their positions.
std::vector<size_t> labelorder(size_t n, const std::function<QString(size_t)>& label);

} // namespace qm
