#pragma once
// Storage for the many short texts of the index. Texts are appended to large
// blocks that never move, so the views handed out stay valid for the arena's
// life (also when the arena itself is moved), and a load makes a few large
// allocations instead of one per value.

#include <algorithm>
#include <cstring>
#include <memory>
#include <string_view>
#include <vector>

namespace qm {

class textarena {
public:
    textarena() = default;
    textarena(textarena&&) = default;
    textarena& operator=(textarena&&) = default;
    textarena(const textarena&) = delete;
    textarena& operator=(const textarena&) = delete;

    std::string_view store(std::string_view text)
    {
        if (text.empty())
            return {};
        if (text.size() > room_) {
            // Blocks grow from small to large, so that a small file costs
            // little; they are not zeroed, since every byte is written first.
            const size_t block = std::min(blocksize, firstblock << std::min<size_t>(blocks_.size(), 8));
            const size_t size = text.size() > block / 4 ? text.size() : block;
            blocks_.push_back(std::unique_ptr<char[]>(new char[size]));
            next_ = blocks_.back().get();
            room_ = size;
            total_ += size;
        }
        char* at = next_;
        std::memcpy(at, text.data(), text.size());
        next_ += text.size();
        room_ -= text.size();
        return {at, text.size()};
    }

    // Bytes held in blocks, for memory accounting.
    size_t capacity() const { return total_; }

private:
    static constexpr size_t firstblock = 16 << 10;
    static constexpr size_t blocksize = 1 << 20;
    std::vector<std::unique_ptr<char[]>> blocks_;
    char* next_ = nullptr;
    size_t room_ = 0;
    size_t total_ = 0;
};

} // namespace qm
