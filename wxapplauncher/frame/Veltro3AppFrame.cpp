#include "frame/Veltro3AppFrame.h"

#include "about/ModuleInfo.h"
#include "about/Splash.h"
#include "app/Veltro3App.h"
#include "frame/Ids.h"
#include "frame/ModuleCatalog.h"
#include "frame/Veltro3MainAppStandardView.h"
#include "help/Documentation.h"
#include "platform/DisplaySession.h"
#include "resources/IconBundle.h"
#include "resources/ImageSets.h"
#include "settings/UpdateCheck.h"

#include <wx/accel.h>
#include <wx/menu.h>
#include <wx/sizer.h>

namespace {
const wxString kLauncherPage = "Launcher.html";
} // namespace

// clang-format off
wxBEGIN_EVENT_TABLE(Veltro3AppFrame, wxFrame)
    EVT_MENU(ID_MODULE_PRINTER, Veltro3AppFrame::OnLaunchPrinter)
    EVT_MENU(ID_MODULE_MONITOR, Veltro3AppFrame::OnLaunchMonitor)
    EVT_MENU(ID_MODULE_DEVICELINK, Veltro3AppFrame::OnLaunchDeviceLink)
    EVT_MENU(ID_MODULE_INSPECT, Veltro3AppFrame::OnLaunchInspect)
    EVT_MENU(ID_MODULE_EDIT, Veltro3AppFrame::OnLaunchEdit)
    EVT_MENU(ID_MODULE_VERIFY, Veltro3AppFrame::OnLaunchVerify)
    EVT_MENU(ID_HELP, Veltro3AppFrame::OnHelp)
    EVT_MENU(ID_USER_GUIDE, Veltro3AppFrame::OnUserGuide)
    EVT_MENU(ID_USER_FORUM, Veltro3AppFrame::OnUserForum)
    EVT_MENU(ID_HELP_TOOL, Veltro3AppFrame::OnHelpTool)
    EVT_MENU(ID_CHECK_UPDATES, Veltro3AppFrame::OnCheckForUpdates)
    EVT_MENU(ID_EXIT, Veltro3AppFrame::OnExitCommand)
    EVT_MENU(ID_ABOUT, Veltro3AppFrame::OnAbout)
    EVT_MENU_RANGE(ID_ABOUT_PRINTER, ID_ABOUT_VERIFY, Veltro3AppFrame::OnAboutModule)
    EVT_MENU(ID_HOW_TO, Veltro3AppFrame::OnHowTo)
    EVT_CLOSE(Veltro3AppFrame::OnClose)
    EVT_SIZE(Veltro3AppFrame::OnSize)
    EVT_BUTTON(ID_BUTTON_HELP, Veltro3AppFrame::OnHelp)
wxEND_EVENT_TABLE()
// clang-format on

Veltro3AppFrame::Veltro3AppFrame(const wxString& title, const wxPoint& pos, const wxSize& size)
    : m_sizer(nullptr), m_standardView(nullptr)
{
    Create(nullptr, wxID_ANY, title, pos, size,
           wxCAPTION | wxSYSTEM_MENU | wxMINIMIZE_BOX | wxCLOSE_BOX | wxCLIP_CHILDREN);

    EnsureLauncherImages();
    EnsureHelpImages();
    SetIcons(LoadIconBundle("IDI_ICON1", 32));

    BuildMenuBar();

    m_standardView = new Veltro3MainAppStandardView(this, wxID_ANY, wxDefaultPosition,
                                                    wxDefaultSize, wxTAB_TRAVERSAL, "panel");
    m_sizer = new wxBoxSizer(wxVERTICAL);
    m_sizer->Add(m_standardView, 1, wxEXPAND, 0);
    m_standardView->UpdateModuleButtons();

    // Fitted to the view, then fixed: the launcher picture does not scale.
    SetSizer(m_sizer);
    m_sizer->Fit(this);
    m_sizer->SetSizeHints(this);
    SetMinSize(GetSize());
    SetMaxSize(GetSize());
    m_fixedClientSize = GetClientSize();

    wxAcceleratorEntry helpTool(wxACCEL_ALT | wxACCEL_SHIFT, WXK_F1, ID_HELP_TOOL);
    SetAcceleratorTable(wxAcceleratorTable(1, &helpTool));
}

Veltro3AppFrame::~Veltro3AppFrame() = default;

void Veltro3AppFrame::BuildMenuBar()
{
    // The File menu and the About Modules submenu list the modules in the
    // same order, the File menu with a separator after the three creators.
    const int order[] = {ID_MODULE_PRINTER, ID_MODULE_MONITOR, ID_MODULE_DEVICELINK,
                         ID_MODULE_INSPECT, ID_MODULE_EDIT,    ID_MODULE_VERIFY};
    wxMenu* file = new wxMenu;
    wxMenu* modules = new wxMenu;
    for (int moduleId : order) {
        const ModuleInfo* module = FindModule(moduleId);
        if (moduleId == ID_MODULE_INSPECT)
            file->AppendSeparator();
        file->Append(moduleId, wxGetTranslation(module->menuLabel), wxString());
        modules->Append(module->aboutId, wxGetTranslation(module->displayName), wxString());
    }
    file->AppendSeparator();
    file->Append(ID_EXIT, _("E&xit"), wxString());

    wxMenu* help = new wxMenu;
    help->Append(ID_HELP, _("Veltrona &Help\tF1"), wxString());
    help->Append(ID_USER_GUIDE, _("User &Guide"), wxString());
    help->Append(ID_USER_FORUM, _("User &Forum"), wxString());
    help->Append(ID_HOW_TO, _("H&ow-To"), wxString());
    help->AppendSeparator();
    help->Append(ID_ABOUT, _("&About Veltrona"), wxString());
    help->Append(ID_ABOUT_MODULES, _("About &Modules"), modules, wxString());
    help->AppendSeparator();
    help->Append(ID_CHECK_UPDATES, _("Check for &Updates..."), wxString());

    wxMenuBar* menuBar = new wxMenuBar;
    menuBar->Append(file, _("&File"));
    menuBar->Append(help, _("&Help"));
    SetMenuBar(menuBar);
}

void Veltro3AppFrame::OpenInInspect(const wxString& path)
{
    if (m_standardView)
        m_standardView->LaunchModule(ID_MODULE_INSPECT, path);
}

// The File menu's module commands end in the view's handlers, like its buttons.
void Veltro3AppFrame::OnLaunchPrinter(wxCommandEvent& event)
{
    m_standardView->OnLaunchPrinter(event);
}

void Veltro3AppFrame::OnLaunchMonitor(wxCommandEvent& event)
{
    m_standardView->OnLaunchMonitor(event);
}

void Veltro3AppFrame::OnLaunchDeviceLink(wxCommandEvent& event)
{
    m_standardView->OnLaunchDeviceLink(event);
}

void Veltro3AppFrame::OnLaunchInspect(wxCommandEvent& event)
{
    m_standardView->OnLaunchInspect(event);
}

void Veltro3AppFrame::OnLaunchEdit(wxCommandEvent& event)
{
    m_standardView->OnLaunchEdit(event);
}

void Veltro3AppFrame::OnLaunchVerify(wxCommandEvent& event)
{
    m_standardView->OnLaunchVerify(event);
}

void Veltro3AppFrame::OnHelp(wxCommandEvent&)
{
    if (Veltro3App* app = GetVeltro3App())
        app->ShowContextHelp(kLauncherPage);
}

void Veltro3AppFrame::OnUserGuide(wxCommandEvent&)
{
    OpenUserGuide();
}

void Veltro3AppFrame::OnUserForum(wxCommandEvent&)
{
    OpenUserForum();
}

void Veltro3AppFrame::OnHelpTool(wxCommandEvent&)
{
    if (Veltro3App* app = GetVeltro3App())
        app->ShowHelpTool(kLauncherPage);
}

void Veltro3AppFrame::OnCheckForUpdates(wxCommandEvent&)
{
    CheckForUpdatesNow();
}

void Veltro3AppFrame::OnExitCommand(wxCommandEvent&)
{
    Close(false);
}

void Veltro3AppFrame::OnAbout(wxCommandEvent&)
{
    ShowSplash(false, 3000);
}

void Veltro3AppFrame::OnAboutModule(wxCommandEvent& event)
{
    ShowModuleInfo(event.GetId());
}

void Veltro3AppFrame::OnHowTo(wxCommandEvent&)
{
    OpenHowTo();
}

void Veltro3AppFrame::OnClose(wxCloseEvent&)
{
    Show(false);
    Destroy();
}

void Veltro3AppFrame::OnSize(wxSizeEvent& event)
{
    // Decorations the toolkit draws itself count in the fixed size, which the
    // toolkit set before it knew them: what the view lost then goes back
    // into the size, once, so that a window manager that imposes sizes cannot make
    // it grow without end.
    const wxSize missing = m_fixedClientSize - GetClientSize();
    if (!m_decorationsCounted && IsShown() && missing != wxSize() && !AreDecorationsOutsideSize()) {
        m_decorationsCounted = true;
        SetMinSize(GetMinSize() + missing);
        SetMaxSize(GetMaxSize() + missing);
        SetSize(GetSize() + missing);
    }
    event.Skip();
}
