#pragma once
// Place completion for the place boxes (census place, birth place): as the
// user types, the best known place that starts with the typed text is
// offered, with its untyped rest selected so that typing on replaces it.

#include "model/gedcomindex.h"

#include <QString>
#include <QStringView>

#include <optional>
#include <vector>

namespace qm {

// Position in `places` of the place that completes `typed`: among the names
// starting with it (ignoring letter case) the one used most often, the first
// on a tie; -1 when there is none or `typed` is empty. `places` is the index's
// table: one entry per case-insensitive group, sorted ignoring case.
int bestplace(const std::vector<placerec>& places, QStringView typed);

// The state of a place box: its text and selection (start and length; a
// length of 0 means the caret is at `selstart`).
struct placebox {
    QString text;
    int selstart = 0;
    int sellength = 0;

    friend bool operator==(const placebox&, const placebox&) = default;
};

// After a key was released: when the caret stands at the end of a non-empty
// text with nothing selected and a place completes it, the box becomes that
// place's name with the typed part unselected and the rest selected.
std::optional<placebox> completeplace(const std::vector<placerec>& places, const placebox& box);

// Before a typed key is entered: when at least two characters are selected and
// the key's text is exactly the first selected character, the key is to be
// swallowed and the selection shrinks by its first character (it keeps ending
// at the end of the text). Returns the new box, or nothing when the key is to
// be entered as usual.
std::optional<placebox> typethrough(const placebox& box, QStringView key);

} // namespace qm
