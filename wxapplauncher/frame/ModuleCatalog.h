// The suite's six modules: ids, labels, product names and executables, and the
// command line that starts one of them.
#pragma once

#include <wx/arrstr.h>
#include <wx/string.h>

struct ModuleInfo
{
    int moduleId;
    const char* displayName; // product name; also the Verify window's title
    const char* executable;  // relative to the launcher's directory
    int buttonId;            // the launcher view's button
    const char* buttonLabel; // untranslated catalogue keys
    const char* menuLabel;
    int aboutId; // its entry in the About Modules submenu
};

// The catalogue entry of a module id, or null when the id names no module.
const ModuleInfo* FindModule(int moduleId);

// What starting a module means: the program and its arguments, unquoted.
struct ModuleCommand
{
    wxArrayString argv;

    // The same as one line, every element in double quotes, as it is shown.
    wxString CommandLine() const;
};

// The command for a module installed in `directory` (with a trailing
// separator), given the launch argument. Verify's argument is split at its
// first blank into the tag and the language number.
ModuleCommand BuildModuleCommand(const ModuleInfo& module, const wxString& directory,
                                 const wxString& argument);
