#include "frame/ModuleCatalog.h"
#include "frame/Veltro3MainAppStandardView.h"

#include "frame/Ids.h"
#include "instrument/MeasuringTable.h"
#include "platform/MessageBox.h"
#include "platform/ProcessStart.h"
#include "platform/WindowActivation.h"

#include <wx/filename.h>
#include <wx/process.h>

namespace {
// The running Verify module's main window, as that program names it.
const char kVerifyWindowClass[] = "TFrm_Main";
} // namespace

void Veltro3MainAppStandardView::LaunchModule(int moduleId, wxString argument)
{
    const ModuleInfo* module = FindModule(moduleId);
    if (!module)
        return;

    // The Monitor module cannot profile while the instrument sits on its table;
    // this is checked before the module is looked for on disk.
    if (moduleId == ID_MODULE_MONITOR && IsInstrumentOnMeasuringTable()) {
        ShowMessageBox(
            _("Please remove the Zel Varo from the Orbis table.\nConnect directly to the "
              "Zel Varo and try again."),
            _("Message"), wxOK | wxCENTRE);
        return;
    }

    // Modules are installed beside the launcher, which runs in its own directory.
    const ModuleCommand command =
        BuildModuleCommand(*module, wxFileName::GetCwd() + wxFILE_SEP_PATH, argument);
    if (!wxFileName::FileExists(command.argv[0]))
        return;

    if (moduleId == ID_MODULE_VERIFY && BringWindowToFront(kVerifyWindowClass, module->displayName))
        return;

    // No parent: the launcher does not follow its modules, and a module that
    // ends after the frame is gone must not reach a destroyed window.
    wxProcess* process = new wxProcess(nullptr, wxID_ANY);
    if (StartProcess(command.argv, process) == 0)
        delete process;
}
