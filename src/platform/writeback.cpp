#include "platform/writeback.h"

#if defined(__linux__)
#include <fcntl.h>
#endif

namespace qm {

void startwriteback(int fd, int64_t offset, int64_t bytes)
{
#if defined(__linux__) && defined(SYNC_FILE_RANGE_WRITE)
    if (fd >= 0 && bytes > 0)
        (void)sync_file_range(fd, offset, bytes, SYNC_FILE_RANGE_WRITE);
#else
    (void)fd;
    (void)offset;
    (void)bytes;
#endif
}

} // namespace qm
