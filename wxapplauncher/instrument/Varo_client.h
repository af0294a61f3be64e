// The launcher's client of the instrument library: the two checks made before
// the Monitor module starts, the notifications the library sends from its own
// thread (turned into events for the GUI thread), and measurements with the
// instrument's options applied before and restored after each one.
#pragma once

#include <wx/string.h>
#include <wx/thread.h>

#include <condition_variable>
#include <list>
#include <map>
#include <mutex>

class NotificationThread;
class MeasureThread;
class TimerThread;

// Options ordered by the toolkit's string comparison.
struct VaroOptionLess
{
    bool operator()(const wxString& left, const wxString& right) const
    {
        return left.Cmp(right) < 0;
    }
};
typedef std::map<wxString, wxString, VaroOptionLess> VaroOptions;

class Varo_client
{
public:
    Varo_client();
    // Blocks until every worker this client started has finished.
    virtual ~Varo_client();

    // Called on the library's thread; hands the notification to a worker.
    virtual void OnNotification(int code, int data);
    virtual void PostConnected();
    virtual void PostDisconnected();
    virtual void PostButtonPressed();
    virtual void PostMeasured();
    virtual void PostMeasureError(int status);

    int CheckInstrument();
    int CheckTableMount();
    int Measure();
    void SaveSettings();
    void ApplySettings();
    void RestoreSettings();

    // Handed to the library: forwards a notification to every live client.
    static void NotifyClients(int code, int data);

    int m_busy;
    VaroOptions m_settings;
    VaroOptions m_savedSettings;
    bool m_measureOnButton;
    wxMutex* m_mutex;
    NotificationThread* m_notificationThread;
    MeasureThread* m_measureThread;
    TimerThread* m_timerThread;

    static std::list<Varo_client*> s_clients;
    static bool s_callbackRegistered;

private:
    friend class NotificationThread;
    friend class MeasureThread;
    friend class TimerThread;

    void HandleNotification(int code);
    void RunMeasurement();
    void EndBusy();

    // Worker bookkeeping: Track (with m_stateLock held) marks and counts a new
    // worker, Launch starts it, Finished is the last thing a worker does.
    template <typename Worker> void Track(Worker* worker, Worker*& marker);
    template <typename Worker> void Launch(Worker* worker);
    template <typename Worker> void Start(Worker* worker, Worker*& marker);
    template <typename Worker> void Release(Worker* worker, Worker*& marker);
    void Finished(NotificationThread* worker);
    void Finished(MeasureThread* worker);
    void Finished(TimerThread* worker);

    // Guards m_busy, the markers and the count of running workers, which
    // several threads read and write.
    std::mutex m_stateLock;
    std::condition_variable m_workersDone;
    int m_runningWorkers;
};
