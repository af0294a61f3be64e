// Runs the tests in a child process and stays behind as its reaper: whatever the tests leave
// running (their own children and everything orphaned below them) is ended once they end,
// however they end, so that nothing of one test outlives it on a shared display.
#pragma once

// Returns in the child that runs the tests; in the reaper it never returns, but exits as
// the child did. Under a debugger it only returns, so that the debugger stays with the tests.
void RunUnderReaper();
