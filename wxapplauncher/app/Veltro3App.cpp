#include "app/Veltro3App.h"

#include "about/Splash.h"
#include "frame/Veltro3AppFrame.h"
#include "help/CContextualHelp.h"
#include "help/HelpTool.h"
#include "platform/InstanceLock.h"
#include "platform/PrivateRuntimeDir.h"
#include "resources/Catalogs.h"
#include "settings/UpdateCheck.h"

#include <wx/clipbrd.h>
#include <wx/filename.h>
#include <wx/filesys.h>
#include <wx/fs_mem.h>
#include <wx/log.h>
#include <wx/snglinst.h>
#include <wx/timer.h>
#include <wx/utils.h>

namespace {
const int kSplashMilliseconds = 2000;
const int kMinimumResolutionPreset = 1;
} // namespace

wxBEGIN_EVENT_TABLE(Veltro3App, wxApp) EVT_IDLE(Veltro3App::OnIdle) wxEND_EVENT_TABLE()

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

    const wxLanguage language = static_cast<wxLanguage>(wxLocale::GetSystemLanguage());
    // A locale that is not installed reads as unknown; the texts then stay English.
    if (language != wxLANGUAGE_UNKNOWN)
        m_locale.Init(language, wxLOCALE_LOAD_DEFAULT);
    PrepareTranslations(m_locale, language);

    const wxString launcherDir =
        wxFileName(argv[0], wxPATH_NATIVE).GetPath(wxPATH_GET_VOLUME | wxPATH_GET_SEPARATOR);

    wxFileSystem::AddHandler(new wxMemoryFSHandler);
    LoadCatalogResources();
    wxLocale::AddCatalogLookupPathPrefix("memory:.");
    m_locale.AddCatalog("Veltro");

    wxSetWorkingDirectory(launcherDir);

    if (!CheckScreenResolution(kMinimumResolutionPreset))
        return false;

    const wxString instanceName = GetVendorName() + "." + GetAppName() + "." + wxGetUserId();
    const wxString lockDir = GetPrivateRuntimeDir();
    RemoveStaleInstanceLock(lockDir, instanceName);
    m_singleInstanceChecker = new wxSingleInstanceChecker;
    m_singleInstanceChecker->Create(instanceName, lockDir);

    if (m_singleInstanceChecker->IsAnotherRunning()) {
        // The toolkit does not call OnExit after a failed OnInit.
        OnExit();
        return false;
    }

    ShowSplash(true, kSplashMilliseconds);
    m_splashTimer->Start(kSplashMilliseconds, wxTIMER_ONE_SHOT);

    m_frame = new Veltro3AppFrame(_("Veltrona"), wxDefaultPosition, wxDefaultSize);
    m_frame->Centre(wxBOTH);
    SetTopWindow(m_frame);

    m_contextualHelp = new CContextualHelp(GetAppName());
    m_contextualHelp->Start();
    return true;
}

int Veltro3App::OnExit()
{
    if (wxTheClipboard)
        wxTheClipboard->Flush();
    delete m_splashTimer;
    m_splashTimer = nullptr;
    delete m_singleInstanceChecker;
    m_singleInstanceChecker = nullptr;
    delete m_contextualHelp;
    m_contextualHelp = nullptr;
    return 0;
}

void Veltro3App::OnIdle(wxIdleEvent& event)
{
    if (m_initialised && m_deferredStartupPending && m_frame) // not while the splash yields in OnInit
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

    m_frame->Raise();
    m_frame->Show();

    if (argc > 1)
        m_pendingFile = argv[1];
    if (!m_pendingFile.empty() && m_frame) {
        const wxString path = m_pendingFile;
        m_pendingFile.clear();
        m_frame->OpenInInspect(path);
    }
}

void Veltro3App::OpenPendingFile()
{
    if (m_pendingFile.empty() || m_deferredStartupPending || !m_frame)
        return;
    const wxString path = m_pendingFile;
    m_pendingFile.clear();
    m_frame->OpenInInspect(path);
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
