#include "support/SessionBus.h"

#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <sys/wait.h>

SessionBus::SessionBus()
{
    if (const char* old = std::getenv("DBUS_SESSION_BUS_ADDRESS"))
        m_saved = old;
    // The daemon forks into the background once it listens, after printing
    // its address and its pid.
    FILE* out = popen("dbus-daemon --session --fork --print-address=1 --print-pid=1", "r");
    char address[512] = {};
    if (!out)
        return;
    if (std::fscanf(out, "%511s %d", address, &m_pid) == 2) {
        m_address = address;
        setenv("DBUS_SESSION_BUS_ADDRESS", address, 1);
    }
    pclose(out);
}

SessionBus::~SessionBus()
{
    if (m_pid > 0)
        kill(m_pid, SIGTERM);
    m_saved.empty() ? unsetenv("DBUS_SESSION_BUS_ADDRESS")
                    : setenv("DBUS_SESSION_BUS_ADDRESS", m_saved.c_str(), 1);
}
