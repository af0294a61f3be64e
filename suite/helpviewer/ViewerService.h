// The help viewer stand-in's service "Help": every poke is logged, and a poke
// of "<application id>$<page>" on the item "Application" shows that page.
#pragma once

#include "platform/Ipc.h"

#include <functional>

// Called with the application id and the page of each well-formed request.
using ShowPageFunction = std::function<void(const wxString&, const wxString&)>;

class ViewerServer : public IpcServer
{
public:
    explicit ViewerServer(ShowPageFunction showPage);

    wxConnectionBase* OnAcceptConnection(const wxString& topic) override;

private:
    ShowPageFunction m_showPage;
};

// Appends one line to the file named by VELTRONA_HELP_LOG: the kind, then the
// fields, tab-separated and escaped as in a stand-in's start record.
void AppendViewerLog(const std::string& kind, const wxString& first, const wxString& second = "");
