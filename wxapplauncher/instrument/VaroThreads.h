// The detached workers of the instrument client. Each one reports its end to
// its client, which waits for all of them before it goes away. The report is
// made from OnExit: from then on the toolkit itself accounts for the ending
// thread, so a program that ends right after the client is gone ends cleanly.
#pragma once

#include <wx/thread.h>

class Varo_client;

// Dispatches one library notification.
class NotificationThread : public wxThread
{
public:
    NotificationThread(Varo_client* client, int code);

    Varo_client* m_client;
    int m_code;

protected:
    ExitCode Entry() override;
    void OnExit() override;
};

// Runs one measurement and posts its result.
class MeasureThread : public wxThread
{
public:
    explicit MeasureThread(Varo_client* client);

    Varo_client* m_client;

protected:
    ExitCode Entry() override;
    void OnExit() override;
};

// Ends the client's busy time half a second after a measurement.
class TimerThread : public wxThread
{
public:
    explicit TimerThread(Varo_client* client);

    Varo_client* m_client;

protected:
    ExitCode Entry() override;
    void OnExit() override;
};
