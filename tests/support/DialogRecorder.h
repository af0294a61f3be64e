// Sees every modal dialog, message boxes included, records it and answers it
// without showing it: with OK, or with what the test's answer function says.
#pragma once

#include <wx/modalhook.h>
#include <wx/msgdlg.h>
#include <wx/string.h>

#include <functional>
#include <utility>
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
    explicit DialogRecorder(std::function<int(wxDialog*)> answer = {}) : m_answer(std::move(answer))
    {
        Register();
    }

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
        return m_answer ? m_answer(dialog) : wxID_OK;
    }

private:
    std::function<int(wxDialog*)> m_answer;
    std::vector<RecordedDialog> m_dialogs;
};
