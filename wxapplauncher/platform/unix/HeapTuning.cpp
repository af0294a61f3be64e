#include "platform/HeapTuning.h"

#include <malloc.h>

namespace {
// Every picture buffer is larger; the toolkit's small objects stay in the heap.
const int kLargeBlockBytes = 64 * 1024;
} // namespace

void ReturnLargeBlocksToSystem()
{
    // A fixed threshold also stops glibc raising it after the first large block is freed,
    // which would put every later picture into the heap for good.
    mallopt(M_MMAP_THRESHOLD, kLargeBlockBytes);
}
