#include "platform/MessageBox.h"

#include <wx/msgdlg.h>

int ShowMessageBox(const wxString& message, const wxString& caption, long style)
{
    // The native box shows the caption as its title and the style's icon.
    return wxMessageBox(message, caption, style);
}
