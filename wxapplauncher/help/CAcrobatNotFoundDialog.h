// Shown when the desktop has no PDF reader: says where a free one is found.
#pragma once

#include <wx/dialog.h>

class ZelLinkText;

class CAcrobatNotFoundDialog : public wxDialog
{
public:
    explicit CAcrobatNotFoundDialog(wxWindow* parent);

    void OnOK(wxCommandEvent& event);
    void OnCharHook(wxKeyEvent& event);

    ZelLinkText* m_link;

private:
    wxDECLARE_EVENT_TABLE();
};
