// The per-user instance lock: one copy of the launcher per user, and a copy that
// died, however it ended, never keeps the next one from starting.
#pragma once

#include <wx/string.h>

// Used like the toolkit's single-instance checker: Create, then IsAnotherRunning.
// The lock is an flock on a file in the private runtime directory; the kernel
// drops it with its holder. The file is never deleted, so two copies always
// contend for the same file.
class InstanceLock
{
public:
    InstanceLock() = default;
    ~InstanceLock();
    InstanceLock(const InstanceLock&) = delete;
    InstanceLock& operator=(const InstanceLock&) = delete;

    // Takes the lock `name` in `dir` (the private runtime directory when empty).
    // False when there is no usable directory or file; then no copy is seen.
    bool Create(const wxString& name, const wxString& dir = wxString());
    bool IsAnotherRunning() const { return m_anotherRunning; }

private:
    int m_fd = -1;
    bool m_anotherRunning = false;
};
