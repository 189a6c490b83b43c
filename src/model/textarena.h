#pragma once
// Storage for the many short texts and lists of the index. They are appended
// to large blocks that never move, so the views handed out stay valid for the
// arena's life (also when the arena itself is moved), and a load makes a few
// large allocations instead of one per value.

#include "platform/memoryhint.h"
#include "platform/prefaulter.h"

#include <algorithm>
#include <cstdint>
#include <cstring>
#include <memory>
#include <new>
#include <string_view>
#include <utility>
#include <vector>

namespace qm {

class textarena {
public:
    textarena() = default;
    textarena(textarena&& other) noexcept { *this = std::move(other); }
    textarena& operator=(textarena&& other) noexcept
    {
        // The moved-from arena is left empty, not pointing into the blocks it gave away.
        if (this != &other) {
            blocks_ = std::move(other.blocks_);
            other.blocks_.clear();
            pf_ = std::exchange(other.pf_, nullptr);
            spare_ = std::exchange(other.spare_, nullptr);
            next_ = std::exchange(other.next_, nullptr);
            room_ = std::exchange(other.room_, 0);
            total_ = std::exchange(other.total_, 0);
        }
        return *this;
    }
    textarena(const textarena&) = delete;
    textarena& operator=(const textarena&) = delete;

    std::string_view store(std::string_view text)
    {
        if (text.empty())
            return {};
        char* at = static_cast<char*>(allocate(text.size(), 1));
        std::memcpy(at, text.data(), text.size());
        return {at, text.size()};
    }

    // Uninitialised room for `bytes` bytes aligned to `align` (a power of two
    // no larger than that of max_align_t).
    void* allocate(size_t bytes, size_t align)
    {
        size_t pad = static_cast<size_t>(-reinterpret_cast<uintptr_t>(next_)) & (align - 1);
        if (bytes + pad > room_) {
            // A large piece gets a block of its own; the current one stays in use.
            if (bytes > blocksize / 4)
                return addblock(bytes, false);
            addblock(bytes, true);
            pad = 0;
        }
        char* at = next_ + pad;
        next_ = at + bytes;
        room_ -= bytes + pad;
        return at;
    }

    // Bytes held in blocks, for memory accounting.
    size_t capacity() const { return total_; }

    // While a big load fills the arena: each large block is made one ahead
    // and brought in by `pf`, so that filling it finds its pages ready. Null
    // ends that (the block made ahead stays for later use).
    void prefaultwith(prefaulter* pf) { pf_ = pf; }

private:
    static constexpr size_t firstblock = 16 << 10;
    static constexpr size_t blocksize = 4 << 20;
    static constexpr size_t largepage = 2 << 20;

    struct freeblock {
        size_t align;
        void operator()(char* p) const { ::operator delete(p, std::align_val_t(align)); }
    };
    using block = std::unique_ptr<char, freeblock>;

    char* addblock(size_t need, bool current)
    {
        // Blocks grow from small to large, so that a small file costs little.
        // Large ones start on a large page and ask for large pages: touching
        // fresh memory a small page at a time is much of a big load's time.
        // They are not zeroed, since every byte is written first.
        const size_t size =
            current ? std::max(need, std::min(blocksize, firstblock << std::min<size_t>(blocks_.size(), 8))) : need;
        if (current && spare_ && need <= blocksize) {
            // The block made ahead takes over.
            next_ = spare_;
            room_ = blocksize;
            spare_ = nullptr;
            if (pf_)
                makespare();
            return next_;
        }
        const size_t align = size >= largepage ? largepage : alignof(std::max_align_t);
        char* const at = static_cast<char*>(::operator new(size, std::align_val_t(align)));
        blocks_.emplace_back(at, freeblock{align});
        total_ += size;
        if (align == largepage)
            hintlargememory(at, size);
        if (current) {
            next_ = at;
            room_ = size;
            if (pf_ && size == blocksize)
                makespare();
        }
        return at;
    }

    void makespare()
    {
        spare_ = static_cast<char*>(::operator new(blocksize, std::align_val_t(largepage)));
        blocks_.emplace_back(spare_, freeblock{largepage});
        total_ += blocksize;
        hintlargememory(spare_, blocksize);
        pf_->request(spare_, blocksize);
    }

    std::vector<block> blocks_;
    prefaulter* pf_ = nullptr;
    char* spare_ = nullptr; // a block made ahead, not yet in use
    char* next_ = nullptr;
    size_t room_ = 0;
    size_t total_ = 0;
};

} // namespace qm
