#include "settings/CProfileConfig.h"

CProfileConfig::CProfileConfig(const wxString& appName) : m_store(appName) {}

CProfileConfig::~CProfileConfig() = default;

wxString CProfileConfig::ReadString(const wxString& key, const wxString& defaultValue) const
{
    wxString value;
    return m_store.Read(key, value) ? value : defaultValue;
}

long CProfileConfig::ReadLong(const wxString& key, long defaultValue) const
{
    long value = defaultValue;
    return m_store.Read(key, value) ? value : defaultValue;
}

void CProfileConfig::WriteLong(const wxString& key, long value)
{
    m_store.Write(key, value);
}
