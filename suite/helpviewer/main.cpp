// Stands in for the suite's help viewer: started from the installation
// directory, it serves "Help" on the topic "IPC START" and shows each page it
// is asked for from the installation's Documentation folder. A copy started
// while another one serves leaves the pages to that one and ends.
#include "HelpPages.h"
#include "StandinProcess.h"
#include "StandinRecord.h"
#include "ViewerService.h"

#include <wx/app.h>
#include <wx/frame.h>
#include <wx/html/htmlwin.h>
#include <wx/log.h>

namespace {

class HelpViewerApp : public wxApp
{
public:
    bool OnInit() override
    {
        wxLog::EnableLogging(false);
        const std::string log = standin::EnvironmentValue("VELTRONA_STANDIN_LOG");
        if (!log.empty())
            standin::AppendRecord(log, standin::FormatRecord({std::string(argv[0].utf8_str())},
                                                             standin::ProcessId(),
                                                             standin::CurrentDirectory()));
        m_installDir = wxString::FromUTF8(standin::CurrentDirectory());

        IpcClient client;
        if (wxConnectionBase* running = client.Connect("Help", "IPC START")) {
            delete running;
            return false;
        }

        m_frame =
            new wxFrame(nullptr, wxID_ANY, "Veltrona Help", wxDefaultPosition, wxSize(640, 480));
        m_page = new wxHtmlWindow(m_frame);
        m_server = new ViewerServer([this](const wxString& applicationId, const wxString& page) {
            Show(applicationId, page);
        });
        if (!m_server->Create("Help")) {
            m_frame->Destroy();
            return false;
        }
        m_frame->Show();
        return true;
    }

    int OnExit() override
    {
        delete m_server;
        return 0;
    }

private:
    void Show(const wxString& applicationId, const wxString& page)
    {
        const wxString path = FindHelpPage(m_installDir, applicationId, page);
        AppendViewerLog("page", path);
        m_page->LoadPage(path);
        m_frame->Raise();
    }

    wxString m_installDir;
    wxFrame* m_frame = nullptr;
    wxHtmlWindow* m_page = nullptr;
    ViewerServer* m_server = nullptr;
};

} // namespace

wxIMPLEMENT_APP(HelpViewerApp);
