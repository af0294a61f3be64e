#include "help/CContextualHelp.h"

#include "help/CContextualIPC.h"
#include "platform/ProcessStart.h"

#include <wx/filefn.h>
#include <wx/filename.h>
#include <wx/log.h>
#include <wx/stdpaths.h>
#include <wx/utils.h>

#include <algorithm>
#include <chrono>
#include <memory>

namespace {

struct ApplicationRow
{
    const char* productName;
    const char* applicationId;
};

const ApplicationRow kApplications[] = {
    {"Veltrona", "LaunchPad"},
    {"Quenta Link Studio", "LinkStudio"},
    {"Quenta Print Studio", "PrintStudio"},
    {"Quenta Edit Studio", "EditStudio"},
    {"Quenta Inspect Studio", "InspectStudio"},
    {"VerifyStudio", "VerifyAssist"},
    {"Quenta Display Studio", "DisplayStudio"},
};

const auto kViewerWait = std::chrono::milliseconds(10000);
const int kViewerRetryMs = 250;
// Each attempt holds the GUI thread at most this long.
const int kViewerAttemptMs = 250;

// The installation folder, with its trailing separator; the monitor module
// lives one folder below it.
wxString InstallationDir()
{
    const wxFileName exe(wxStandardPaths::Get().GetExecutablePath());
    wxFileName dir = wxFileName::DirName(exe.GetPath());
    if (exe.GetName() == "Zel Display Studio")
        dir.RemoveLastDir();
    return dir.GetPath(wxPATH_GET_VOLUME | wxPATH_GET_SEPARATOR);
}

} // namespace

CContextualHelp::CContextualHelp(const wxString& appName) : m_server(nullptr), m_appName(appName)
{
    m_viewerWait.Bind(wxEVT_TIMER, [this](wxTimerEvent&) { TryViewer(); });
}

CContextualHelp::~CContextualHelp()
{
    delete m_server;
}

void CContextualHelp::Start()
{
    IdentifyApplication();
    StartServer();
}

void CContextualHelp::IdentifyApplication()
{
    for (const ApplicationRow& row : kApplications) {
        if (m_appName.Contains(row.productName)) {
            m_serviceName = row.applicationId;
            m_applicationId = row.applicationId;
            break;
        }
    }
    m_helpService = "Help";
}

void CContextualHelp::StartServer()
{
    m_server = new CContextualIPCServer;
    if (!m_server->Create(m_serviceName)) {
        delete m_server;
        m_server = nullptr;
    }
}

void CContextualHelp::ShowTopic(const wxString& page)
{
    if (m_viewerWait.IsRunning())
        return;
    wxLogNull noLog;

    const wxString installDir = InstallationDir();
    const wxString viewer = installDir + "Help" + wxString(wxFILE_SEP_PATH) + "Veltrona Help.exe";
    if (!wxFileExists(viewer))
        return;

    const wxString previousDir = wxGetCwd();
    wxSetWorkingDirectory(installDir);
    StartProcess(wxArrayString(1, &viewer), nullptr);
    wxSetWorkingDirectory(previousDir);

    // One deadline for the whole wait: attempts that each time out must not add up.
    m_viewerDeadline = std::chrono::steady_clock::now() + kViewerWait;
    m_waitingPage = page;
    m_viewerWait.Start(kViewerRetryMs, wxTIMER_ONE_SHOT);
}

void CContextualHelp::TryViewer()
{
    wxLogNull noLog;
    const auto left = std::chrono::duration_cast<std::chrono::milliseconds>(
                          m_viewerDeadline - std::chrono::steady_clock::now())
                          .count();
    if (left <= 0)
        return;
    IpcClient client;
    std::unique_ptr<wxConnectionBase> connection(client.Connect(
        m_helpService, "IPC START", static_cast<int>(std::min<long long>(left, kViewerAttemptMs))));
    if (connection)
        connection->Poke("Application", m_applicationId + "$" + m_waitingPage);
    else
        m_viewerWait.Start(kViewerRetryMs, wxTIMER_ONE_SHOT);
}
