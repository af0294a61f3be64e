// A private headless Wayland compositor (weston), with or without XWayland, for tests that run the
// launcher on a Wayland desktop. Headless weston has no input seat.
#pragma once

#include <string>
#include <sys/types.h>

class WestonServer
{
public:
    WestonServer(int width, int height, bool xwayland);
    ~WestonServer();
    WestonServer(const WestonServer&) = delete;
    WestonServer& operator=(const WestonServer&) = delete;

    // Its own XDG_RUNTIME_DIR, which holds the socket; for WAYLAND_DISPLAY.
    const std::string& RuntimeDir() const { return m_runtimeDir; }
    const char* Socket() const { return "wayland-test"; }
    // True once weston serves clients (and XWayland listens, when asked for).
    bool Ready() const { return m_ready; }
    pid_t Pid() const { return m_pid; }
    // XWayland's ":N", empty without it.
    const std::string& Display() const { return m_display; }

private:
    pid_t m_pid = -1;
    bool m_ready = false;
    std::string m_runtimeDir;
    std::string m_display;
};
