// The instrument client against the simulator library.
#include "instrument/SimControl.h"
#include "instrument/VaroEvents.h"
#include "instrument/Varo_client.h"

#include <gtest/gtest.h>
#include <wx/app.h>
#include <wx/eventfilter.h>
#include <wx/thread.h>

#include <chrono>
#include <deque>
#include <memory>
#include <set>
#include <string>

namespace {

using Events = std::multiset<std::string>;

// Each instrument event delivered ("button 1"), marked when handled off the GUI
// thread or unable to travel up the window hierarchy.
struct Recorder : wxEventFilter
{
    Recorder() { wxEvtHandler::AddFilter(this); }
    ~Recorder() override { wxEvtHandler::RemoveFilter(this); }

    int FilterEvent(wxEvent& e) override
    {
        const wxEventType type = e.GetEventType();
        std::string what;
        if (type == zelEVT_Varo_CONNECTION)
            what =
                "connected " + std::to_string(dynamic_cast<zelVaroConnectionEvent&>(e).m_connected);
        else if (type == zelEVT_Varo_BUTTON)
            what = "button " + std::to_string(dynamic_cast<zelVaroButtonEvent&>(e).m_pressed);
        else if (type == zelEVT_Varo_MEAS)
            what = "measured " + std::to_string(dynamic_cast<zelVaroMeasEvent&>(e).m_status);
        else
            return Event_Skip;
        events.insert(what + (wxThread::IsMain() && e.ShouldPropagate() ? "" : " not as posted"));
        return Event_Skip;
    }

    Events events; // unordered: each notification has a worker of its own
};

// Lets notifications arrive, destroys the clients with their workers, delivers what they posted.
template <typename Clients> void Finish(Clients& clients)
{
    EXPECT_EQ(SIM(varosim_wait_idle)(10000), 0);
    clients = Clients();
    wxTheApp->ProcessPendingEvents();
}

// Connection codes reach every live client through one registration. A button
// press measures, with the beep off, only while the launcher is active; the
// client's destruction waits for the measurement and the half second after it.
TEST(VaroClient, NotifiesEveryLiveClientAndMeasuresWhileActive)
{
    Recorder recorder;
    auto first = std::make_unique<Varo_client>(), second = std::make_unique<Varo_client>();
    for (const int code : {1000, 1, 2, 999})
        SIM(varosim_fire)(code, 0);
    Finish(second);
    Finish(first);
    for (const auto& [active, result] : {std::pair{false, 0}, {true, 0}, {true, 7}}) {
        wxTheApp->SetActive(active, nullptr);
        SIM(varosim_set_measure_result)(result);
        const auto pressed = std::chrono::steady_clock::now();
        auto client = std::make_unique<Varo_client>();
        SIM(varosim_fire)(0, 0);
        Finish(client);
        if (active) {
            EXPECT_GE(std::chrono::steady_clock::now() - pressed, std::chrono::milliseconds(500));
        }
    }
    EXPECT_EQ(SIM(varosim_calls)("VaroRegisterCallback"), 1);
    EXPECT_EQ(recorder.events,
              (Events{"connected 1", "connected 1", "connected 0", "connected 0", "button 1",
                      "button 1", "button 1", "measured 0", "measured 7"}));
    char options[64];
    SIM(varosim_option_log)(options, sizeof options);
    EXPECT_STREQ(options, "Beep=no\nBeep=no\n");
}

// Also run under ThreadSanitizer: any unguarded shared access or use of a
// destroyed client fails it.
TEST(VaroClient, ClientsComeAndGoWhileTheLibraryNotifies)
{
    Recorder recorder;
    std::deque<std::unique_ptr<Varo_client>> clients;
    for (int round = 0; round < 120; ++round) {
        // A measurement keeps its client half a second, so only some presses measure.
        wxTheApp->SetActive(round % 15 == 0, nullptr);
        clients.push_back(std::make_unique<Varo_client>());
        for (const int code : {1000, 1, 2, 0})
            SIM(varosim_fire)(code, round);
        if (clients.size() > 3 || round % 4 == 0)
            clients.pop_front();
        if (round % 10 == 0)
            wxTheApp->ProcessPendingEvents();
    }
    Finish(clients);
    EXPECT_TRUE(Varo_client::s_clients.empty());
    EXPECT_GT(recorder.events.count("button 1"), 0u);
    for (const std::string& event : recorder.events)
        EXPECT_EQ(event.find("not as posted"), std::string::npos) << event;
}

} // namespace
