// Records every instrument event the application object receives, with what
// a handler on the GUI thread can see of it.
#pragma once

#include "instrument/VaroEvents.h"

#include <vector>

struct RecordedVaroEvent
{
    wxEventType type;
    int id;
    int propagationLevel;
    bool onGuiThread;
    bool fromApplication;
    bool flag;       // m_connected or m_pressed
    int status;      // m_status
    bool rightClass; // the event's class matches its type
};

class VaroEventRecorder
{
public:
    VaroEventRecorder();
    ~VaroEventRecorder();

    const std::vector<RecordedVaroEvent>& Events() const { return m_events; }
    size_t Count(wxEventType type) const;
    // The events of one type, in arrival order.
    std::vector<RecordedVaroEvent> Of(wxEventType type) const;
    // Every recorded event arrived on the GUI thread from the application
    // object, with id 0, command-event propagation and the class of its type.
    bool AllDeliveredAsPosted() const;

private:
    void OnConnection(zelVaroConnectionEvent& event);
    void OnButton(zelVaroButtonEvent& event);
    void OnMeasurement(zelVaroMeasEvent& event);
    static RecordedVaroEvent Record(wxEvent& event, wxClassInfo* expectedClass);

    std::vector<RecordedVaroEvent> m_events;
};
