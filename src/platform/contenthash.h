#pragma once
// A fingerprint of a file's content, to tell later whether the file still
// holds exactly the bytes Quillmark wrote: 64-bit XXH64 (seed 0), the
// published non-cryptographic hash, fed in pieces as the bytes go by. It runs
// at several gigabytes a second, so a save of a large family file pays next
// to nothing for it; it guards against accidents (another program's edit
// that keeps the size and the time stamp), not against forgery.

#include <QString>

#include <cstddef>
#include <cstdint>
#include <string_view>

namespace qm {

class contenthash {
public:
    void add(const char* data, size_t size);
    void add(std::string_view bytes) { add(bytes.data(), bytes.size()); }
    // The hash of everything added so far (more may be added after).
    uint64_t value() const;

private:
    uint64_t v_[4] = {0x60ea27eeadc0b5d6ULL, 0xc2b2ae3d27d4eb4fULL, 0, 0x61c8864e7a143579ULL};
    unsigned char pending_[32] = {};
    size_t pendingsize_ = 0;
    uint64_t total_ = 0;
};

// The hash as 16 lower-case hexadecimal digits.
QString hashtext(uint64_t hash);

// The hash of a whole file, read in pieces. False (with the system's reason
// in error) when it cannot be read.
bool hashfile(const QString& path, uint64_t& hash, QString* error = nullptr);

} // namespace qm
