#include "about/VersionInfo.h"

#include "platform/LittleEndian.h"
#include "platform/VersionResource.h"

#include <wx/intl.h>

#include <memory>
#include <stdexcept>

VersionInfo::VersionInfo(const wxString& path)
{
    switch (ReadVersionResource(std::string(path.fn_str()), m_buffer, m_fixedInfo)) {
    case VersionResourceResult::Found:
        return;
    case VersionResourceResult::Missing:
        throw std::runtime_error("VersionInfo: can not find the file.");
    case VersionResourceResult::Malformed:
        break;
    }
    throw std::runtime_error("VersionInfo: can not retrieve version information");
}

wxString VersionInfo::FormatVersion() const
{
    // Of the fixed info only the product version counts, never the file version.
    const unsigned char* fixed = m_buffer.data() + m_fixedInfo;
    const std::uint32_t ms = Le32(fixed + 16), ls = Le32(fixed + 20);
    const unsigned first = ms >> 16, second = ms & 0xFFFF, third = ls >> 16, fourth = ls & 0xFFFF;
    return wxString::Format(fourth >= 10 ? "%u.%u.%u.%u" : "%u.%u.%u.0%u", first, second, third,
                            fourth);
}

namespace {

wxString FormattedVersionOr(const wxString& path, const wxString& fallback)
{
    try {
        return std::make_unique<VersionInfo>(path)->FormatVersion();
    } catch (...) {
        return fallback;
    }
}

} // namespace

wxString GetLauncherVersion()
{
    // "Veltrona.exe" is the running executable, whatever it was started as.
    return FormattedVersionOr("/proc/self/exe", wxString());
}

wxString GetFileVersionString(const wxString& path)
{
    return FormattedVersionOr(path, _("N/A"));
}
