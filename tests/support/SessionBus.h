// A private D-Bus session bus for one test, so that the accessibility bus
// and its registry start for the programs the test runs and no other.
#pragma once

#include <string>
#include <sys/types.h>

class SessionBus
{
public:
    // Starts dbus-daemon and points DBUS_SESSION_BUS_ADDRESS at it.
    SessionBus();
    ~SessionBus();
    SessionBus(const SessionBus&) = delete;
    SessionBus& operator=(const SessionBus&) = delete;

    // Empty when the daemon did not come up.
    const std::string& Address() const { return m_address; }

private:
    pid_t m_pid = -1;
    std::string m_address;
    std::string m_saved;
};
