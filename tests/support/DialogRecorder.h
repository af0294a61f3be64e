// Sees every modal dialog, message boxes included, records it and answers it
// with OK without showing it.
#pragma once

#include <wx/modalhook.h>
#include <wx/msgdlg.h>
#include <wx/string.h>

#include <vector>

struct RecordedDialog
{
    wxString message;
    wxString caption;
    long style = 0;
};

class DialogRecorder : public wxModalDialogHook
{
public:
    DialogRecorder() { Register(); }

    const std::vector<RecordedDialog>& Dialogs() const { return m_dialogs; }

protected:
    int Enter(wxDialog* dialog) override
    {
        RecordedDialog record;
        record.caption = dialog->GetTitle();
        if (auto* box = dynamic_cast<wxMessageDialog*>(dialog)) {
            record.message = box->GetMessage();
            record.style = box->GetMessageDialogStyle();
        }
        m_dialogs.push_back(record);
        return wxID_OK;
    }

private:
    std::vector<RecordedDialog> m_dialogs;
};
