#include "ViewerService.h"

#include "StandinProcess.h"
#include "StandinRecord.h"

#include <wx/app.h>

namespace {

class ViewerConnection : public IpcConnection
{
public:
    explicit ViewerConnection(const ShowPageFunction& showPage) : m_showPage(showPage) {}

    bool OnPoke(const wxString&, const wxString& item, const void* data, size_t size,
                wxIPCFormat format) override
    {
        wxString text;
        if (!ReadPokeText(data, size, format, text)) {
            AppendViewerLog("refused", item);
            return false;
        }
        AppendViewerLog("poke", item, text);
        const int dollar = text.Find('$');
        if (item != "Application" || dollar == wxNOT_FOUND)
            return false;
        // Shown after the sender's conversation has ended, not inside its poke.
        const wxString applicationId = text.Left(dollar), page = text.Mid(dollar + 1);
        const ShowPageFunction showPage = m_showPage;
        wxTheApp->CallAfter([showPage, applicationId, page] { showPage(applicationId, page); });
        return true;
    }

private:
    ShowPageFunction m_showPage;
};

} // namespace

ViewerServer::ViewerServer(ShowPageFunction showPage) : m_showPage(std::move(showPage)) {}

wxConnectionBase* ViewerServer::OnAcceptConnection(const wxString& topic)
{
    return topic == "IPC START" ? new ViewerConnection(m_showPage) : nullptr;
}

void AppendViewerLog(const std::string& kind, const wxString& first, const wxString& second)
{
    const std::string log = standin::EnvironmentValue("VELTRONA_HELP_LOG");
    if (log.empty())
        return;
    std::string line = kind + "\t" + standin::EscapeField(std::string(first.utf8_str()));
    if (!second.empty())
        line += "\t" + standin::EscapeField(std::string(second.utf8_str()));
    standin::AppendRecord(log, line + "\n");
}
