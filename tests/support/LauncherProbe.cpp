// The real launcher with two recorders added, for process-level tests: every
// modal dialog (answered with OK, never shown) and every top-level window that
// is shown are appended to the file named by VELTRONA_PROBE_LOG.
#include "app/Veltro3App.h"

#include <wx/eventfilter.h>
#include <wx/init.h>
#include <wx/modalhook.h>
#include <wx/msgdlg.h>
#include <wx/toplevel.h>

#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <string>

namespace {

const auto kStart = std::chrono::steady_clock::now();

std::string Escape(const wxString& text)
{
    std::string out;
    for (char c : std::string(text.utf8_str())) {
        if (c == '\\')
            out += "\\\\";
        else if (c == '\n')
            out += "\\n";
        else if (c == '\t')
            out += "\\t";
        else
            out += c;
    }
    return out;
}

void Append(const std::string& line)
{
    const char* path = std::getenv("VELTRONA_PROBE_LOG");
    if (!path)
        return;
    if (FILE* file = std::fopen(path, "a")) {
        std::fputs((line + "\n").c_str(), file);
        std::fclose(file);
    }
}

class Recorder : public wxModalDialogHook, public wxEventFilter
{
protected:
    int Enter(wxDialog* dialog) override
    {
        wxString message, caption = dialog->GetTitle();
        long style = 0;
        if (auto* box = dynamic_cast<wxMessageDialog*>(dialog)) {
            message = box->GetMessage();
            style = box->GetMessageDialogStyle();
        }
        Append("dialog\t" + Escape(message) + "\t" + Escape(caption) + "\t" +
               std::to_string(style));
        return wxID_OK;
    }

    int FilterEvent(wxEvent& event) override
    {
        if (event.GetEventType() == wxEVT_SHOW && static_cast<wxShowEvent&>(event).IsShown()) {
            if (auto* window = dynamic_cast<wxTopLevelWindow*>(event.GetEventObject())) {
                const auto elapsed = std::chrono::duration_cast<std::chrono::milliseconds>(
                    std::chrono::steady_clock::now() - kStart);
                Append("shown\t" + Escape(window->GetTitle()) + "\t" +
                       std::to_string(elapsed.count()));
            }
        }
        return Event_Skip;
    }
};

} // namespace

int main(int argc, char** argv)
{
    Recorder recorder;
    recorder.Register();
    wxEvtHandler::AddFilter(&recorder);
    // Created where the launcher's own entry point creates it, after the
    // toolkit has read the command line.
    wxApp::SetInitializerFunction([]() -> wxAppConsole* { return new Veltro3App; });
    const int result = wxEntry(argc, argv);
    wxEvtHandler::RemoveFilter(&recorder);
    return result;
}
