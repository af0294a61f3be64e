// The ThreadSanitizer build runs the shared test main without the launcher's
// application; the toolkit's own application class stands in for it.
#pragma once

#include <wx/app.h>

typedef wxApp Veltro3App;
