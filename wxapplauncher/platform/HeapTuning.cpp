#include "platform/HeapTuning.h"

#ifdef __GLIBC__
#include <malloc.h>
#endif

namespace {
// Every picture buffer is larger; the toolkit's small objects stay in the heap.
const int kLargeBlockBytes = 64 * 1024;
} // namespace

void ReturnLargeBlocksToSystem()
{
#ifdef __GLIBC__
    // A fixed threshold also stops glibc raising it after the first large block is freed,
    // which would put every later picture into the heap for good.
    mallopt(M_MMAP_THRESHOLD, kLargeBlockBytes);
#endif
}
