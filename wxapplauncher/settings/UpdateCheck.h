// The suite's updater: leftover temporary files, the scheduled and the manual check.
#pragma once

void RemoveUpdaterTempFiles();
void CheckForUpdateAtLaunch();
void CheckForUpdatesNow();
