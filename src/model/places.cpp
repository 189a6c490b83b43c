// The place table: one entry per group of names that are equal ignoring
// letter case, sorted ignoring case.
#include "model/loadgedcom.h"

#include <algorithm>
#include <numeric>

namespace qm {

std::string placekey(std::string_view name)
{
    if (allascii(name)) {
        std::string key(name);
        for (char& c : key)
            if (c >= 'A' && c <= 'Z')
                c = static_cast<char>(c + 32);
        return key;
    }
    return qs(name).toCaseFolded().toStdString();
}

namespace {

// First position whose key is not below `key`.
size_t lowerplace(const gedcomindex& index, std::string_view key)
{
    size_t lo = 0, hi = index.places.size();
    while (lo < hi) {
        const size_t mid = lo + (hi - lo) / 2;
        if (placekey(index.places[mid].name) < key)
            lo = mid + 1;
        else
            hi = mid;
    }
    return lo;
}

} // namespace

int findplace(const gedcomindex& index, std::string_view name)
{
    const std::string key = placekey(name);
    const size_t at = lowerplace(index, key);
    if (at < index.places.size() && placekey(index.places[at].name) == key)
        return static_cast<int>(at);
    return -1;
}

void insertplace(gedcomindex& index, std::string_view name)
{
    if (name.empty())
        return;
    const std::string key = placekey(name);
    const size_t at = lowerplace(index, key);
    if (at < index.places.size() && placekey(index.places[at].name) == key) {
        ++index.places[at].count;
        return;
    }
    placerec p;
    p.name = index.arena.store(name);
    p.count = 1;
    index.places.insert(index.places.begin() + static_cast<std::ptrdiff_t>(at), p);
}

void sortplaces(gedcomindex& index, size_t low, size_t high)
{
    auto& places = index.places;
    if (places.empty() || low >= high || low >= places.size())
        return;
    high = std::min(high, places.size() - 1);
    std::vector<std::pair<std::string, placerec>> items;
    items.reserve(high - low + 1);
    for (size_t i = low; i <= high; ++i)
        items.emplace_back(placekey(places[i].name), places[i]);
    std::stable_sort(items.begin(), items.end(), [](const auto& a, const auto& b) { return a.first < b.first; });
    for (size_t i = low; i <= high; ++i)
        places[i] = items[i - low].second;
}

void countplaces(gedcomindex& index)
{
    auto& places = index.places;
    if (places.empty())
        return;
    sortplaces(index, 0, places.size() - 1);
    std::vector<placerec> groups;
    std::string headkey;
    for (const placerec& p : places) {
        std::string key = placekey(p.name);
        if (!groups.empty() && key == headkey) {
            groups.back().count += p.count;
            continue;
        }
        groups.push_back(p);
        headkey = std::move(key);
    }
    places = std::move(groups);
}

} // namespace qm
