// Runs the tests inside the launcher's own application class, its start-up left out,
// on the environment's display, under a reaper that ends whatever they leave running.
#include "app/Veltro3App.h"
#include "support/Reaper.h"

#include <gtest/gtest.h>
#include <wx/evtloop.h>
#include <wx/init.h>
#include <wx/log.h>
#include <wx/utils.h>

namespace {

class TestApp : public Veltro3App
{
public:
    bool OnInit() override { return true; }
    int OnExit() override { return 0; }
};

} // namespace

int main(int argc, char** argv)
{
    testing::InitGoogleTest(&argc, argv);
    if (GTEST_FLAG_GET(list_tests))
        return RUN_ALL_TESTS();
    RunUnderReaper();

    // Toolkit messages go to the test's output; a dialog would stall the run.
    wxSetAssertHandler([](const wxString& file, int line, const wxString& func,
                          const wxString& cond, const wxString& msg) {
        ADD_FAILURE_AT(file.utf8_str(), line)
            << "toolkit assertion in " << func << ": " << cond << " " << msg;
    });

    // Neither the tests nor what they start use a session or accessibility bus unless a test
    // starts one of its own: with none named, GIO would start one through dbus-launch and
    // leave it on the display for every later test.
    wxSetEnv("NO_AT_BRIDGE", "1");
    wxSetEnv("DBUS_SESSION_BUS_ADDRESS", "disabled:");
    wxApp::SetInstance(new TestApp);
    const bool started = wxEntryStart(argc, argv);
    if (!started || !wxTheApp->CallOnInit()) {
        fprintf(stderr, "the toolkit could not start (is DISPLAY set?)\n");
        return 2;
    }
    delete wxLog::SetActiveTarget(new wxLogStderr);
    wxLog::DontCreateOnDemand();
    int result = 0;
    {
        wxEventLoop loop;
        wxEventLoopActivator activate(&loop);
        result = RUN_ALL_TESTS();
    }
    wxTheApp->OnExit();
    wxEntryCleanup();
    return result;
}
