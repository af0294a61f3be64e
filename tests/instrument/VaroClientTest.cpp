// The instrument client against the simulator library: callback registration,
// notifications turned into events on the GUI thread, measurements with their
// option steps, and destruction that waits for the client's workers.
#include "instrument/VaroEventRecorder.h"
#include "instrument/VaroFunctions.h"
#include "instrument/VaroSimControl.h"
#include "instrument/Varo_client.h"

#include "support/GuiWait.h"

#include <gtest/gtest.h>
#include <wx/app.h>

#include <chrono>
#include <memory>

namespace {

class VaroClientTest : public testing::Test
{
protected:
    void SetUp() override
    {
        ASSERT_TRUE(m_sim.IsOpen());
        wxTheApp->SetActive(true, nullptr);
    }

    // Lets every fired notification reach the client, destroys the client
    // (which waits for its workers) and delivers what they posted.
    void Finish(std::unique_ptr<Varo_client>& client)
    {
        EXPECT_TRUE(m_sim.WaitIdle());
        client.reset();
        wxTheApp->ProcessPendingEvents();
    }

    bool WaitForMeasurements(size_t count)
    {
        return WaitFor([&] { return m_events.Count(zelEVT_Varo_MEAS) >= count; });
    }

    VaroSimControl m_sim;
    VaroEventRecorder m_events;
};

TEST_F(VaroClientTest, OnlyTheFirstClientOfAProcessRegistersTheCallback)
{
    EXPECT_FALSE(Varo_client::s_callbackRegistered);
    auto first = std::make_unique<Varo_client>();
    EXPECT_TRUE(Varo_client::s_callbackRegistered);
    EXPECT_EQ(m_sim.Calls("VaroRegisterCallback"), 1);
    {
        Varo_client second;
        Varo_client third;
        EXPECT_EQ(Varo_client::s_clients.size(), 3u);
    }
    first.reset();
    EXPECT_TRUE(Varo_client::s_clients.empty());

    // A later client is reached through the registration made by the first.
    auto later = std::make_unique<Varo_client>();
    EXPECT_EQ(m_sim.Calls("VaroRegisterCallback"), 1);
    m_sim.Fire(1000);
    Finish(later);
    EXPECT_EQ(m_events.Count(zelEVT_Varo_CONNECTION), 1u);
}

TEST_F(VaroClientTest, ConnectionCodesBecomeEventsAndOtherCodesNothing)
{
    auto client = std::make_unique<Varo_client>();
    m_sim.Fire(1000);
    m_sim.Fire(1);
    m_sim.Fire(2);
    m_sim.Fire(999);
    Finish(client);

    // Each notification has its own worker, so their events may arrive in any order.
    const auto connections = m_events.Of(zelEVT_Varo_CONNECTION);
    ASSERT_EQ(connections.size(), 2u);
    EXPECT_NE(connections[0].flag, connections[1].flag);
    EXPECT_EQ(m_events.Events().size(), 2u);
    EXPECT_TRUE(m_events.AllDeliveredAsPosted());
}

TEST_F(VaroClientTest, EveryLiveClientGetsEachNotification)
{
    auto first = std::make_unique<Varo_client>();
    auto second = std::make_unique<Varo_client>();
    m_sim.Fire(1);
    EXPECT_TRUE(m_sim.WaitIdle());
    second.reset();
    m_sim.Fire(1);
    Finish(first);
    EXPECT_EQ(m_events.Count(zelEVT_Varo_CONNECTION), 3u);
}

TEST_F(VaroClientTest, ButtonWhileAnotherProgramIsActiveMeasuresNothing)
{
    wxTheApp->SetActive(false, nullptr);
    auto client = std::make_unique<Varo_client>();
    m_sim.Fire(0);
    Finish(client);

    const auto buttons = m_events.Of(zelEVT_Varo_BUTTON);
    ASSERT_EQ(buttons.size(), 1u);
    EXPECT_TRUE(buttons[0].flag);
    EXPECT_EQ(m_events.Count(zelEVT_Varo_MEAS), 0u);
    EXPECT_EQ(m_sim.Calls("VaroMeasure"), 0);
    EXPECT_EQ(m_sim.OptionLog(), "");
    EXPECT_TRUE(m_events.AllDeliveredAsPosted());
}

TEST_F(VaroClientTest, ButtonWhileActiveMeasuresWithTheBeepOff)
{
    for (const int result : {0, 7}) {
        m_sim.SetMeasureResult(result);
        auto client = std::make_unique<Varo_client>();
        m_sim.Fire(0);
        ASSERT_TRUE(WaitForMeasurements(result == 0 ? 1 : 2));
        Finish(client);
        EXPECT_EQ(m_events.Of(zelEVT_Varo_MEAS).back().status, result);
    }
    EXPECT_EQ(m_events.Count(zelEVT_Varo_BUTTON), 2u);
    EXPECT_EQ(m_sim.Calls("VaroMeasure"), 2);
    // "Beep" is the one option: set before each measurement, never read or restored.
    EXPECT_EQ(m_sim.OptionLog(), "Beep=no\nBeep=no\n");
    EXPECT_EQ(m_sim.Calls("VaroGetOption"), 0);
    EXPECT_TRUE(m_events.AllDeliveredAsPosted());
}

TEST_F(VaroClientTest, DestroyingRightAfterAMeasurementWaitsForTheTimerWorker)
{
    const auto pressed = std::chrono::steady_clock::now();
    auto client = std::make_unique<Varo_client>();
    m_sim.Fire(0);
    ASSERT_TRUE(WaitForMeasurements(1));
    client.reset();
    // The timer worker sleeps half a second from the measurement, which came after the press.
    EXPECT_GE(std::chrono::steady_clock::now() - pressed, std::chrono::milliseconds(500));
}

TEST_F(VaroClientTest, ButtonIsIgnoredWhileAMeasurementRunsAndJustAfter)
{
    m_sim.SetMeasureDelay(1000);
    auto client = std::make_unique<Varo_client>();
    m_sim.Fire(0);
    ASSERT_TRUE(WaitFor([&] { return m_sim.Calls("VaroMeasure") == 1; }));
    m_sim.Fire(0);
    ASSERT_TRUE(WaitForMeasurements(1));
    m_sim.Fire(0);
    Finish(client);

    EXPECT_EQ(m_sim.Calls("VaroMeasure"), 1);
    EXPECT_EQ(m_events.Count(zelEVT_Varo_BUTTON), 1u);
    EXPECT_EQ(m_events.Count(zelEVT_Varo_MEAS), 1u);
}

TEST_F(VaroClientTest, MeasureRefusesAtOnceWhileBusy)
{
    Varo_client client;
    m_sim.SetMeasureResult(3);
    EXPECT_EQ(client.Measure(), 3);
    EXPECT_EQ(client.Measure(), -1);
    EXPECT_EQ(m_sim.Calls("VaroMeasure"), 1);
}

TEST_F(VaroClientTest, SavedOptionsAreReadAsUtf8AndRestoredByTheirRules)
{
    VaroFunctions::Get()->setOption("Illumination", "Grün");
    Varo_client client;
    client.m_settings["Beep"] = "no";
    client.m_settings["Recognition"] = "yes";
    client.m_settings["Illumination"] = "D50";
    client.SaveSettings();
    ASSERT_EQ(client.m_savedSettings.size(), 1u);
    EXPECT_EQ(client.m_savedSettings["Illumination"], wxString::FromUTF8("Grün"));
    EXPECT_EQ(m_sim.Calls("VaroGetOption"), 1);

    client.m_savedSettings.clear();
    client.m_savedSettings["Beep"] = "loud";
    client.m_savedSettings["Recognition"] = "yes";
    client.m_savedSettings["Mode"] = "SingleEmission";
    client.m_savedSettings["Filter"] = "no";
    client.m_savedSettings["Speed"] = "fast";
    const std::string before = m_sim.OptionLog();
    client.RestoreSettings();
    EXPECT_EQ(m_sim.OptionLog().substr(before.size()), "Filter=no\nRecognition=yes\nSpeed=fast\n");
}

TEST_F(VaroClientTest, ChecksAnswerFromTheLibrary)
{
    Varo_client client;
    m_sim.SetState(VAROSIM_NONE);
    EXPECT_NE(client.CheckInstrument(), 0);
    m_sim.SetState(VAROSIM_DIRECT);
    EXPECT_EQ(client.CheckInstrument(), 0);
    EXPECT_NE(client.CheckTableMount(), 0);
    m_sim.SetState(VAROSIM_TABLE);
    EXPECT_EQ(client.CheckInstrument(), 0);
    EXPECT_EQ(client.CheckTableMount(), 0);
}

} // namespace
