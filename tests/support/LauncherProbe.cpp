// The real launcher with two recorders added, for process-level tests: every modal dialog
// (answered with OK, never shown) and every top-level window that is shown are appended to the
// file named by VELTRONA_PROBE_LOG (a dialog that is no message box also with the texts of its
// controls, one per line); a shown window's client area follows as a "placed" event (title,
// then x, y, width and height in the screen's physical pixels). With VELTRONA_PROBE_COMMAND=<id>,
// the menu command <id> goes to the top window once it is first shown, and its start and end
// are recorded as "command" events (id, then milliseconds since the probe started). With
// VELTRONA_PROBE_SHOW_DIALOGS=1 the dialogs are recorded and then shown for real.
#include "DialogRecorder.h"
#include "StandinRecord.h"
#include "app/Veltro3App.h"

#include <wx/app.h>
#include <wx/eventfilter.h>
#include <wx/frame.h>
#include <wx/init.h>
#include <wx/textctrl.h>
#include <wx/toplevel.h>

#include <chrono>
#include <cstdlib>
#include <string>

namespace {

const auto kStart = std::chrono::steady_clock::now();

std::string Elapsed()
{
    return std::to_string(std::chrono::duration_cast<std::chrono::milliseconds>(
                              std::chrono::steady_clock::now() - kStart)
                              .count());
}

std::string Escape(const wxString& text)
{
    return standin::EscapeField(text.utf8_string());
}

void Append(const std::string& line)
{
    if (const char* path = std::getenv("VELTRONA_PROBE_LOG"))
        standin::AppendRecord(path, line + "\n");
}

int RecordDialog(const RecordedDialog& dialog, const wxDialog* window)
{
    wxString controls;
    for (const wxWindow* child : window->GetChildren()) {
        if (const auto* field = dynamic_cast<const wxTextCtrl*>(child))
            controls += field->GetValue() + "\n";
        else if (const auto* control = dynamic_cast<const wxControl*>(child))
            controls += control->GetLabel() + "\n";
    }
    Append("dialog\t" + Escape(dialog.message) + "\t" + Escape(dialog.caption) + "\t" +
           std::to_string(dialog.style) + "\t" + Escape(controls));
    return wxID_OK;
}

class ShowRecorder : public wxEventFilter
{
protected:
    int FilterEvent(wxEvent& event) override
    {
        if (event.GetEventType() == wxEVT_SHOW && static_cast<wxShowEvent&>(event).IsShown()) {
            if (auto* window = dynamic_cast<wxTopLevelWindow*>(event.GetEventObject())) {
                Append("shown\t" + Escape(window->GetTitle()) + "\t" + Elapsed());
                // Once the toolkit has placed it.
                window->CallAfter([window] {
                    const double scale = window->GetContentScaleFactor();
                    const wxRect area(window->ClientToScreen(wxPoint(0, 0)) * scale,
                                      window->GetClientSize() * scale);
                    Append("placed\t" + Escape(window->GetTitle()) + "\t" + std::to_string(area.x) +
                           "\t" + std::to_string(area.y) + "\t" + std::to_string(area.width) +
                           "\t" + std::to_string(area.height));
                });
                // The main frame, not the start-up splash shown before it.
                auto* frame = dynamic_cast<wxFrame*>(window);
                if (frame && frame->GetMenuBar() && window == wxTheApp->GetTopWindow())
                    SendCommandOnce(window);
            }
        }
        return Event_Skip;
    }

private:
    void SendCommandOnce(wxWindow* window)
    {
        const char* id = std::getenv("VELTRONA_PROBE_COMMAND");
        if (m_commandSent || !id)
            return;
        m_commandSent = true;
        const std::string command = id;
        window->CallAfter([window, command] {
            Append("command\t" + command + "\t" + Elapsed());
            wxCommandEvent event(wxEVT_MENU, std::atoi(command.c_str()));
            event.SetEventObject(window);
            window->ProcessWindowEvent(event);
            Append("command\t" + command + "\t" + Elapsed());
        });
    }

    bool m_commandSent = false;
};

} // namespace

int main(int argc, char** argv)
{
    const bool showDialogs = std::getenv("VELTRONA_PROBE_SHOW_DIALOGS") != nullptr;
    DialogRecorder dialogs([&dialogs, showDialogs](wxDialog* dialog) {
        const int answer = RecordDialog(dialogs.Dialogs().back(), dialog);
        return showDialogs ? int(wxID_NONE) : answer;
    });
    ShowRecorder recorder;
    wxEvtHandler::AddFilter(&recorder);
    // Created where the launcher's own entry point creates it, after the
    // toolkit has read the command line.
    wxApp::SetInitializerFunction([]() -> wxAppConsole* { return new Veltro3App; });
    const int result = wxEntry(argc, argv);
    wxEvtHandler::RemoveFilter(&recorder);
    return result;
}
