#pragma once
// A list held by a record of the index (families, citations, flags, census
// events): a pointer and two counts, 16 bytes where a vector takes 24.
//
// The loader places each list in the index's arena as one piece of its exact
// size (adopt), so a big file costs no heap allocation per record; such
// storage goes with the arena. A list built or grown any other way (push_back,
// assignment, copies) owns heap storage like a vector. Either way its elements
// are destroyed with the list.

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <initializer_list>
#include <memory>
#include <span>
#include <stdexcept>
#include <type_traits>
#include <vector>

namespace qm {

template <typename T>
class indexlist {
public:
    using value_type = T;
    using size_type = size_t;
    using difference_type = std::ptrdiff_t;
    using reference = T&;
    using const_reference = const T&;
    using pointer = T*;
    using const_pointer = const T*;
    using iterator = T*;
    using const_iterator = const T*;

    indexlist() = default;
    indexlist(std::initializer_list<T> items) { assign(items.begin(), items.end()); }
    explicit indexlist(const std::vector<T>& items) { assign(items.begin(), items.end()); }
    indexlist(const indexlist& other) { assign(other.begin(), other.end()); }
    indexlist(indexlist&& other) noexcept : data_(other.data_), size_(other.size_), cap_(other.cap_)
    {
        other.forget();
    }
    ~indexlist() { release(); }

    indexlist& operator=(const indexlist& other)
    {
        if (this != &other)
            assign(other.begin(), other.end());
        return *this;
    }
    indexlist& operator=(indexlist&& other) noexcept
    {
        if (this != &other) {
            release();
            data_ = other.data_;
            size_ = other.size_;
            cap_ = other.cap_;
            other.forget();
        }
        return *this;
    }
    indexlist& operator=(const std::vector<T>& items)
    {
        assign(items.begin(), items.end());
        return *this;
    }
    indexlist& operator=(std::initializer_list<T> items)
    {
        assign(items.begin(), items.end());
        return *this;
    }

    // Takes over n elements constructed in storage that outlives the list
    // (the index's arena): they are destroyed with the list, the storage is
    // not freed.
    void adopt(T* items, size_t n)
    {
        release();
        data_ = items;
        size_ = checked(n);
        cap_ = size_ | borrowed;
    }

    template <typename It>
    void assign(It first, It last)
    {
        clear();
        const auto n = static_cast<size_t>(std::distance(first, last));
        reserve(n);
        std::uninitialized_copy(first, last, data_);
        size_ = static_cast<uint32_t>(n);
    }

    void reserve(size_t n)
    {
        if (n > capacity())
            regrow(n);
    }

    void push_back(const T& item) { emplace_back(item); }
    void push_back(T&& item) { emplace_back(std::move(item)); }
    template <typename... A>
    T& emplace_back(A&&... args)
    {
        if (size_ == capacity()) {
            // The new element is made first: args may refer to an element.
            T item(std::forward<A>(args)...);
            regrow(std::max<size_t>(4, size_t{size_} * 2));
            return *::new (static_cast<void*>(data_ + size_++)) T(std::move(item));
        }
        return *::new (static_cast<void*>(data_ + size_++)) T(std::forward<A>(args)...);
    }

    void clear()
    {
        destroy(data_, size_);
        size_ = 0;
    }

    size_t size() const { return size_; }
    bool empty() const { return size_ == 0; }
    size_t capacity() const { return cap_ & ~borrowed; }

    T* data() { return data_; }
    const T* data() const { return data_; }
    T* begin() { return data_; }
    T* end() { return data_ + size_; }
    const T* begin() const { return data_; }
    const T* end() const { return data_ + size_; }
    T& operator[](size_t i) { return data_[i]; }
    const T& operator[](size_t i) const { return data_[i]; }
    T& at(size_t i) { return data_[checkedindex(i)]; }
    const T& at(size_t i) const { return data_[checkedindex(i)]; }
    T& front() { return data_[0]; }
    const T& front() const { return data_[0]; }
    T& back() { return data_[size_ - 1]; }
    const T& back() const { return data_[size_ - 1]; }

    operator std::span<const T>() const { return {data_, size_}; }

    friend bool operator==(const indexlist& a, const indexlist& b)
    {
        return std::equal(a.begin(), a.end(), b.begin(), b.end());
    }
    friend bool operator==(const indexlist& a, const std::vector<T>& b)
    {
        return std::equal(a.begin(), a.end(), b.begin(), b.end());
    }

private:
    static constexpr uint32_t borrowed = 1u << 31;

    static uint32_t checked(size_t n)
    {
        if (n >= borrowed)
            throw std::length_error("indexlist too long");
        return static_cast<uint32_t>(n);
    }
    size_t checkedindex(size_t i) const
    {
        if (i >= size_)
            throw std::out_of_range("indexlist::at");
        return i;
    }

    static void destroy(T* items, size_t n)
    {
        if constexpr (!std::is_trivially_destructible_v<T>)
            std::destroy_n(items, n);
    }

    void regrow(size_t n)
    {
        const uint32_t cap = checked(n);
        T* items = std::allocator<T>().allocate(cap);
        std::uninitialized_move(data_, data_ + size_, items);
        const uint32_t size = size_;
        release();
        data_ = items;
        size_ = size;
        cap_ = cap;
    }

    void release()
    {
        destroy(data_, size_);
        if (data_ && !(cap_ & borrowed))
            std::allocator<T>().deallocate(data_, cap_);
        forget();
    }

    void forget()
    {
        data_ = nullptr;
        size_ = 0;
        cap_ = 0;
    }

    T* data_ = nullptr;
    uint32_t size_ = 0;
    uint32_t cap_ = 0; // capacity, with `borrowed` set for storage the list does not own
};

} // namespace qm
