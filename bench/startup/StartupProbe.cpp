// The real launcher with a recorder: the start-up splash's first paint, the frame shown,
// then the About box's scrolling (CPU time per tick, the largest area repainted) and the
// peak resident memory with the About box open.
#include "Clock.h"
#include "about/Splash.h"
#include "about/SplashScreen.h"
#include "app/Veltro3App.h"
#include "frame/Veltro3AppFrame.h"

#include <wx/eventfilter.h>
#include <wx/init.h>
#include <wx/timer.h>

#include <sys/resource.h>

namespace {

double CpuMs()
{
    rusage usage;
    getrusage(RUSAGE_SELF, &usage);
    return (usage.ru_utime.tv_sec + usage.ru_stime.tv_sec) * 1e3 +
           (usage.ru_utime.tv_usec + usage.ru_stime.tv_usec) / 1e3;
}

class Recorder : public wxEventFilter
{
public:
    int FilterEvent(wxEvent& event) override
    {
        const wxEventType type = event.GetEventType();
        wxObject* object = event.GetEventObject();
        if (type == wxEVT_PAINT && dynamic_cast<ZelSplashScreen*>(object)) {
            auto* splash = static_cast<ZelSplashScreen*>(object);
            if (!m_splashPainted) {
                m_splashPainted = true;
                std::printf("splash_first_paint %lld\nsplash_first_paint_cpu_us %lld\n", NowNs(),
                            ThreadCpuUs());
            } else if (m_measuring) {
                ++m_paints;
                const wxRect box = splash->GetUpdateRegion().GetBox();
                m_largestPaint = std::max(m_largestPaint, box.width * box.height);
            }
        } else if (type == wxEVT_SHOW && dynamic_cast<Veltro3AppFrame*>(object) &&
                   static_cast<wxShowEvent&>(event).IsShown() && !m_frameShown) {
            m_frameShown = true;
            std::printf("frame_shown %lld\n", NowNs());
            wxTheApp->CallAfter([this] { OpenAbout(); });
        }
        return Event_Skip;
    }

private:
    void OpenAbout()
    {
        ShowSplash(false, 3000);
        // Scrolling starts after 3 s; measure the 10 s after that.
        // Made here: a timer needs the toolkit running.
        m_timer = new wxTimer;
        m_timer->Bind(wxEVT_TIMER, [this](wxTimerEvent&) { Step(); });
        m_timer->StartOnce(3200);
    }

    void Step()
    {
        if (!m_measuring) {
            m_measuring = true;
            m_cpuStart = CpuMs();
            m_timer->StartOnce(10000);
            return;
        }
        m_measuring = false;
        const double cpu = CpuMs() - m_cpuStart;
        std::printf("about_ticks %d\nabout_cpu_ms_per_tick %.3f\nabout_largest_paint_px %d\n",
                    m_paints, m_paints ? cpu / m_paints : 0.0, m_largestPaint);
        std::printf("peak_rss_kb %ld\n", PeakRssKb());
        std::fflush(stdout);
        m_timer->Stop();
        wxTheApp->ExitMainLoop();
    }

    bool m_splashPainted = false, m_frameShown = false, m_measuring = false;
    int m_paints = 0, m_largestPaint = 0;
    double m_cpuStart = 0;
    wxTimer* m_timer = nullptr; // left to process exit
};

} // namespace

int main(int argc, char** argv)
{
    Recorder recorder;
    wxEvtHandler::AddFilter(&recorder);
    wxApp::SetInstance(new Veltro3App);
    const int result = wxEntry(argc, argv);
    wxEvtHandler::RemoveFilter(&recorder);
    return result;
}
