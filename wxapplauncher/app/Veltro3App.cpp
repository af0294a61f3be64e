#include "app/Veltro3App.h"

#include "about/Splash.h"
#include "app/CommandLineFile.h"
#include "app/HandOver.h"
#include "app/Veltro3AppLauncherIPC.h"
#include "frame/Veltro3AppFrame.h"
#include "help/CContextualHelp.h"
#include "help/HelpTool.h"
#include "platform/DisplaySession.h"
#include "platform/HeapTuning.h"
#include "platform/InstanceLock.h"
#include "platform/UserLanguage.h"
#include "resources/Catalogs.h"
#include "settings/UpdateCheck.h"

#include <wx/clipbrd.h>
#include <wx/filename.h>
#include <wx/filesys.h>
#include <wx/fs_mem.h>
#include <wx/log.h>
#include <wx/stdpaths.h>
#include <wx/timer.h>
#include <wx/utils.h>

namespace {
const int kSplashMilliseconds = 2000;
const int kMinimumResolutionPreset = 1;
} // namespace

// clang-format off
wxBEGIN_EVENT_TABLE(Veltro3App, wxApp)
    EVT_IDLE(Veltro3App::OnIdle)
wxEND_EVENT_TABLE()
// clang-format on

Veltro3App* GetVeltro3App()
{
    return dynamic_cast<Veltro3App*>(wxTheApp);
}

Veltro3App::Veltro3App()
    : m_contextualHelp(nullptr), m_initialised(false), m_deferredStartupPending(false),
      m_launcherServer(nullptr), m_singleInstanceChecker(nullptr), m_splashTimer(nullptr),
      m_frame(nullptr)
{
}

Veltro3App::~Veltro3App() = default;

bool Veltro3App::Initialize(int& argc, wxChar** argv)
{
    // The desktop entry's name; the frame's fixed size and the Verify raise need X11 where
    // the session offers it.
    PrepareToolkit("veltrona");
    return wxApp::Initialize(argc, argv);
}

bool Veltro3App::OnInit()
{
    m_initialised = true;
    SetAppName("Veltrona");
    SetVendorName("Zelgrave");

    // Nothing the toolkit logs or asserts is ever shown to the user.
    wxLog::EnableLogging(false);
#ifdef NDEBUG
    wxDisableAsserts();
#endif

    m_deferredStartupPending = true;
    m_contextualHelp = nullptr;
    m_launcherServer = nullptr;
    m_singleInstanceChecker = nullptr;
    m_splashTimer = new wxTimer;

    // Relative paths on the command line name files where the caller stood.
    m_commandLineFile = CommandLineFile(argv, argc, wxGetCwd());

    DecideUserLanguage();
    InitLocale(m_locale);

    // The running executable, not argv[0]: that is a bare name when the
    // launcher is found through PATH, or the path of a link to it.
    const wxString launcherDir = wxFileName(wxStandardPaths::Get().GetExecutablePath())
                                     .GetPath(wxPATH_GET_VOLUME | wxPATH_GET_SEPARATOR);

    wxFileSystem::AddHandler(new wxMemoryFSHandler);
    LoadCatalogResources();
    wxLocale::AddCatalogLookupPathPrefix("memory:.");
    m_locale.AddCatalog("Veltro");

    wxSetWorkingDirectory(launcherDir);

    if (!CheckScreenResolution(kMinimumResolutionPreset))
        return false;

    const wxString instanceName = GetVendorName() + "." + GetAppName() + "." + wxGetUserId();
    m_singleInstanceChecker = new InstanceLock;
    m_singleInstanceChecker->Create(instanceName);

    const wxString serviceName = instanceName + ".ipc";
    if (m_singleInstanceChecker->IsAnotherRunning()) {
        // A later copy ends without a window: 0 when its request reached the
        // running copy, so that whoever started it (a file manager) sees success.
        m_handOverStatus = HandOverToRunningCopy(serviceName, m_commandLineFile) ? 0 : 1;
        return true;
    }

    m_launcherServer = new Veltro3AppLauncherIPCServer;
    if (!m_launcherServer->Create(serviceName)) {
        delete m_launcherServer;
        m_launcherServer = nullptr;
    }

    ShowSplash(true, kSplashMilliseconds);
    // After the splash's first paint: handing blocks back costs time.
    ReturnLargeBlocksToSystem();
    m_splashTimer->Start(kSplashMilliseconds, wxTIMER_ONE_SHOT);

    m_frame = new Veltro3AppFrame(_("Veltrona"), wxDefaultPosition, wxDefaultSize);
    m_frame->Centre(wxBOTH);
    SetTopWindow(m_frame);
    // The toolkit destroys the frame; nothing may reach it afterwards.
    m_frame->Bind(wxEVT_DESTROY, [this](wxWindowDestroyEvent& event) {
        if (event.GetEventObject() == m_frame)
            m_frame = nullptr;
        event.Skip();
    });

    m_contextualHelp = new CContextualHelp(GetAppName());
    m_contextualHelp->Start();
    return true;
}

int Veltro3App::OnRun()
{
    if (m_handOverStatus >= 0)
        return m_handOverStatus;
    return wxApp::OnRun();
}

int Veltro3App::OnExit()
{
    // What the user copied (a path from the help tool) goes to the desktop's clipboard
    // manager and outlives the launcher. Without an input seat GTK's clipboard crashes.
    if (wxTheClipboard && HasInputSeat())
        wxTheClipboard->Flush();
    delete m_splashTimer;
    m_splashTimer = nullptr;
    // The services go before the lock: a copy that takes the lock next finds
    // none of our sockets, and its own are never removed by us.
    delete m_launcherServer;
    m_launcherServer = nullptr;
    delete m_contextualHelp;
    m_contextualHelp = nullptr;
    delete m_singleInstanceChecker;
    m_singleInstanceChecker = nullptr;
    return 0;
}

void Veltro3App::OnIdle(wxIdleEvent& event)
{
    // Not while the splash yields in OnInit, before the frame is made.
    if (m_initialised && m_deferredStartupPending && m_frame)
        RunDeferredStartup();
    event.Skip();
}

void Veltro3App::RunDeferredStartup()
{
    RemoveUpdaterTempFiles();
    m_deferredStartupPending = false;

    // The frame stays hidden for the splash time; events keep flowing meanwhile.
    while (m_splashTimer->IsRunning()) {
        wxMilliSleep(25);
        wxSafeYield(nullptr, false);
    }

    CheckForUpdateAtLaunch();

    if (!m_frame)
        return;
    m_frame->Raise();
    m_frame->Show();

    // The launcher's own file first, then those later copies sent meanwhile.
    if (!m_commandLineFile.empty())
        m_queuedFiles.Insert(m_commandLineFile, 0);
    OpenPendingFile();
}

void Veltro3App::OpenPendingFile()
{
    // Paths that arrive before the frame shows wait in order; none replaces another.
    if (!m_pendingFile.empty()) {
        m_queuedFiles.Add(m_pendingFile);
        m_pendingFile.clear();
    }
    if (m_deferredStartupPending)
        return;
    while (!m_queuedFiles.empty() && m_frame && m_frame->IsShown()) {
        const wxString path = m_queuedFiles[0];
        m_queuedFiles.RemoveAt(0);
        m_frame->OpenInInspect(path);
    }
}

void Veltro3App::ShowContextHelp(const wxString& page)
{
    if (m_contextualHelp)
        m_contextualHelp->ShowTopic(page);
}

void Veltro3App::ShowHelpTool(const wxString& page)
{
    ShowHelpToolDialog(GetAppName(), page);
}
