#include "platform/InstanceLock.h"

#include <wx/snglinst.h>

// The toolkit's checker is a named mutex in the user's session: the system
// closes it with its holder, and started modules do not inherit it.
struct InstanceLock::Held
{
    wxSingleInstanceChecker checker;
};

InstanceLock::InstanceLock() = default;

InstanceLock::~InstanceLock() = default;

bool InstanceLock::Create(const wxString& name, const wxString& dir)
{
    m_held.reset();
    m_anotherRunning = false;
    if (name.empty() || name.Contains("\\"))
        return false;
    // Mutex names are flat: a folder becomes part of the name, which may hold
    // no back slash.
    wxString lockName = name;
    if (!dir.empty()) {
        wxString folder = dir;
        folder.Replace("\\", "/");
        lockName = folder + (folder.EndsWith("/") ? "" : "/") + name;
    }
    auto held = std::make_unique<Held>();
    if (!held->checker.Create(lockName))
        return false;
    m_anotherRunning = held->checker.IsAnotherRunning();
    if (!m_anotherRunning)
        m_held = std::move(held);
    return true;
}
