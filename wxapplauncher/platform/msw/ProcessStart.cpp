#include "platform/ProcessStart.h"

#include <wx/process.h>
#include <wx/utils.h>

#include <windows.h>

#include <shellapi.h>

namespace {

// One element quoted so that the C runtime's splitting gives it back whole: a
// double quote on each side, as the suite's command lines have them, with the
// back slashes before a quote doubled and any quote inside escaped.
wxString Quote(const wxString& element)
{
    wxString quoted = "\"";
    size_t slashes = 0;
    for (const wxUniChar c : element) {
        if (c == '\\') {
            ++slashes;
            continue;
        }
        quoted.append(c == '"' ? 2 * slashes + 1 : slashes, '\\');
        slashes = 0;
        quoted += c;
    }
    quoted.append(2 * slashes, '\\');
    return quoted + "\"";
}

} // namespace

long StartProcess(const wxArrayString& argv, wxProcess* process)
{
    if (argv.empty())
        return 0;
    wxString command;
    for (const wxString& element : argv)
        command += (command.empty() ? "" : " ") + Quote(element);
    return wxExecute(command, wxEXEC_ASYNC, process);
}

bool StartProgram(const wxString& path)
{
    const HINSTANCE result =
        ShellExecuteW(nullptr, nullptr, path.wc_str(), nullptr, nullptr, SW_SHOWNORMAL);
    return reinterpret_cast<INT_PTR>(result) > 32;
}
