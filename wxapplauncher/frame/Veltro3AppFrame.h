// The launcher's main window: the launcher view, the File and Help menus and
// the handlers that pass each command on.
#pragma once

#include <wx/frame.h>

class wxBoxSizer;
class Veltro3MainAppStandardView;

class Veltro3AppFrame : public wxFrame
{
public:
    Veltro3AppFrame(const wxString& title, const wxPoint& pos, const wxSize& size);
    ~Veltro3AppFrame() override;

    // Opens a file in the Inspect module.
    void OpenInInspect(const wxString& path);

    Veltro3MainAppStandardView* GetStandardView() const { return m_standardView; }

private:
    void BuildMenuBar();

    void OnLaunchPrinter(wxCommandEvent& event);
    void OnLaunchMonitor(wxCommandEvent& event);
    void OnLaunchDeviceLink(wxCommandEvent& event);
    void OnLaunchInspect(wxCommandEvent& event);
    void OnLaunchEdit(wxCommandEvent& event);
    void OnLaunchVerify(wxCommandEvent& event);
    void OnHelp(wxCommandEvent& event);
    void OnUserGuide(wxCommandEvent& event);
    void OnUserForum(wxCommandEvent& event);
    void OnHelpTool(wxCommandEvent& event);
    void OnCheckForUpdates(wxCommandEvent& event);
    void OnExitCommand(wxCommandEvent& event);
    void OnSize(wxSizeEvent& event);
    void OnAbout(wxCommandEvent& event);
    void OnAboutModule(wxCommandEvent& event);
    void OnHowTo(wxCommandEvent& event);
    void OnClose(wxCloseEvent& event);

    wxBoxSizer* m_sizer;
    // The client area the launcher picture needs, kept whatever the decorations take.
    wxSize m_fixedClientSize;
    bool m_decorationsCounted = false;
    Veltro3MainAppStandardView* m_standardView;

    wxDECLARE_EVENT_TABLE();
};
