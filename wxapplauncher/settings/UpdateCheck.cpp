#include "settings/UpdateCheck.h"

// The updater is not wired up yet: nothing is deleted, nothing is started.
void RemoveUpdaterTempFiles() {}
void CheckForUpdateAtLaunch() {}
void CheckForUpdatesNow() {}
