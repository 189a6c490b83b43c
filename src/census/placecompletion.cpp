#include "census/placecompletion.h"

#include "model/loadgedcom.h"

#include <algorithm>

namespace qm {

namespace {

// Compares the start of a name with the typed text in the folded form the
// place table is sorted by: 0 when the name starts with the text.
int compareprefix(std::string_view name, std::string_view typedkey)
{
    const std::string key = placekey(name);
    return std::string_view(key).substr(0, typedkey.size()).compare(typedkey);
}

} // namespace

int bestplace(const std::vector<placerec>& places, QStringView typed)
{
    if (typed.isEmpty())
        return -1;
    // The table is sorted by folded name, so the names starting with the typed
    // text stand together; find the first of them.
    const std::string key = placekey(u8(typed.toString()));
    auto it = std::partition_point(places.begin(), places.end(), [&](const placerec& p) {
        return compareprefix(p.name, key) < 0;
    });
    int best = -1;
    for (; it != places.end() && compareprefix(it->name, key) == 0; ++it) {
        const int at = static_cast<int>(it - places.begin());
        if (best < 0 || it->count > places[best].count)
            best = at;
    }
    return best;
}

std::optional<placebox> completeplace(const std::vector<placerec>& places, const placebox& box)
{
    const int length = static_cast<int>(box.text.size());
    if (length == 0 || box.sellength != 0 || box.selstart != length)
        return std::nullopt;
    const int at = bestplace(places, box.text);
    if (at < 0)
        return std::nullopt;
    placebox done;
    done.text = qs(places[at].name);
    done.selstart = length;
    done.sellength = static_cast<int>(done.text.size()) - length;
    return done;
}

std::optional<placebox> typethrough(const placebox& box, QStringView key)
{
    if (box.sellength < 2 || key.size() != 1 || box.selstart < 0
        || box.selstart + box.sellength > box.text.size())
        return std::nullopt;
    if (key[0] != box.text[box.selstart])
        return std::nullopt;
    placebox next = box;
    next.sellength = box.sellength - 1;
    next.selstart = static_cast<int>(box.text.size()) - next.sellength;
    return next;
}

} // namespace qm
