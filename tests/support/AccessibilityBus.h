// An accessibility bus of the test's own, with its registry, for reading the accessible
// trees of the programs the test starts: while it exists, the test and what it starts use
// this bus and no other (not one that a desktop named on the display's root window).
#pragma once

#include "support/ScopedEnv.h"

#include <optional>
#include <string>
#include <sys/types.h>

class AccessibilityBus
{
public:
    AccessibilityBus();
    ~AccessibilityBus();
    AccessibilityBus(const AccessibilityBus&) = delete;
    AccessibilityBus& operator=(const AccessibilityBus&) = delete;

    // Empty once the bus and its registry answer, else what did not come up.
    const std::string& Failure() const { return m_failure; }

private:
    std::string m_dir;
    pid_t m_daemon = -1;
    pid_t m_registry = -1;
    std::optional<ScopedEnv> m_env;
    std::string m_failure;
};
