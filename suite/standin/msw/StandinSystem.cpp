#include "StandinProcess.h"
#include "StandinRecord.h"
#include "Utf16.h"

#include <windows.h>

#include <shellapi.h>

namespace standin {

std::vector<std::string> ProgramArguments(int, char**)
{
    std::vector<std::string> arguments;
    int count = 0;
    wchar_t** split = CommandLineToArgvW(GetCommandLineW(), &count);
    if (split == nullptr)
        return arguments;
    for (int i = 0; i < count; ++i)
        arguments.push_back(Utf8(split[i]));
    LocalFree(split);
    return arguments;
}

std::string EnvironmentValue(const char* name)
{
    const std::wstring wideName = Utf16(name);
    std::wstring value(256, L'\0');
    for (;;) {
        const DWORD size = GetEnvironmentVariableW(wideName.c_str(), value.data(),
                                                   static_cast<DWORD>(value.size()));
        if (size < value.size()) {
            value.resize(size);
            return Utf8(value);
        }
        value.resize(size);
    }
}

std::string BaseName(const std::string& path)
{
    return path.substr(path.find_last_of("/\\") + 1);
}

std::string CurrentDirectory()
{
    const DWORD size = GetCurrentDirectoryW(0, nullptr);
    std::wstring directory(size, L'\0');
    const DWORD length = GetCurrentDirectoryW(size, directory.data());
    if (length == 0 || length >= size)
        return std::string();
    directory.resize(length);
    return Utf8(directory);
}

long ProcessId()
{
    return static_cast<long>(GetCurrentProcessId());
}

bool AppendRecord(const std::string& path, const std::string& record)
{
    // With append access alone, the system puts every write at the end of the file.
    HANDLE file = CreateFileW(Utf16(path).c_str(), FILE_APPEND_DATA,
                              FILE_SHARE_READ | FILE_SHARE_WRITE | FILE_SHARE_DELETE, nullptr,
                              OPEN_ALWAYS, FILE_ATTRIBUTE_NORMAL, nullptr);
    if (file == INVALID_HANDLE_VALUE)
        return false;
    DWORD written = 0;
    const bool whole =
        WriteFile(file, record.data(), static_cast<DWORD>(record.size()), &written, nullptr) &&
        written == record.size();
    return CloseHandle(file) && whole;
}

} // namespace standin
