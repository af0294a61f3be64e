#include "instrument/VaroEvents.h"

const wxEventType zelEVT_Varo_CONNECTION = wxNewEventType();
const wxEventType zelEVT_Varo_BUTTON = wxNewEventType();
const wxEventType zelEVT_Varo_MEAS = wxNewEventType();

wxIMPLEMENT_DYNAMIC_CLASS(zelVaroConnectionEvent, wxEvent);
wxIMPLEMENT_DYNAMIC_CLASS(zelVaroButtonEvent, wxEvent);
wxIMPLEMENT_DYNAMIC_CLASS(zelVaroMeasEvent, wxEvent);

// Instrument events travel up the window hierarchy like command events.
zelVaroConnectionEvent::zelVaroConnectionEvent(wxEventType type, bool connected)
    : wxEvent(0, type), m_connected(connected)
{
    m_propagationLevel = wxEVENT_PROPAGATE_MAX;
}

zelVaroButtonEvent::zelVaroButtonEvent(wxEventType type, bool pressed)
    : wxEvent(0, type), m_pressed(pressed)
{
    m_propagationLevel = wxEVENT_PROPAGATE_MAX;
}

zelVaroMeasEvent::zelVaroMeasEvent(wxEventType type, std::int32_t status)
    : wxEvent(0, type), m_status(status)
{
    m_propagationLevel = wxEVENT_PROPAGATE_MAX;
}
