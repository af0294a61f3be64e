#include "about/VersionInfo.h"

#include "platform/LittleEndian.h"
#include "platform/ResourceImage.h"
#include "platform/VersionResource.h"

#include <wx/intl.h>

#include <memory>
#include <stdexcept>

namespace {

void ThrowUnlessFound(VersionResourceResult result)
{
    switch (result) {
    case VersionResourceResult::Found:
        return;
    case VersionResourceResult::Missing:
        throw std::runtime_error("VersionInfo: can not find the file.");
    case VersionResourceResult::Malformed:
        break;
    }
    throw std::runtime_error("VersionInfo: can not retrieve version information");
}

} // namespace

VersionInfo::VersionInfo(const wxString& path)
{
    ThrowUnlessFound(ReadVersionResource(path.utf8_string(), m_buffer, m_fixedInfo));
}

VersionInfo::VersionInfo(const ResourceImage& resources)
{
    ThrowUnlessFound(ReadVersionResource(resources, m_buffer, m_fixedInfo));
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

template <typename Source>
wxString FormattedVersionOr(const Source& source, const wxString& fallback)
{
    try {
        return std::make_unique<VersionInfo>(source)->FormatVersion();
    } catch (...) {
        return fallback;
    }
}

} // namespace

wxString GetLauncherVersion()
{
    // The running executable's resources, whatever it was started as; read before the
    // splash anyway, so its start costs no second reading of the file.
    return FormattedVersionOr(ResourceImage::OfExecutable(), wxString());
}

wxString GetFileVersionString(const wxString& path)
{
    return FormattedVersionOr(path, _("N/A"));
}
