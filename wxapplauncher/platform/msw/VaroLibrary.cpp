#include "platform/VaroLibrary.h"

#include <windows.h>

#include <string>

namespace {

const wchar_t kLibraryName[] = L"Varo.dll";

// The launcher's own folder, with its trailing back slash; empty when the
// system does not say.
std::wstring LauncherFolder()
{
    std::wstring path(MAX_PATH, L'\0');
    for (;;) {
        const DWORD length = GetModuleFileNameW(nullptr, &path[0], DWORD(path.size()));
        if (length == 0)
            return std::wstring();
        if (length < path.size()) {
            path.resize(length);
            break;
        }
        path.resize(path.size() * 2);
    }
    return path.substr(0, path.find_last_of(L'\\') + 1);
}

// A library that cannot be loaded is missing: no error box from the system.
HMODULE Load(const std::wstring& name)
{
    DWORD previous = 0;
    SetThreadErrorMode(SEM_FAILCRITICALERRORS | SEM_NOOPENFILEERRORBOX, &previous);
    const HMODULE module = LoadLibraryW(name.c_str());
    SetThreadErrorMode(previous, nullptr);
    return module;
}

} // namespace

const VaroLibrary& VaroLibrary::Get()
{
    static const VaroLibrary library;
    return library;
}

VaroLibrary::VaroLibrary() : m_handle(nullptr)
{
    const std::wstring folder = LauncherFolder();
    if (!folder.empty() &&
        GetFileAttributesW((folder + kLibraryName).c_str()) != INVALID_FILE_ATTRIBUTES)
        m_handle = Load(folder + kLibraryName);
    if (m_handle == nullptr)
        m_handle = Load(kLibraryName);
}

void* VaroLibrary::Function(int ordinal) const
{
    if (m_handle == nullptr || ordinal <= 0 || ordinal > 0xFFFF)
        return nullptr;
    return reinterpret_cast<void*>(
        GetProcAddress(static_cast<HMODULE>(m_handle), MAKEINTRESOURCEA(ordinal)));
}

void* VaroLibrary::Symbol(const char* name) const
{
    if (m_handle == nullptr || name == nullptr)
        return nullptr;
    return reinterpret_cast<void*>(GetProcAddress(static_cast<HMODULE>(m_handle), name));
}
