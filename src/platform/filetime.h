#pragma once
// What Quillmark notes about a family file to tell later whether another
// program has changed it: its last-modified time and its size.

#include <QString>

#include <cstdint>

namespace qm {

struct filestamp {
    bool exists = false;
    int64_t modified = 0; // last-modified time, milliseconds since 1970 UTC
    int64_t size = 0;

    bool operator==(const filestamp&) const = default;
};

filestamp stampof(const QString& path);

// Sets a file's last-modified time (a backup keeps its original's time).
bool setmodified(const QString& path, int64_t modified);

} // namespace qm
