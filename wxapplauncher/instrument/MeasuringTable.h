// Asks the instrument library, through a short-lived client, whether the
// instrument sits on its measuring table.
#pragma once

// True exactly when an instrument answers and it is on the measuring table.
// The client is gone again when this returns.
bool IsInstrumentOnMeasuringTable();
