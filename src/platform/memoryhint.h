#pragma once
// Hints to the operating system about large blocks of memory.

#include <cstddef>

namespace qm {

// Asks for large pages behind a large block that will be filled from the
// start (a table reserved for a big file): touching fresh memory a page at a
// time is a large part of loading a big file. Does nothing where the system
// has no such hint, or for small blocks.
void hintlargememory(void* data, size_t bytes);

} // namespace qm
