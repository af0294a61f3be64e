#include "platform/ProcessStart.h"

#include <wx/process.h>
#include <wx/utils.h>

#include <vector>

long StartProcess(const wxArrayString& argv, wxProcess* process)
{
    if (argv.empty())
        return 0;
    std::vector<const wchar_t*> pointers;
    pointers.reserve(argv.size() + 1);
    for (const wxString& element : argv)
        pointers.push_back(element.wc_str());
    pointers.push_back(nullptr);
    return wxExecute(pointers.data(), wxEXEC_ASYNC, process);
}

bool StartProgram(const wxString& path)
{
    wxProcess* process = new wxProcess(nullptr, wxID_ANY);
    if (StartProcess(wxArrayString(1, path), process) != 0)
        return true;
    delete process;
    return false;
}
