#include "platform/HeapTuning.h"

void ReturnLargeBlocksToSystem()
{
    // The Windows heap decommits large freed blocks by itself.
}
