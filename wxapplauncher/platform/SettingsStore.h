// The store behind the settings the launcher shares with the suite's updater,
// under the vendor "Zelgrave": the user's store, read first and the only one
// written, and the system-wide store, read second. Value names and types are
// the same on every system.
#pragma once

#include <wx/string.h>

#include <memory>

class wxConfigBase;

class SettingsStore
{
public:
    explicit SettingsStore(const wxString& appName);
    ~SettingsStore();
    SettingsStore(const SettingsStore&) = delete;
    SettingsStore& operator=(const SettingsStore&) = delete;

    // The stored value, the user's before the system's; false when neither
    // store holds a readable one.
    bool Read(const wxString& key, wxString& value) const;
    // The same for an integer; false also when the value is not one.
    bool Read(const wxString& key, long& value) const;
    // Stores the value in the user's store at once. Does nothing unless
    // IsWritable().
    void Write(const wxString& key, long value);
    // True when the user's store can take values without losing anything it
    // holds. A store that cannot is read as far as it can be and never written.
    bool IsWritable() const { return m_writable; }

private:
    std::unique_ptr<wxConfigBase> m_config;
    bool m_writable = false;
};
