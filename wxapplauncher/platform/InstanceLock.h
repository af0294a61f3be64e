// The per-user instance lock: one copy of the launcher per user, and a copy that
// died, however it ended, never keeps the next one from starting.
#pragma once

#include <wx/string.h>

#include <memory>

// Used like the toolkit's single-instance checker: Create, then IsAnotherRunning.
// The system drops the lock with its holder.
class InstanceLock
{
public:
    InstanceLock();
    ~InstanceLock();
    InstanceLock(const InstanceLock&) = delete;
    InstanceLock& operator=(const InstanceLock&) = delete;

    // Takes the lock `name` in `dir` (the system's place for the user's locks
    // when empty). False when the lock cannot be made; then no copy is seen.
    bool Create(const wxString& name, const wxString& dir = wxString());
    bool IsAnotherRunning() const { return m_anotherRunning; }

private:
    // What the system keeps for a lock that is held.
    struct Held;
    std::unique_ptr<Held> m_held;
    bool m_anotherRunning = false;
};
