#include "help/HelpTool.h"

#include "help/CHelpToolDlg.h"

void ShowHelpToolDialog(const wxString& appName, const wxString& page)
{
    CHelpToolDlg dialog(appName, page, nullptr, wxID_ANY, "Quenta Contextual Help Tool",
                        wxDefaultPosition, wxSize(625, 200), wxDEFAULT_DIALOG_STYLE);
    dialog.ShowModal();
}
