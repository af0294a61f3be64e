// The launcher's side of the channel to the suite's help viewer: the program's
// application id, its own help service, and starting the viewer on a page.
#pragma once

#include <wx/string.h>
#include <wx/timer.h>

#include <chrono>

class CContextualIPCServer;

class CContextualHelp
{
public:
    explicit CContextualHelp(const wxString& appName);
    ~CContextualHelp();
    CContextualHelp(const CContextualHelp&) = delete;
    CContextualHelp& operator=(const CContextualHelp&) = delete;

    // IdentifyApplication, then StartServer.
    void Start();
    // The first row of the product table whose name occurs in m_appName gives
    // both ids; without one they stay empty. The viewer's service is "Help".
    void IdentifyApplication();
    // Registers m_serviceName; on failure the launcher runs on without it.
    void StartServer();
    // Starts the help viewer and sends it "<application id>$<page>" once it
    // answers, for at most about ten seconds. The wait runs on the event loop,
    // so the launcher goes on serving its window and its services meanwhile.
    // Does nothing when the viewer is not installed or while a request waits.
    void ShowTopic(const wxString& page);

    CContextualIPCServer* m_server;
    wxString m_serviceName;
    wxString m_applicationId;
    wxString m_appName;
    wxString m_helpService;

private:
    void TryViewer();

    // Runs while a request waits for the viewer.
    wxTimer m_viewerWait;
    std::chrono::steady_clock::time_point m_viewerDeadline;
    wxString m_waitingPage;
};
