#include "support/SessionBus.h"

#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

SessionBus::SessionBus()
{
    if (const char* old = std::getenv("DBUS_SESSION_BUS_ADDRESS"))
        m_saved = old;
    int out[2];
    if (pipe(out) != 0)
        return;
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    posix_spawn_file_actions_adddup2(&actions, out[1], 1);
    posix_spawn_file_actions_addclose(&actions, out[0]);
    char* argv[] = {const_cast<char*>("dbus-daemon"), const_cast<char*>("--session"),
                    const_cast<char*>("--nofork"), const_cast<char*>("--print-address=1"), nullptr};
    const bool started = posix_spawnp(&m_pid, "dbus-daemon", &actions, nullptr, argv, environ) == 0;
    posix_spawn_file_actions_destroy(&actions);
    close(out[1]);
    // The daemon prints its address once it listens.
    FILE* reader = fdopen(out[0], "r");
    char line[512] = {};
    if (started && reader && std::fgets(line, sizeof line, reader)) {
        m_address = line;
        m_address.erase(m_address.find_last_not_of('\n') + 1);
        setenv("DBUS_SESSION_BUS_ADDRESS", m_address.c_str(), 1);
    }
    if (reader)
        std::fclose(reader);
    if (!started)
        m_pid = -1;
}

SessionBus::~SessionBus()
{
    if (m_pid > 0) {
        kill(m_pid, SIGTERM);
        waitpid(m_pid, nullptr, 0);
    }
    m_saved.empty() ? unsetenv("DBUS_SESSION_BUS_ADDRESS")
                    : setenv("DBUS_SESSION_BUS_ADDRESS", m_saved.c_str(), 1);
}
