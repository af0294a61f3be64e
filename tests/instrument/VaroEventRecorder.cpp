#include "instrument/VaroEventRecorder.h"

#include <wx/app.h>
#include <wx/thread.h>

#include <algorithm>

namespace {

// Built when used: the event types are assigned during static initialisation.
wxEventTypeTag<zelVaroConnectionEvent> Connection()
{
    return wxEventTypeTag<zelVaroConnectionEvent>(zelEVT_Varo_CONNECTION);
}

wxEventTypeTag<zelVaroButtonEvent> Button()
{
    return wxEventTypeTag<zelVaroButtonEvent>(zelEVT_Varo_BUTTON);
}

wxEventTypeTag<zelVaroMeasEvent> Measurement()
{
    return wxEventTypeTag<zelVaroMeasEvent>(zelEVT_Varo_MEAS);
}

} // namespace

VaroEventRecorder::VaroEventRecorder()
{
    wxTheApp->Bind(Connection(), &VaroEventRecorder::OnConnection, this);
    wxTheApp->Bind(Button(), &VaroEventRecorder::OnButton, this);
    wxTheApp->Bind(Measurement(), &VaroEventRecorder::OnMeasurement, this);
}

VaroEventRecorder::~VaroEventRecorder()
{
    wxTheApp->Unbind(Connection(), &VaroEventRecorder::OnConnection, this);
    wxTheApp->Unbind(Button(), &VaroEventRecorder::OnButton, this);
    wxTheApp->Unbind(Measurement(), &VaroEventRecorder::OnMeasurement, this);
}

RecordedVaroEvent VaroEventRecorder::Record(wxEvent& event, wxClassInfo* expectedClass)
{
    RecordedVaroEvent recorded{};
    recorded.type = event.GetEventType();
    recorded.id = event.GetId();
    recorded.propagationLevel = event.StopPropagation();
    event.ResumePropagation(recorded.propagationLevel);
    recorded.onGuiThread = wxThread::IsMain();
    recorded.fromApplication = event.GetEventObject() == wxTheApp;
    recorded.rightClass = event.GetClassInfo() == expectedClass;
    return recorded;
}

void VaroEventRecorder::OnConnection(zelVaroConnectionEvent& event)
{
    RecordedVaroEvent recorded = Record(event, wxCLASSINFO(zelVaroConnectionEvent));
    recorded.flag = event.m_connected;
    m_events.push_back(recorded);
}

void VaroEventRecorder::OnButton(zelVaroButtonEvent& event)
{
    RecordedVaroEvent recorded = Record(event, wxCLASSINFO(zelVaroButtonEvent));
    recorded.flag = event.m_pressed;
    m_events.push_back(recorded);
}

void VaroEventRecorder::OnMeasurement(zelVaroMeasEvent& event)
{
    RecordedVaroEvent recorded = Record(event, wxCLASSINFO(zelVaroMeasEvent));
    recorded.status = event.m_status;
    m_events.push_back(recorded);
}

size_t VaroEventRecorder::Count(wxEventType type) const
{
    return Of(type).size();
}

std::vector<RecordedVaroEvent> VaroEventRecorder::Of(wxEventType type) const
{
    std::vector<RecordedVaroEvent> matching;
    std::copy_if(m_events.begin(), m_events.end(), std::back_inserter(matching),
                 [type](const RecordedVaroEvent& event) { return event.type == type; });
    return matching;
}

bool VaroEventRecorder::AllDeliveredAsPosted() const
{
    return std::all_of(m_events.begin(), m_events.end(), [](const RecordedVaroEvent& event) {
        return event.id == 0 && event.propagationLevel == wxEVENT_PROPAGATE_MAX &&
               event.onGuiThread && event.fromApplication && event.rightClass;
    });
}
