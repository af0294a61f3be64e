#include "instrument/VaroThreads.h"

#include "instrument/Varo_client.h"

#include <wx/utils.h>

namespace {

const unsigned long kBusyMilliseconds = 500;

} // namespace

NotificationThread::NotificationThread(Varo_client* client, int code)
    : wxThread(wxTHREAD_DETACHED), m_client(client), m_code(code)
{
}

wxThread::ExitCode NotificationThread::Entry()
{
    if (m_client == nullptr)
        return nullptr;
    m_client->HandleNotification(m_code);
    return nullptr;
}

void NotificationThread::OnExit()
{
    if (m_client != nullptr)
        m_client->Finished(this);
}

MeasureThread::MeasureThread(Varo_client* client) : wxThread(wxTHREAD_DETACHED), m_client(client) {}

wxThread::ExitCode MeasureThread::Entry()
{
    if (m_client == nullptr)
        return nullptr;
    m_client->RunMeasurement();
    return nullptr;
}

void MeasureThread::OnExit()
{
    if (m_client != nullptr)
        m_client->Finished(this);
}

TimerThread::TimerThread(Varo_client* client) : wxThread(wxTHREAD_DETACHED), m_client(client) {}

wxThread::ExitCode TimerThread::Entry()
{
    wxMilliSleep(kBusyMilliseconds);
    if (m_client == nullptr)
        return nullptr;
    m_client->EndBusy();
    return nullptr;
}

void TimerThread::OnExit()
{
    if (m_client != nullptr)
        m_client->Finished(this);
}
