// The launcher's application object: start-up checks, the per-user instance
// lock, the deferred start-up on the first idle event, and shutdown.
#pragma once

#include <wx/app.h>
#include <wx/arrstr.h>
#include <wx/intl.h>
#include <wx/string.h>

class wxIdleEvent;
class InstanceLock;
class wxTimer;
class CContextualHelp;
class Veltro3AppLauncherIPCServer;
class Veltro3AppFrame;

class Veltro3App : public wxApp
{
public:
    Veltro3App();
    ~Veltro3App() override;

    bool Initialize(int& argc, wxChar** argv) override;
    bool OnInit() override;
    // A later copy that handed over ends here with its status, without an event loop.
    int OnRun() override;
    int OnExit() override;

    void OnIdle(wxIdleEvent& event);
    void RunDeferredStartup();
    void OpenPendingFile();
    // Whether the screen offers the preset and room for the launcher's windows at the
    // desktop's scale; shows the message when it does not.
    bool CheckScreenResolution(int preset);
    static void GetMinimumResolution(int preset, int& width, int& height);

    void ShowContextHelp(const wxString& page);
    void ShowHelpTool(const wxString& page);

    CContextualHelp* m_contextualHelp;
    bool m_initialised;
    bool m_deferredStartupPending;
    Veltro3AppLauncherIPCServer* m_launcherServer;
    InstanceLock* m_singleInstanceChecker;
    wxTimer* m_splashTimer;
    wxLocale m_locale;
    wxString m_pendingFile;
    Veltro3AppFrame* m_frame;
    // Paths to open once the frame shows, oldest first.
    wxArrayString m_queuedFiles;

private:
    // The first command-line argument, absolute; empty when it cannot be used.
    wxString m_commandLineFile;
    // The exit status of a later copy once it has handed over; -1 in the running copy.
    int m_handOverStatus = -1;

    wxDECLARE_EVENT_TABLE();
};

// The running application object, or null when the toolkit runs another one.
Veltro3App* GetVeltro3App();
