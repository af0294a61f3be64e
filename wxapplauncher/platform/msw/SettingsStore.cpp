#include "platform/SettingsStore.h"

#include <wx/msw/regconf.h>
#include <wx/msw/registry.h>

// The registry as the suite's updater uses it: "Software\Zelgrave\<appName>"
// below HKEY_CURRENT_USER, read first and written, then the same key below
// HKEY_LOCAL_MACHINE. A value of the wrong type counts as missing in that store.
namespace {

const wxString kVendor = "Zelgrave";

} // namespace

SettingsStore::SettingsStore(const wxString& appName)
{
    m_config = std::make_unique<wxRegConfig>(appName, kVendor, wxString(), wxString(),
                                             wxCONFIG_USE_GLOBAL_FILE);
    // Values are taken as stored, "%USERPROFILE%" included.
    m_config->SetExpandEnvVars(false);
    wxRegKey user(wxRegKey::HKCU, "Software\\" + kVendor + "\\" + appName);
    m_writable = user.Open(wxRegKey::Write);
}

SettingsStore::~SettingsStore() = default;

bool SettingsStore::Read(const wxString& key, wxString& value) const
{
    return m_config->Read(key, &value);
}

bool SettingsStore::Read(const wxString& key, long& value) const
{
    long read = 0;
    if (!m_config->Read(key, &read))
        return false;
    value = read;
    return true;
}

void SettingsStore::Write(const wxString& key, long value)
{
    if (!m_writable)
        return;
    m_config->Write(key, value);
    m_config->Flush(false);
}
