// The instrument events: their run-time class information, default state,
// cloning and their event types.
#include "instrument/VaroEvents.h"

#include <gtest/gtest.h>

#include <memory>
#include <set>

namespace {

template <typename Event> std::unique_ptr<Event> CreateByName(const char* name)
{
    wxObject* object = wxCreateDynamicObject(name);
    EXPECT_NE(object, nullptr) << name;
    EXPECT_TRUE(object == nullptr || object->IsKindOf(wxCLASSINFO(wxEvent))) << name;
    Event* event = wxDynamicCast(object, Event);
    EXPECT_NE(event, nullptr) << name;
    if (event != nullptr) {
        EXPECT_EQ(event->GetId(), 0) << name;
        EXPECT_EQ(event->GetEventType(), wxEVT_NULL) << name;
    }
    return std::unique_ptr<Event>(event);
}

int PropagationLevel(wxEvent& event)
{
    const int level = event.StopPropagation();
    event.ResumePropagation(level);
    return level;
}

TEST(VaroEvents, AreCreatedByClassNameInTheirDefaultState)
{
    auto connection = CreateByName<zelVaroConnectionEvent>("zelVaroConnectionEvent");
    auto button = CreateByName<zelVaroButtonEvent>("zelVaroButtonEvent");
    auto measurement = CreateByName<zelVaroMeasEvent>("zelVaroMeasEvent");
    ASSERT_TRUE(connection && button && measurement);
    EXPECT_FALSE(connection->m_connected);
    EXPECT_FALSE(button->m_pressed);
    EXPECT_EQ(measurement->m_status, 0);
    EXPECT_EQ(wxClassInfo::FindClass("zelVaroMeasEvent")->GetBaseClassName1(), wxString("wxEvent"));
}

TEST(VaroEvents, CloneKeepsTheFieldAndCommandEventPropagation)
{
    zelVaroConnectionEvent connection(zelEVT_Varo_CONNECTION, true);
    zelVaroButtonEvent button(zelEVT_Varo_BUTTON, true);
    zelVaroMeasEvent measurement(zelEVT_Varo_MEAS, -42);

    std::unique_ptr<wxEvent> clones[] = {std::unique_ptr<wxEvent>(connection.Clone()),
                                         std::unique_ptr<wxEvent>(button.Clone()),
                                         std::unique_ptr<wxEvent>(measurement.Clone())};
    EXPECT_TRUE(static_cast<zelVaroConnectionEvent&>(*clones[0]).m_connected);
    EXPECT_TRUE(static_cast<zelVaroButtonEvent&>(*clones[1]).m_pressed);
    EXPECT_EQ(static_cast<zelVaroMeasEvent&>(*clones[2]).m_status, -42);
    for (auto& clone : clones) {
        EXPECT_EQ(PropagationLevel(*clone), wxEVENT_PROPAGATE_MAX);
        EXPECT_EQ(clone->GetId(), 0);
    }
    EXPECT_EQ(clones[2]->GetEventType(), zelEVT_Varo_MEAS);
    EXPECT_TRUE(clones[1]->IsKindOf(wxCLASSINFO(zelVaroButtonEvent)));
}

TEST(VaroEvents, TypesAreDistinctAndAssigned)
{
    const std::set<wxEventType> types = {zelEVT_Varo_CONNECTION, zelEVT_Varo_BUTTON,
                                         zelEVT_Varo_MEAS};
    EXPECT_EQ(types.size(), 3u);
    EXPECT_EQ(types.count(wxEVT_NULL), 0u);
}

} // namespace
