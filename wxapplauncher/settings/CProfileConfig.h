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
    // Stores the value in the user's file at once. Does nothing when that file
    // exists but could not be read whole, so that nothing in it is lost.
    void WriteLong(const wxString& key, long value);

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
