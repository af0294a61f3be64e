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

const int kViewerWaitMs = 10000;
const int kViewerRetryMs = 250;

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

CContextualHelp::CContextualHelp(const wxString& appName)
    : m_server(nullptr), m_appName(appName), m_showingTopic(false)
{
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
    // The socket waits below dispatch events, a second F1 among them.
    if (m_showingTopic)
        return;
    m_showingTopic = true;
    std::shared_ptr<void> done(nullptr, [this](void*) { m_showingTopic = false; });
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
    using Clock = std::chrono::steady_clock;
    const auto deadline = Clock::now() + std::chrono::milliseconds(kViewerWaitMs);
    IpcClient client;
    std::unique_ptr<wxConnectionBase> connection;
    while (!connection) {
        wxMilliSleep(kViewerRetryMs);
        const auto left =
            std::chrono::duration_cast<std::chrono::milliseconds>(deadline - Clock::now()).count();
        if (left <= 0)
            return;
        connection.reset(
            client.Connect(m_helpService, "IPC START",
                           static_cast<int>(std::min<long long>(left, kIpcConnectTimeoutMs))));
    }
    connection->Poke("Application", m_applicationId + "$" + page);
}
