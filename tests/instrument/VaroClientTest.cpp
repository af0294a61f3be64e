// The instrument client against the simulator library: callback registration,
// notifications turned into events for the GUI thread, measurements, and
// destruction that waits for the client's workers.
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

template <typename Event, typename Field>
std::string Describe(const wxEvent& event, const char* name, Field Event::*field)
{
    const Event* typed = dynamic_cast<const Event*>(&event);
    return typed ? name + (" " + std::to_string(typed->*field)) : "wrong class";
}

// Writes down each instrument event delivered, as "connected 1", "button 1" or
// "measured 7", marking one that did not arrive as posted: on the GUI thread,
// from the application, with id 0 and full propagation.
struct Recorder : wxEventFilter
{
    Recorder() { wxEvtHandler::AddFilter(this); }
    ~Recorder() override { wxEvtHandler::RemoveFilter(this); }

    int FilterEvent(wxEvent& event) override
    {
        const wxEventType type = event.GetEventType();
        std::string what;
        if (type == zelEVT_Varo_CONNECTION)
            what = Describe(event, "connected", &zelVaroConnectionEvent::m_connected);
        else if (type == zelEVT_Varo_BUTTON)
            what = Describe(event, "button", &zelVaroButtonEvent::m_pressed);
        else if (type == zelEVT_Varo_MEAS)
            what = Describe(event, "measured", &zelVaroMeasEvent::m_status);
        else
            return Event_Skip;
        const int level = event.StopPropagation();
        event.ResumePropagation(level);
        if (!wxThread::IsMain() || event.GetEventObject() != wxTheApp || event.GetId() != 0 ||
            level != wxEVENT_PROPAGATE_MAX)
            what += " not as posted";
        events.insert(what);
        return Event_Skip;
    }

    Events events; // unordered: each notification has a worker of its own
};

// Lets every fired notification reach the client, destroys the client (which
// waits for its workers) and delivers what they posted.
void Finish(std::unique_ptr<Varo_client>& client)
{
    EXPECT_EQ(SIM(varosim_wait_idle)(10000), 0);
    client.reset();
    wxTheApp->ProcessPendingEvents();
}

TEST(VaroClient, OnlyTheFirstClientRegistersAndEveryLiveClientIsNotified)
{
    Recorder recorder;
    auto first = std::make_unique<Varo_client>();
    auto second = std::make_unique<Varo_client>();
    SIM(varosim_fire)(1000, 0);
    Finish(second);
    Finish(first);
    // A later client is reached through the first one's registration.
    auto later = std::make_unique<Varo_client>();
    SIM(varosim_fire)(1000, 0);
    Finish(later);
    EXPECT_EQ(SIM(varosim_calls)("VaroRegisterCallback"), 1);
    EXPECT_EQ(recorder.events, (Events{"connected 1", "connected 1", "connected 1"}));
}

TEST(VaroClient, ConnectionCodesBecomeEventsOtherCodesNothing)
{
    Recorder recorder;
    auto client = std::make_unique<Varo_client>();
    for (const int code : {1000, 1, 2, 999})
        SIM(varosim_fire)(code, 0);
    Finish(client);
    EXPECT_EQ(recorder.events, (Events{"connected 0", "connected 1"}));
}

TEST(VaroClient, ButtonWhileAnotherProgramIsActiveMeasuresNothing)
{
    wxTheApp->SetActive(false, nullptr);
    Recorder recorder;
    auto client = std::make_unique<Varo_client>();
    SIM(varosim_fire)(0, 0);
    Finish(client);
    EXPECT_EQ(recorder.events, Events{"button 1"});
    EXPECT_EQ(SIM(varosim_calls)("VaroMeasure"), 0);
    EXPECT_EQ(SIM(varosim_option_log)(nullptr, 0), 0u);
}

// The client goes as soon as the press reached it: its destruction waits for
// the measurement and for the half-second busy timer that follows it.
TEST(VaroClient, ButtonWhileActiveMeasuresWithTheBeepOff)
{
    wxTheApp->SetActive(true, nullptr);
    Recorder recorder;
    for (const int result : {0, 7}) {
        SIM(varosim_set_measure_result)(result);
        const auto pressed = std::chrono::steady_clock::now();
        auto client = std::make_unique<Varo_client>();
        SIM(varosim_fire)(0, 0);
        Finish(client);
        const auto waited = std::chrono::steady_clock::now() - pressed;
        EXPECT_GE(std::chrono::duration_cast<std::chrono::milliseconds>(waited).count(), 500);
    }
    EXPECT_EQ(recorder.events, (Events{"button 1", "button 1", "measured 0", "measured 7"}));
    EXPECT_EQ(SIM(varosim_calls)("VaroMeasure"), 2);
    // Set before each measurement, never read back nor restored.
    char options[64];
    SIM(varosim_option_log)(options, sizeof options);
    EXPECT_STREQ(options, "Beep=no\nBeep=no\n");
}

// Also run under ThreadSanitizer, which reports any unguarded shared access
// and any use of a destroyed client.
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
    EXPECT_EQ(SIM(varosim_wait_idle)(10000), 0);
    clients.clear();
    wxTheApp->ProcessPendingEvents();
    EXPECT_TRUE(Varo_client::s_clients.empty());
    EXPECT_GT(recorder.events.count("button 1"), 0u);
    for (const std::string& event : recorder.events)
        EXPECT_TRUE(event == "connected 0" || event == "connected 1" || event == "button 1" ||
                    event == "measured 0")
            << event;
}

} // namespace
