// The settings the launcher shares with the suite's updater: a user file that
// is read first and written, and a system-wide file read second.
#pragma once

#include <wx/string.h>

class wxFileConfig;

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
    // Stores the value in the user's file at once (through a link, in the file
    // it leads to). Does nothing unless IsWritable().
    void WriteLong(const wxString& key, long value);
    // True when the user's file is missing, or is UTF-8 text that was read whole
    // and may be replaced without losing a byte. A file that is read-only, not
    // UTF-8 or unreadable is read as far as it can be and never written.
    bool IsWritable() const { return m_writable; }

    // "<config home>/Zelgrave/<appName>.conf": $XDG_CONFIG_HOME when it is an
    // absolute path, else ~/.config.
    static wxString UserFile(const wxString& appName);
    // "<config dir>/Zelgrave/<appName>.conf": the first absolute directory of
    // $XDG_CONFIG_DIRS, else /etc/xdg.
    static wxString SystemFile(const wxString& appName);

private:
    wxFileConfig* m_config;
    bool m_writable;
};
