// Figures of the launcher view, each beside its anchor from the same run:
// a real click on a module button until the module's process exists, against
// starting the same program with posix_spawn; and the CPU time of one hover
// repaint of a module button, against a repaint that only blits its buffer.
// Runs in the demo installation (the working directory), on an X display; its own files
// go to a folder of its own, removed after.
#include "controls/ZelStaticBitmap.h"
#include "frame/Veltro3AppFrame.h"
#include "frame/Veltro3MainAppStandardView.h"

#include <wx/app.h>
#include <wx/evtloop.h>
#include <wx/init.h>
#include <wx/log.h>
#include <wx/uiaction.h>

#include <X11/Xlib.h>
#include <X11/extensions/XTest.h>

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <ctime>
#include <filesystem>
#include <fstream>
#include <functional>
#include <set>
#include <spawn.h>
#include <string>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>
#include <vector>

extern char** environ;

namespace {

const int kRuns = 20;

double Median(std::vector<double> values)
{
    std::sort(values.begin(), values.end());
    return values[values.size() / 2];
}

double Now()
{
    return std::chrono::duration<double, std::milli>(
               std::chrono::steady_clock::now().time_since_epoch())
        .count();
}

double ThreadCpu()
{
    timespec t{};
    clock_gettime(CLOCK_THREAD_CPUTIME_ID, &t);
    return t.tv_sec * 1e3 + t.tv_nsec / 1e6;
}

// The stand-ins' start log: a stand-in writes its pid there first thing, so
// a module counts as started once its record is there.
std::string g_log;

off_t LogSize()
{
    struct stat st = {};
    return stat(g_log.c_str(), &st) == 0 ? st.st_size : 0;
}

// Handles events until the condition holds, at most `timeoutMs`. Polling
// looks at the condition between events without waiting for the next one.
bool Until(const std::function<bool()>& condition, double timeoutMs = 5000, bool poll = false)
{
    wxEventLoopBase* loop = wxEventLoopBase::GetActive();
    const double deadline = Now() + timeoutMs;
    while (!condition()) {
        if (Now() > deadline)
            return false;
        if (poll)
            loop->YieldFor(wxEVT_CATEGORY_ALL);
        else
            loop->DispatchTimeout(50);
    }
    return true;
}

void Reap()
{
    while (waitpid(-1, nullptr, WNOHANG) > 0) {
    }
}

} // namespace

int main(int argc, char** argv)
{
    wxApp::SetInstance(new wxApp);
    if (!wxEntryStart(argc, argv)) {
        fprintf(stderr, "view_bench: no display\n");
        return 2;
    }
    wxLog::EnableLogging(false);
    std::string dir = (std::filesystem::temp_directory_path() / "view-bench-XXXXXX").string();
    if (!mkdtemp(dir.data())) {
        perror("view_bench: mkdtemp");
        return 2;
    }
    g_log = dir + "/starts.log";
    setenv("VELTRONA_STANDIN_EXIT", "1", 1);
    setenv("VELTRONA_STANDIN_LOG", g_log.c_str(), 1);

    int status = 0;
    {
        wxEventLoop loop;
        wxEventLoopActivator activate(&loop);
        auto* frame = new Veltro3AppFrame("Veltrona", wxPoint(0, 0), wxDefaultSize);
        frame->Show();
        auto* printer = static_cast<ZelStaticBitmap*>(frame->FindWindow(1101));
        wxUIActionSimulator sim;
        Display* display = XOpenDisplay(nullptr);
        Until([&] { return printer->IsShownOnScreen(); });
        // Let the window manager place and paint the window.
        Until([] { return false; }, 500);

        const wxRect r = printer->GetScreenRect();
        const wxPoint inside(r.x + r.width / 2, r.y + r.height / 2);
        const wxPoint outside(r.x + r.width / 2, r.y - 20);

        // The view's own Printer handler, timed: once it returns, the module's
        // process exists.
        std::vector<double> click, forked, spawn, spawned;
        double launched = 0;
        auto* view = frame->GetStandardView();
        view->Bind(
            wxEVT_BUTTON,
            [&](wxCommandEvent& e) {
                view->OnLaunchPrinter(e);
                launched = Now();
            },
            1101);
        const std::string exe = "Quenta Print Studio.exe";
        for (int i = 0; i < kRuns; ++i) {
            sim.MouseMove(inside);
            Until([&] { return printer->GetState() == 1; });
            off_t before = LogSize();
            double start = Now();
            // Straight to the X server: the simulator's own waits are not the launcher's.
            XTestFakeButtonEvent(display, 1, True, 0);
            XTestFakeButtonEvent(display, 1, False, 0);
            XFlush(display);
            if (!Until([&] { return LogSize() > before; }, 5000, true)) {
                fprintf(stderr, "view_bench: the click started nothing\n");
                status = 1;
                break;
            }
            click.push_back(Now() - start);
            forked.push_back(launched - start);
            Until([&] { return printer->GetState() == 1; });

            char* args[] = {const_cast<char*>(exe.c_str()), nullptr};
            pid_t pid = 0;
            before = LogSize();
            start = Now();
            if (posix_spawn(&pid, exe.c_str(), nullptr, nullptr, args, environ) == 0) {
                spawned.push_back(Now() - start);
                if (Until([&] { return LogSize() > before; }, 5000, true))
                    spawn.push_back(Now() - start);
            }
            waitpid(pid, nullptr, 0);
            Reap();
        }

        // Each repaint is timed from what causes it until the button's paint
        // handler has put its back buffer on the screen.
        std::vector<double> pointer, hover, blit;
        int paints = 0;
        printer->Bind(wxEVT_PAINT, [&](wxPaintEvent& e) {
            ++paints;
            e.Skip();
        });
        auto timed = [&](const std::function<void()>& cause) {
            Until([] { return false; }, 30);
            paints = 0;
            const double cpu = ThreadCpu();
            cause();
            Until([&] { return paints > 0; });
            return ThreadCpu() - cpu;
        };
        for (int i = 0; i < kRuns && status == 0; ++i) {
            sim.MouseMove(outside);
            Until([&] { return printer->GetState() == 0; });
            pointer.push_back(timed([&] { sim.MouseMove(inside); }));
            wxMouseEvent leave(wxEVT_LEAVE_WINDOW);
            printer->ProcessWindowEvent(leave);
            hover.push_back(timed([&] {
                wxMouseEvent enter(wxEVT_ENTER_WINDOW);
                printer->ProcessWindowEvent(enter);
            }));
            blit.push_back(timed([&] { printer->wxWindow::Refresh(false); }));
        }

        if (status == 0) {
            printf("real click on a module button until the module's process exists (median of "
                   "%d): %.2f ms; anchor posix_spawn of the same program returning: %.2f ms\n",
                   kRuns, Median(forked), Median(spawned));
            printf("real click on a module button until the module has logged its pid (median "
                   "of %d): %.2f ms; anchor posix_spawn of the same program until it has logged "
                   "its pid: %.2f ms\n",
                   kRuns, Median(click), Median(spawn));
            printf("CPU time of one hover repaint of a module button, state change to buffer on "
                   "screen (median of %d): %.3f ms; anchor repaint that only blits the button's "
                   "buffer: %.3f ms\n",
                   kRuns, Median(hover), Median(blit));
            printf("CPU time of the same with the toolkit's handling of a real pointer move "
                   "(median of %d): %.3f ms; anchor as above: %.3f ms\n",
                   kRuns, Median(pointer), Median(blit));
        }
        XCloseDisplay(display);
        frame->Destroy();
        Until([] { return false; }, 100);
    }
    wxEntryCleanup();
    std::filesystem::remove_all(dir);
    return status;
}
