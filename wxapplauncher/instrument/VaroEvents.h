// The events through which instrument notifications and measurement results
// reach the GUI thread; they are posted to the application object.
#pragma once

#include <wx/event.h>

#include <cstdint>

extern const wxEventType zelEVT_Varo_CONNECTION;
extern const wxEventType zelEVT_Varo_BUTTON;
extern const wxEventType zelEVT_Varo_MEAS;

// The instrument was connected (true) or disconnected (false).
class zelVaroConnectionEvent : public wxEvent
{
public:
    explicit zelVaroConnectionEvent(wxEventType type = wxEVT_NULL, bool connected = false);
    wxEvent* Clone() const override { return new zelVaroConnectionEvent(*this); }

    bool m_connected;

private:
    wxDECLARE_DYNAMIC_CLASS_NO_ASSIGN(zelVaroConnectionEvent);
};

// The instrument's button was pressed.
class zelVaroButtonEvent : public wxEvent
{
public:
    explicit zelVaroButtonEvent(wxEventType type = wxEVT_NULL, bool pressed = false);
    wxEvent* Clone() const override { return new zelVaroButtonEvent(*this); }

    bool m_pressed;

private:
    wxDECLARE_DYNAMIC_CLASS_NO_ASSIGN(zelVaroButtonEvent);
};

// A measurement ended: status 0, or the library's failure status.
class zelVaroMeasEvent : public wxEvent
{
public:
    explicit zelVaroMeasEvent(wxEventType type = wxEVT_NULL, std::int32_t status = 0);
    wxEvent* Clone() const override { return new zelVaroMeasEvent(*this); }

    std::int32_t m_status;

private:
    wxDECLARE_DYNAMIC_CLASS_NO_ASSIGN(zelVaroMeasEvent);
};
