#include "platform/VaroLibrary.h"

#include <dlfcn.h>

#include <wx/filename.h>
#include <wx/stdpaths.h>

namespace {

const char kLibraryName[] = "libvaro.so";

// The library exports by name what the Windows library exports by ordinal.
struct VaroOrdinal
{
    int ordinal;
    const char* symbol;
};

const VaroOrdinal kOrdinals[] = {
    {18, "VaroRegisterCallback"}, {14, "VaroCheckInstrument"}, {23, "VaroCheckTableMount"},
    {11, "VaroSetOption"},        {12, "VaroGetOption"},       {5, "VaroMeasure"},
};

void* Open(const wxString& path)
{
    return dlopen(path.fn_str(), RTLD_NOW | RTLD_LOCAL);
}

} // namespace

const VaroLibrary& VaroLibrary::Get()
{
    static const VaroLibrary library;
    return library;
}

VaroLibrary::VaroLibrary() : m_handle(nullptr)
{
    const wxFileName besideLauncher(
        wxFileName(wxStandardPaths::Get().GetExecutablePath()).GetPath(), kLibraryName);
    if (besideLauncher.FileExists())
        m_handle = Open(besideLauncher.GetFullPath());
    if (m_handle == nullptr)
        m_handle = Open(kLibraryName);
}

void* VaroLibrary::Function(int ordinal) const
{
    for (const VaroOrdinal& entry : kOrdinals)
        if (entry.ordinal == ordinal)
            return Symbol(entry.symbol);
    return nullptr;
}

void* VaroLibrary::Symbol(const char* name) const
{
    return m_handle == nullptr || name == nullptr ? nullptr : dlsym(m_handle, name);
}
