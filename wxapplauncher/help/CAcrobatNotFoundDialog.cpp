#include "help/CAcrobatNotFoundDialog.h"

#include "controls/ZelLinkText.h"
#include "controls/ZelStaticBitmap.h"
#include "help/Documentation.h"

#include <wx/artprov.h>
#include <wx/button.h>
#include <wx/sizer.h>
#include <wx/stattext.h>

namespace {
const wxWindowID kDialogId = 23456;
const wxWindowID kIconId = 231;
const wxWindowID kTitleId = 200;
const wxWindowID kHintId = 210;
const wxWindowID kLinkId = 211;
const wxWindowID kOkId = 140;
} // namespace

// clang-format off
wxBEGIN_EVENT_TABLE(CAcrobatNotFoundDialog, wxDialog)
    EVT_BUTTON(kOkId, CAcrobatNotFoundDialog::OnOK)
    EVT_CHAR_HOOK(CAcrobatNotFoundDialog::OnCharHook)
wxEND_EVENT_TABLE()
// clang-format on

CAcrobatNotFoundDialog::CAcrobatNotFoundDialog(wxWindow* parent)
    : wxDialog(parent, kDialogId, _("Acrobat Reader not found"), wxDefaultPosition, wxDefaultSize,
               wxCAPTION),
      m_link(nullptr)
{
    auto* main = new wxBoxSizer(wxVERTICAL);
    main->Add(10, 10, 0, wxALIGN_CENTER_HORIZONTAL | wxALL, 5);

    auto* title = new wxBoxSizer(wxHORIZONTAL);
    auto* icon = new ZelStaticBitmap(
        this, kIconId, wxArtProvider::GetBitmap(wxART_WARNING, wxART_CMN_DIALOG), wxDefaultPosition,
        wxDefaultSize, wxNO_BORDER, "zelStaticBitmap");
    // A picture here, not a button: the focus goes to OK, so Return ends the dialog.
    icon->SetFocusable(false);
    title->Add(icon, 0, wxALIGN_CENTER_VERTICAL | wxALL, 5);
    title->Add(10, 15, 0, wxALIGN_CENTER_VERTICAL | wxALL, 5);
    // The title and the hint line are as high as the font needs: 15 and 12
    // pixels cut them in the desktop's font.
    title->Add(new wxStaticText(this, kTitleId, _("Acrobat Reader not found"), wxDefaultPosition,
                                wxDefaultSize, wxALIGN_CENTRE),
               0, wxALIGN_CENTER_VERTICAL);
    title->Add(50, 15, 0, wxALIGN_CENTER_VERTICAL);
    main->Add(title, 0, wxALIGN_CENTER_HORIZONTAL | wxALL, 5);

    auto* hint = new wxBoxSizer(wxHORIZONTAL);
    hint->Add(20, 15, 0, wxALIGN_CENTER_VERTICAL);
    hint->Add(new wxStaticText(this, kHintId, _("Please install a free version from:")), 0,
              wxALIGN_CENTER_VERTICAL);
    main->Add(hint, 0, wxALIGN_CENTER_HORIZONTAL);

    m_link = new ZelLinkText(this, kLinkId, kReaderDownloadPage, wxEmptyString, wxDefaultPosition,
                             wxDefaultSize, wxALIGN_CENTRE, "staticText");
    main->Add(m_link, 0, wxALIGN_CENTER_HORIZONTAL | wxLEFT | wxRIGHT, 20);
    main->Add(20, 5, 0, wxALIGN_CENTER_HORIZONTAL | wxALL, 5);
    auto* ok = new wxButton(this, kOkId, _("OK"));
    ok->SetDefault();
    main->Add(ok, 0, wxALIGN_CENTER_HORIZONTAL | wxALL, 5);
    main->Add(20, 10, 0, wxALIGN_CENTER_HORIZONTAL | wxALL, 5);

    SetSizer(main);
    main->SetSizeHints(this);
}

void CAcrobatNotFoundDialog::OnOK(wxCommandEvent&)
{
    EndModal(wxID_OK);
}

void CAcrobatNotFoundDialog::OnCharHook(wxKeyEvent& event)
{
    // The toolkit maps Escape to a Cancel or OK button by their standard ids,
    // which this dialog's one button does not have.
    if (event.GetKeyCode() == WXK_ESCAPE && IsModal())
        EndModal(wxID_CANCEL);
    else
        event.Skip();
}
