// The suite's updater: its leftover temporary files, the scheduled start at
// launch and the start from Help > "Check for Updates...".
#pragma once

// Removes the updater's temporary files ("ZELUPDATE_*") from the user's
// temporary directory: only regular files of the user's own that no process
// holds open.
void RemoveUpdaterTempFiles();
// Starts the updater when the date in "Next Launch" has come, and only when the
// user's settings file can take the next date.
void CheckForUpdateAtLaunch();
// Starts the updater at once, marked as started by the user.
void CheckForUpdatesNow();
