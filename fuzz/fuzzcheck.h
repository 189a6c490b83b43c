#pragma once
// What a fuzz target does when a promise of the code under test is broken:
// abort, which libFuzzer reports with the input that did it.

#include <cstdlib>

namespace qmfuzz {

inline void check(bool ok)
{
    if (!ok)
        std::abort();
}

} // namespace qmfuzz
