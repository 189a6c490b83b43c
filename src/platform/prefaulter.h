#pragma once
// Brings fresh memory in ahead of its use, on a thread of its own.
//
// Filling hundreds of megabytes of new memory is much of a big load's time,
// and most of that goes to the system providing and clearing each page at its
// first touch. A prefaulter has that done on another processor while the load
// goes on, so that the loading thread finds the pages ready. Where the system
// has no call for it, requests are dropped.

#include <condition_variable>
#include <cstddef>
#include <deque>
#include <mutex>
#include <thread>
#include <utility>

namespace qm {

class prefaulter {
public:
    prefaulter() = default;
    ~prefaulter(); // drops what is still asked for and waits for what is under way
    prefaulter(const prefaulter&) = delete;
    prefaulter& operator=(const prefaulter&) = delete;

    // Asks for [data, data + bytes) to be brought in, after earlier requests.
    // The memory must stay allocated until finish() or the prefaulter's end.
    void request(void* data, size_t bytes);
    // Waits until every request so far has been handled.
    void finish();

private:
    void run();

    std::mutex mutex_;
    std::condition_variable wake_, idle_;
    std::deque<std::pair<char*, size_t>> queue_;
    bool stop_ = false;
    bool busy_ = false;
    bool unsupported_ = false;
    std::thread thread_;
};

} // namespace qm
