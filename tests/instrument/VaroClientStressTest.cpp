// Clients come and go on the GUI thread while the library delivers
// notifications from its own thread. Run under ThreadSanitizer as well: any
// use of a destroyed client, or an unguarded shared field, shows up there.
#include "instrument/VaroEventRecorder.h"
#include "instrument/VaroSimControl.h"
#include "instrument/Varo_client.h"

#include <gtest/gtest.h>
#include <wx/app.h>

#include <deque>
#include <memory>

namespace {

TEST(VaroClientStress, ClientsComeAndGoWhileTheLibraryNotifies)
{
    VaroSimControl sim;
    ASSERT_TRUE(sim.IsOpen());
    VaroEventRecorder events;
    const int codes[] = {1000, 1, 2, 0};

    std::deque<std::unique_ptr<Varo_client>> clients;
    for (int round = 0; round < 120; ++round) {
        // Measurements keep a client alive half a second, so only some presses measure.
        wxTheApp->SetActive(round % 15 == 0, nullptr);
        clients.push_back(std::make_unique<Varo_client>());
        for (const int code : codes)
            sim.Fire(code, round);
        if (clients.size() > 3 || round % 4 == 0)
            clients.pop_front();
        if (round % 10 == 0)
            wxTheApp->ProcessPendingEvents();
    }
    EXPECT_TRUE(sim.WaitIdle());
    clients.clear();
    wxTheApp->ProcessPendingEvents();
    EXPECT_TRUE(Varo_client::s_clients.empty());
    EXPECT_TRUE(events.AllDeliveredAsPosted());
    EXPECT_GT(events.Count(zelEVT_Varo_BUTTON), 0u);

    // The registry still works: one new client, one notification, one event.
    const size_t before = events.Count(zelEVT_Varo_CONNECTION);
    auto client = std::make_unique<Varo_client>();
    sim.Fire(1000);
    EXPECT_TRUE(sim.WaitIdle());
    client.reset();
    wxTheApp->ProcessPendingEvents();
    EXPECT_EQ(events.Count(zelEVT_Varo_CONNECTION), before + 1);
}

} // namespace
