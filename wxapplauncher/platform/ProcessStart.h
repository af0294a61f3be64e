// Starting other programs.
#pragma once

#include <wx/arrstr.h>

#include <wx/string.h>

class wxProcess;

// Starts argv[0] with the remaining elements as its arguments, exactly as
// given: no shell, no re-splitting of a command line. Returns the process id,
// or 0 when the program could not be started.
long StartProcess(const wxArrayString& argv, wxProcess* process);

// Starts the program at `path` without arguments and without watching it, the
// way the desktop starts a program the user opens. False when it could not be
// started.
bool StartProgram(const wxString& path);
