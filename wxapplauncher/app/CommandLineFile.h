// The file named on the launcher's command line, made absolute against the
// directory the launcher was started in.
#pragma once

#include <wx/string.h>

class wxCmdLineArgsArray;

// `path` joined to `base` when it is relative ("./" steps dropped); unchanged when
// absolute; empty when it is empty or relative to an unknown base.
wxString MakeAbsolutePath(const wxString& path, const wxString& base);

// The first argument after the program name, absolute; empty when there is none,
// or when it cannot be carried unchanged (the toolkit drops an argument it cannot
// convert, and the next one must not take its place).
wxString CommandLineFile(const wxCmdLineArgsArray& argv, int argc, const wxString& startDir);
