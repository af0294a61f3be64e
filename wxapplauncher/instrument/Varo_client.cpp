#include "instrument/Varo_client.h"

#include "instrument/VaroEvents.h"
#include "instrument/VaroFunctions.h"
#include "instrument/VaroThreads.h"

#include <wx/app.h>

std::list<Varo_client*> Varo_client::s_clients;
bool Varo_client::s_callbackRegistered = false;

namespace {

// Guards s_clients and s_callbackRegistered: the library's thread walks the
// list while the GUI thread adds and removes clients.
std::mutex& ClientsLock()
{
    static std::mutex lock;
    return lock;
}

const char kBeep[] = "Beep";
const char kRecognition[] = "Recognition";

bool IsSwitch(const wxString& value)
{
    return value == "yes" || value == "no";
}

void Post(wxEvent& event)
{
    wxApp* app = wxTheApp;
    if (app == nullptr)
        return;
    event.SetEventObject(app);
    app->AddPendingEvent(event);
}

} // namespace

Varo_client::Varo_client()
    : m_busy(0), m_measureOnButton(true), m_mutex(new wxMutex), m_notificationThread(nullptr),
      m_measureThread(nullptr), m_timerThread(nullptr), m_runningWorkers(0)
{
    bool registerCallback = false;
    {
        std::lock_guard<std::mutex> lock(ClientsLock());
        registerCallback = !s_callbackRegistered;
        s_callbackRegistered = true;
    }
    // Outside the lock: a library may deliver a first notification at once.
    if (registerCallback) {
        if (const VaroFunctions* library = VaroFunctions::Get())
            library->registerCallback(&Varo_client::NotifyClients);
    }
    std::lock_guard<std::mutex> lock(ClientsLock());
    s_clients.push_back(this);
}

Varo_client::~Varo_client()
{
    {
        std::lock_guard<std::mutex> lock(ClientsLock());
        s_clients.remove(this);
    }
    // Every worker was counted while this client was still listed, so once the
    // count is zero nothing can reach this client any more.
    {
        std::unique_lock<std::mutex> lock(m_stateLock);
        m_workersDone.wait(lock, [this] { return m_runningWorkers == 0; });
    }
    delete m_mutex;
    m_savedSettings.clear();
    m_settings.clear();
}

void Varo_client::NotifyClients(int code, int data)
{
    std::lock_guard<std::mutex> lock(ClientsLock());
    for (Varo_client* client : s_clients)
        client->OnNotification(code, data);
}

void Varo_client::OnNotification(int code, int)
{
    Start(new NotificationThread(this, code), m_notificationThread);
}

void Varo_client::HandleNotification(int code)
{
    switch (code) {
    case 0: {
        MeasureThread* measurement = nullptr;
        {
            std::lock_guard<std::mutex> lock(m_stateLock);
            // A press during a measurement or the half second after it is ignored.
            if (m_busy != 0 || m_measureThread != nullptr)
                return;
            if (m_measureOnButton && wxTheApp != nullptr && wxTheApp->IsActive()) {
                measurement = new MeasureThread(this);
                Track(measurement, m_measureThread);
            }
        }
        if (measurement != nullptr)
            Launch(measurement);
        PostButtonPressed();
        break;
    }
    case 1:
        PostDisconnected();
        break;
    case 1000:
        PostConnected();
        break;
    default:
        break;
    }
}

void Varo_client::RunMeasurement()
{
    if (wxTheApp == nullptr || !wxTheApp->IsActive())
        return;
    const int result = Measure();
    if (result == 0)
        PostMeasured();
    else
        PostMeasureError(result);
}

void Varo_client::EndBusy()
{
    std::lock_guard<std::mutex> lock(m_stateLock);
    m_busy = 0;
}

void Varo_client::PostConnected()
{
    zelVaroConnectionEvent event(zelEVT_Varo_CONNECTION, true);
    Post(event);
}

void Varo_client::PostDisconnected()
{
    zelVaroConnectionEvent event(zelEVT_Varo_CONNECTION, false);
    Post(event);
}

void Varo_client::PostButtonPressed()
{
    zelVaroButtonEvent event(zelEVT_Varo_BUTTON, true);
    Post(event);
}

void Varo_client::PostMeasured()
{
    zelVaroMeasEvent event(zelEVT_Varo_MEAS, 0);
    Post(event);
}

void Varo_client::PostMeasureError(int status)
{
    zelVaroMeasEvent event(zelEVT_Varo_MEAS, status);
    Post(event);
}

int Varo_client::CheckInstrument()
{
    const VaroFunctions* library = VaroFunctions::Get();
    return library == nullptr ? -1 : library->checkInstrument();
}

int Varo_client::CheckTableMount()
{
    const VaroFunctions* library = VaroFunctions::Get();
    return library == nullptr ? -1 : library->checkTableMount();
}

int Varo_client::Measure()
{
    {
        std::lock_guard<std::mutex> lock(m_stateLock);
        if (m_busy != 0)
            return -1;
        m_busy = 1;
    }
    wxMutexLocker measuring(*m_mutex);
    m_settings[kBeep] = "no";
    SaveSettings();
    ApplySettings();
    const VaroFunctions* library = VaroFunctions::Get();
    const int result = library == nullptr ? -1 : library->measure();
    Start(new TimerThread(this), m_timerThread);
    RestoreSettings();
    return result;
}

void Varo_client::SaveSettings()
{
    const VaroFunctions* library = VaroFunctions::Get();
    if (library == nullptr)
        return;
    for (const auto& setting : m_settings) {
        const wxString& name = setting.first;
        if (name == kRecognition || name == kBeep)
            continue;
        // The text belongs to the library: copy it, never free it.
        const char* value = library->getOption(name.mb_str(wxConvLibc));
        m_savedSettings[name] = value == nullptr ? wxString() : wxString::FromUTF8(value);
    }
}

void Varo_client::ApplySettings()
{
    const VaroFunctions* library = VaroFunctions::Get();
    if (library == nullptr)
        return;
    for (const auto& setting : m_settings)
        library->setOption(setting.first.mb_str(wxConvLibc), setting.second.mb_str(wxConvLibc));
}

void Varo_client::RestoreSettings()
{
    const VaroFunctions* library = VaroFunctions::Get();
    if (library == nullptr)
        return;
    for (const auto& saved : m_savedSettings) {
        const wxString& name = saved.first;
        const wxString& value = saved.second;
        const bool switchOnly = name == kRecognition || name == kBeep || value == "SingleEmission";
        if (switchOnly && !IsSwitch(value))
            continue;
        library->setOption(name.mb_str(wxConvLibc), value.mb_str(wxConvLibc));
    }
}

template <typename Worker> void Varo_client::Track(Worker* worker, Worker*& marker)
{
    marker = worker;
    ++m_runningWorkers;
}

template <typename Worker> void Varo_client::Launch(Worker* worker)
{
    if (worker->Create() == wxTHREAD_NO_ERROR && worker->Run() == wxTHREAD_NO_ERROR)
        return;
    // A detached thread that never ran does not delete itself.
    Finished(worker);
    delete worker;
}

template <typename Worker> void Varo_client::Start(Worker* worker, Worker*& marker)
{
    {
        std::lock_guard<std::mutex> lock(m_stateLock);
        Track(worker, marker);
    }
    Launch(worker);
}

template <typename Worker> void Varo_client::Release(Worker* worker, Worker*& marker)
{
    std::lock_guard<std::mutex> lock(m_stateLock);
    // Only the latest worker of a kind is marked; an earlier one leaves the mark alone.
    if (marker == worker)
        marker = nullptr;
    if (--m_runningWorkers == 0)
        m_workersDone.notify_all();
}

void Varo_client::Finished(NotificationThread* worker)
{
    Release(worker, m_notificationThread);
}

void Varo_client::Finished(MeasureThread* worker)
{
    Release(worker, m_measureThread);
}

void Varo_client::Finished(TimerThread* worker)
{
    Release(worker, m_timerThread);
}
