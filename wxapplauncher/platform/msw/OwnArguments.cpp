#include "platform/OwnArguments.h"

#include <windows.h>

#include <shellapi.h>

namespace {

std::string ToUtf8(const wchar_t* text)
{
    const int size = WideCharToMultiByte(CP_UTF8, 0, text, -1, nullptr, 0, nullptr, nullptr);
    if (size <= 1)
        return std::string();
    std::string bytes(static_cast<size_t>(size), '\0');
    WideCharToMultiByte(CP_UTF8, 0, text, -1, &bytes[0], size, nullptr, nullptr);
    bytes.resize(static_cast<size_t>(size) - 1);
    return bytes;
}

} // namespace

// Split the way the C runtime splits it, so the arguments are the ones the
// caller quoted.
bool ReadOwnArguments(std::vector<std::string>& args)
{
    int count = 0;
    LPWSTR* words = CommandLineToArgvW(GetCommandLineW(), &count);
    if (!words)
        return false;
    args.clear();
    for (int i = 0; i < count; ++i)
        args.push_back(ToUtf8(words[i]));
    LocalFree(words);
    return !args.empty();
}

std::string RawArgument(const wxString& argument)
{
    return ToUtf8(argument.wc_str());
}
