// How the C library's allocator keeps memory the launcher has freed.
#pragma once

// Large blocks (decoded pictures, screen captures, text renderings) are handed back to
// the system when freed, rather than kept in the heap for later use; without this they
// stay resident after the splash and the About box are done with them.
void ReturnLargeBlocksToSystem();
