#include "platform/memoryhint.h"

#include <cstdint>

#if defined(__linux__)
#include <sys/mman.h>
#endif

namespace qm {

void hintlargememory(void* data, size_t bytes)
{
#if defined(__linux__) && defined(MADV_HUGEPAGE)
    constexpr uintptr_t huge = 2u << 20;
    if (bytes < huge)
        return;
    // Only whole large pages inside the block.
    const uintptr_t from = (reinterpret_cast<uintptr_t>(data) + huge - 1) & ~(huge - 1);
    const uintptr_t to = (reinterpret_cast<uintptr_t>(data) + bytes) & ~(huge - 1);
    if (to > from)
        madvise(reinterpret_cast<void*>(from), to - from, MADV_HUGEPAGE);
#else
    (void)data;
    (void)bytes;
#endif
}

} // namespace qm
