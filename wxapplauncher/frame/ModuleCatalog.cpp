#include "frame/ModuleCatalog.h"

#include "frame/Ids.h"

namespace {

const ModuleInfo kModules[] = {
    {ID_MODULE_PRINTER, "Quenta Print Studio", "Quenta Print Studio.exe"},
    {ID_MODULE_MONITOR, "Zel Display Studio", "Monitor/Zel Display Studio.exe"},
    {ID_MODULE_DEVICELINK, "Quenta Link Studio", "Quenta Link Studio.exe"},
    {ID_MODULE_VERIFY, "Zel Verify Studio", "ZelVerifyStudio.exe"},
    {ID_MODULE_INSPECT, "Quenta Inspect Studio", "Quenta Inspect Studio.exe"},
    {ID_MODULE_EDIT, "Quenta Edit Studio", "Quenta Edit Studio.exe"},
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
    command.argv.Add(directory + wxString::FromUTF8(module.executable));
    if (module.moduleId == ID_MODULE_VERIFY) {
        command.argv.Add(argument.BeforeFirst(' '));
        command.argv.Add(argument.AfterFirst(' '));
    } else if (!argument.empty()) {
        command.argv.Add(argument);
    }
    return command;
}
