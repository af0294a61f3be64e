// Version numbers of executables: the launcher's own for the splash and About box,
// and each module's for its information window.
#pragma once

#include <wx/string.h>

#include <cstddef>
#include <vector>

// The version resource of one file, read once at construction. Throws std::runtime_error
// when the file or its version resource cannot be read.
class VersionInfo
{
public:
    explicit VersionInfo(const wxString& path);

    // The product version as four numbers, the last with at least two digits ("3.0.21.07").
    wxString FormatVersion() const;

private:
    std::vector<unsigned char> m_buffer;
    std::size_t m_fixedInfo = 0; // offset of the VS_FIXEDFILEINFO in m_buffer
};

// The launcher's own product version, read from the running executable; empty if unreadable.
wxString GetLauncherVersion();

// The product version of the file, or the translated "N/A" when it cannot be read.
wxString GetFileVersionString(const wxString& path);
