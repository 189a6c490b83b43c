#include "platform/contenthash.h"

#include <QFile>

#include <cstring>
#include <vector>

namespace qm {

namespace {

constexpr uint64_t p1 = 11400714785074694791ULL;
constexpr uint64_t p2 = 14029467366897019727ULL;
constexpr uint64_t p3 = 1609587929392839161ULL;
constexpr uint64_t p4 = 9650029242287828579ULL;
constexpr uint64_t p5 = 2870177450012600261ULL;

uint64_t rotl(uint64_t x, int r)
{
    return (x << r) | (x >> (64 - r));
}

// Little-endian loads whatever the machine's byte order; a single load where it is little-endian.
uint64_t read64(const unsigned char* p)
{
    uint64_t v = 0;
    for (int i = 7; i >= 0; --i)
        v = (v << 8) | p[i];
    return v;
}

uint64_t read32(const unsigned char* p)
{
    return uint64_t{p[0]} | uint64_t{p[1]} << 8 | uint64_t{p[2]} << 16 | uint64_t{p[3]} << 24;
}

uint64_t round(uint64_t acc, uint64_t input)
{
    return rotl(acc + input * p2, 31) * p1;
}

uint64_t mergeround(uint64_t acc, uint64_t v)
{
    return (acc ^ round(0, v)) * p1 + p4;
}

void stripe(uint64_t (&v)[4], const unsigned char* p)
{
    for (int i = 0; i < 4; ++i)
        v[i] = round(v[i], read64(p + 8 * i));
}

} // namespace

void contenthash::add(const char* data, size_t size)
{
    auto p = reinterpret_cast<const unsigned char*>(data);
    total_ += size;
    if (pendingsize_ + size < 32) {
        std::memcpy(pending_ + pendingsize_, p, size);
        pendingsize_ += size;
        return;
    }
    if (pendingsize_ > 0) {
        const size_t fill = 32 - pendingsize_;
        std::memcpy(pending_ + pendingsize_, p, fill);
        stripe(v_, pending_);
        p += fill;
        size -= fill;
        pendingsize_ = 0;
    }
    for (; size >= 32; p += 32, size -= 32)
        stripe(v_, p);
    std::memcpy(pending_, p, size);
    pendingsize_ = size;
}

uint64_t contenthash::value() const
{
    uint64_t h;
    if (total_ >= 32) {
        h = rotl(v_[0], 1) + rotl(v_[1], 7) + rotl(v_[2], 12) + rotl(v_[3], 18);
        for (uint64_t v : v_)
            h = mergeround(h, v);
    } else {
        h = p5; // the seed, 0, plus p5
    }
    h += total_;
    const unsigned char* p = pending_;
    size_t n = pendingsize_;
    for (; n >= 8; p += 8, n -= 8)
        h = rotl(h ^ round(0, read64(p)), 27) * p1 + p4;
    if (n >= 4) {
        h = rotl(h ^ (read32(p) * p1), 23) * p2 + p3;
        p += 4;
        n -= 4;
    }
    for (; n > 0; ++p, --n)
        h = rotl(h ^ (*p * p5), 11) * p1;
    h ^= h >> 33;
    h *= p2;
    h ^= h >> 29;
    h *= p3;
    h ^= h >> 32;
    return h;
}

QString hashtext(uint64_t hash)
{
    return QStringLiteral("%1").arg(hash, 16, 16, QLatin1Char('0'));
}

bool hashfile(const QString& path, uint64_t& hash, QString* error)
{
    QFile f(path);
    if (!f.open(QIODevice::ReadOnly)) {
        if (error)
            *error = f.errorString();
        return false;
    }
    contenthash h;
    std::vector<char> buf(1 << 20);
    for (;;) {
        const qint64 n = f.read(buf.data(), static_cast<qint64>(buf.size()));
        if (n < 0) {
            if (error)
                *error = f.errorString();
            return false;
        }
        if (n == 0)
            break;
        h.add(buf.data(), static_cast<size_t>(n));
    }
    hash = h.value();
    return true;
}

} // namespace qm
