#include "about/ModuleInfo.h"

#include "about/ModuleSplash.h"
#include "about/VersionInfo.h"
#include "frame/Ids.h"
#include "frame/ModuleCatalog.h"

#include <wx/intl.h>

namespace {

// The About Modules entries in menu order, each naming the module it describes.
struct AboutEntry
{
    int commandId;
    int moduleId;
};

const AboutEntry kEntries[] = {
    {ID_ABOUT_PRINTER, ID_MODULE_PRINTER},
    {ID_ABOUT_MONITOR, ID_MODULE_MONITOR},
    {ID_ABOUT_DEVICELINK, ID_MODULE_DEVICELINK},
    {ID_ABOUT_INSPECT, ID_MODULE_INSPECT},
    {ID_ABOUT_EDIT, ID_MODULE_EDIT},
    {ID_ABOUT_VERIFY, ID_MODULE_VERIFY},
};

const ModuleInfo* ModuleOfCommand(int commandId)
{
    for (const AboutEntry& entry : kEntries)
        if (entry.commandId == commandId)
            return FindModule(entry.moduleId);
    return nullptr;
}

} // namespace

wxArrayString ModuleInfoLines(int commandId)
{
    wxArrayString lines;
    const ModuleInfo* module = ModuleOfCommand(commandId);
    if (!module)
        return lines;
    lines.Add(wxString());
    lines.Add(wxString());
    lines.Add(wxGetTranslation(wxString::FromUTF8(module->displayName)));
    lines.Add(_("Version ") + GetFileVersionString(wxString::FromUTF8(module->executable)));
    lines.Add(_("Copyright 2005-2012 Zelgrave, Quenta Group"));
    lines.Add(_("All rights reserved."));
    lines.Add(wxString());
    return lines;
}

void ShowModuleInfo(int commandId)
{
    const wxArrayString lines = ModuleInfoLines(commandId);
    if (!lines.empty())
        new ZelModuleSplashScreen(-1, lines);
}
