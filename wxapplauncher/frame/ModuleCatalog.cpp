#include "frame/ModuleCatalog.h"

#include "frame/Ids.h"

#include <wx/filename.h>
#include <wx/intl.h>

namespace {

// Labels are catalogue keys, translated where they are shown.
const ModuleInfo kModules[] = {
    {ID_MODULE_PRINTER, wxTRANSLATE("Quenta Print Studio"), "Quenta Print Studio.exe",
     ID_BUTTON_PRINTER, wxTRANSLATE("Printer"), wxTRANSLATE("Create &Printer Profile..."),
     ID_ABOUT_PRINTER},
    {ID_MODULE_MONITOR, wxTRANSLATE("Zel Display Studio"), "Monitor/Zel Display Studio.exe",
     ID_BUTTON_MONITOR, wxTRANSLATE("Monitor"), wxTRANSLATE("Create &Monitor Profile..."),
     ID_ABOUT_MONITOR},
    {ID_MODULE_DEVICELINK, wxTRANSLATE("Quenta Link Studio"), "Quenta Link Studio.exe",
     ID_BUTTON_DEVICELINK, wxTRANSLATE("Device Link"),
     wxTRANSLATE("Create &Device Link Profile..."), ID_ABOUT_DEVICELINK},
    {ID_MODULE_VERIFY, wxTRANSLATE("Zel Verify Studio"), "ZelVerifyStudio.exe", ID_BUTTON_VERIFY,
     wxTRANSLATE("Verify"), wxTRANSLATE("&Verify Color..."), ID_ABOUT_VERIFY},
    {ID_MODULE_INSPECT, wxTRANSLATE("Quenta Inspect Studio"), "Quenta Inspect Studio.exe",
     ID_BUTTON_INSPECT, wxTRANSLATE("Inspect"), wxTRANSLATE("&Inspect Profile..."),
     ID_ABOUT_INSPECT},
    {ID_MODULE_EDIT, wxTRANSLATE("Quenta Edit Studio"), "Quenta Edit Studio.exe", ID_BUTTON_EDIT,
     wxTRANSLATE("Edit"), wxTRANSLATE("&Edit Profile..."), ID_ABOUT_EDIT},
};

} // namespace

const ModuleInfo* FindModule(int moduleId)
{
    for (const ModuleInfo& module : kModules)
        if (module.moduleId == moduleId)
            return &module;
    return nullptr;
}

wxString ModuleCommand::CommandLine() const
{
    wxString line;
    for (const wxString& element : argv) {
        if (!line.empty())
            line += ' ';
        line += '"' + element + '"';
    }
    return line;
}

ModuleCommand BuildModuleCommand(const ModuleInfo& module, const wxString& directory,
                                 const wxString& argument)
{
    ModuleCommand command;
    // With the system's own separators: a module that splits its own path on them
    // (Monitor's, in a sub-folder) must find its folder.
    command.argv.Add(wxFileName(directory + wxString::FromUTF8(module.executable)).GetFullPath());
    if (module.moduleId == ID_MODULE_VERIFY) {
        command.argv.Add(argument.BeforeFirst(' '));
        command.argv.Add(argument.AfterFirst(' '));
    } else if (!argument.empty()) {
        command.argv.Add(argument);
    }
    return command;
}
