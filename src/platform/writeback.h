#pragma once
// Hints to the operating system about a file being written.

#include <cstdint>

namespace qm {

// Starts writing bytes [offset, offset + bytes) of an open file to the disk
// without waiting for them, so that a large file written in one go is mostly
// on the disk already when the final sync makes it durable. Does nothing
// where the system has no such call; never reports failure (the final sync
// does).
void startwriteback(int fd, int64_t offset, int64_t bytes);

} // namespace qm
