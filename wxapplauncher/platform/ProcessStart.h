// Starting another program from an argument vector.
#pragma once

#include <wx/arrstr.h>

class wxProcess;

// Starts argv[0] with the remaining elements as its arguments, exactly as
// given: no shell, no re-splitting of a command line. Returns the process id,
// or 0 when the program could not be started.
long StartProcess(const wxArrayString& argv, wxProcess* process);
