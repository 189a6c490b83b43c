#include "platform/prefaulter.h"

#include <cerrno>
#include <cstdint>

#if defined(__linux__)
#include <sys/mman.h>
#endif

namespace qm {

namespace {

#if defined(__linux__) && defined(MADV_POPULATE_WRITE)
constexpr bool supported = true;
#else
constexpr bool supported = false;
#endif

// False when the system cannot populate memory on request.
bool populate(char* data, size_t bytes)
{
#if defined(__linux__) && defined(MADV_POPULATE_WRITE)
    constexpr size_t page = 4096;
    char* from = reinterpret_cast<char*>((reinterpret_cast<uintptr_t>(data) + page - 1) & ~uintptr_t{page - 1});
    char* to = reinterpret_cast<char*>((reinterpret_cast<uintptr_t>(data) + bytes) & ~uintptr_t{page - 1});
    if (to > from && madvise(from, static_cast<size_t>(to - from), MADV_POPULATE_WRITE) != 0)
        return errno != EINVAL;
    return true;
#else
    (void)data;
    (void)bytes;
    return false;
#endif
}

} // namespace

prefaulter::~prefaulter()
{
    {
        std::lock_guard lock(mutex_);
        stop_ = true;
        queue_.clear();
    }
    wake_.notify_all();
    if (thread_.joinable())
        thread_.join();
}

void prefaulter::request(void* data, size_t bytes)
{
    if (!supported || !data || bytes == 0)
        return;
    {
        std::lock_guard lock(mutex_);
        if (unsupported_ || stop_)
            return;
        queue_.emplace_back(static_cast<char*>(data), bytes);
        if (!thread_.joinable())
            thread_ = std::thread([this] { run(); });
    }
    wake_.notify_one();
}

void prefaulter::finish()
{
    std::unique_lock lock(mutex_);
    idle_.wait(lock, [this] { return queue_.empty() && !busy_; });
}

void prefaulter::run()
{
    std::unique_lock lock(mutex_);
    for (;;) {
        wake_.wait(lock, [this] { return stop_ || !queue_.empty(); });
        if (stop_)
            break;
        const auto [data, bytes] = queue_.front();
        queue_.pop_front();
        busy_ = true;
        lock.unlock();
        const bool ok = populate(data, bytes);
        lock.lock();
        busy_ = false;
        if (!ok) {
            unsupported_ = true;
            queue_.clear();
        }
        if (queue_.empty())
            idle_.notify_all();
    }
    busy_ = false;
    idle_.notify_all();
}

} // namespace qm
