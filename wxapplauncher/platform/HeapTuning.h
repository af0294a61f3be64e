// How the system's allocator keeps memory the launcher has freed.
#pragma once

// Large blocks (decoded pictures, screen captures, text renderings) are handed back to
// the system when freed, rather than kept in the heap for later use; without this they
// stay resident after the frame and the About box are done with them. Mapping each block
// afresh costs time, so start-up sets this once the splash has painted.
void ReturnLargeBlocksToSystem();
