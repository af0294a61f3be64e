// The launcher's side of the channel to the suite's help viewer: the program's
// application id, its own help service, and starting the viewer on a page.
#pragma once

#include <wx/string.h>

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
    // Starts the help viewer and sends it "<application id>$<page>". Waits at
    // most about ten seconds for the viewer; returns at once when it is not
    // installed or when another request is still waiting.
    void ShowTopic(const wxString& page);

    CContextualIPCServer* m_server;
    wxString m_serviceName;
    wxString m_applicationId;
    wxString m_appName;
    wxString m_helpService;

private:
    bool m_showingTopic;
};
