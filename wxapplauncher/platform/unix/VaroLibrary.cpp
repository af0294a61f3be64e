#include "platform/VaroLibrary.h"

#include <dlfcn.h>

#include <wx/filename.h>
#include <wx/stdpaths.h>

namespace {

const char kLibraryName[] = "libvaro.so";

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

void* VaroLibrary::Symbol(const char* name) const
{
    return m_handle == nullptr || name == nullptr ? nullptr : dlsym(m_handle, name);
}
