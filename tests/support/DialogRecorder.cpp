#include "support/DialogRecorder.h"

#include <wx/msgdlg.h>

int DialogRecorder::Enter(wxDialog* dialog)
{
    RecordedDialog record;
    if (auto* box = dynamic_cast<wxMessageDialog*>(dialog)) {
        record.message = box->GetMessage();
        record.caption = box->GetTitle();
        record.style = box->GetMessageDialogStyle();
    } else {
        record.caption = dialog->GetTitle();
    }
    m_dialogs.push_back(record);
    return wxID_OK;
}
