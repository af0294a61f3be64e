// The anchor: a bare toolkit frame of the splash's size with a menu bar. Prints the time
// of its first paint and, once shown and idle, its peak resident memory.
#include "Clock.h"

#include <wx/wx.h>

namespace {

class BareFrame : public wxFrame
{
public:
    BareFrame() : wxFrame(nullptr, wxID_ANY, "Bare", wxDefaultPosition, wxSize(445, 425))
    {
        auto* bar = new wxMenuBar;
        auto* file = new wxMenu;
        file->Append(wxID_EXIT, "E&xit");
        bar->Append(file, "&File");
        auto* help = new wxMenu;
        help->Append(wxID_ABOUT, "&About");
        bar->Append(help, "&Help");
        SetMenuBar(bar);
        Bind(wxEVT_PAINT, &BareFrame::OnPaint, this);
    }

private:
    void OnPaint(wxPaintEvent&)
    {
        wxPaintDC dc(this);
        if (m_painted)
            return;
        m_painted = true;
        std::printf("first_paint %lld\nfirst_paint_cpu_us %lld\n", NowNs(), ThreadCpuUs());
        CallAfter([this] {
            std::printf("peak_rss_kb %ld\n", PeakRssKb());
            std::fflush(stdout);
            Close(true);
        });
    }

    bool m_painted = false;
};

class BareApp : public wxApp
{
public:
    bool OnInit() override
    {
        (new BareFrame)->Show();
        return true;
    }
};

} // namespace

wxIMPLEMENT_APP(BareApp);
