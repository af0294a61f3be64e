// The settings the launcher shares with the suite's updater: the user's store
// is read first and written, the system-wide store read second.
#pragma once

#include "platform/SettingsStore.h"

#include <wx/string.h>

class CProfileConfig
{
public:
    explicit CProfileConfig(const wxString& appName);
    virtual ~CProfileConfig();
    CProfileConfig(const CProfileConfig&) = delete;
    CProfileConfig& operator=(const CProfileConfig&) = delete;

    // The stored value, or `defaultValue` when it is missing or unreadable.
    wxString ReadString(const wxString& key, const wxString& defaultValue) const;
    // The stored integer, or `defaultValue` when it is missing or not an integer.
    long ReadLong(const wxString& key, long defaultValue) const;
    // Stores the value in the user's store at once. Does nothing unless
    // IsWritable().
    void WriteLong(const wxString& key, long value);
    // True when the user's store can take values without losing anything it
    // holds (see SettingsStore).
    bool IsWritable() const { return m_store.IsWritable(); }

private:
    SettingsStore m_store;
};
