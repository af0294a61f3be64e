#include "UpdaterSettings.h"
#include "Utf16.h"

#include <windows.h>

#include <cstdint>
#include <cstring>

namespace standin {

namespace {

// Where the launcher's settings store keeps the updater's values.
const wchar_t kSettingsKey[] = L"Software\\Zelgrave\\Zel Updater";

template <typename Integer> Integer Number(const std::wstring& data)
{
    Integer number;
    std::memcpy(&number, data.data(), sizeof(number));
    return number;
}

std::optional<std::string> ReadSilent(HKEY root)
{
    HKEY key;
    if (RegOpenKeyExW(root, kSettingsKey, 0, KEY_QUERY_VALUE, &key) != ERROR_SUCCESS)
        return std::nullopt;
    DWORD type = 0;
    DWORD size = 0;
    std::optional<std::string> value;
    if (RegQueryValueExW(key, L"Silent", nullptr, &type, nullptr, &size) == ERROR_SUCCESS) {
        std::wstring data((size + sizeof(wchar_t) - 1) / sizeof(wchar_t) + 1, L'\0');
        if (RegQueryValueExW(key, L"Silent", nullptr, &type, reinterpret_cast<BYTE*>(data.data()),
                             &size) == ERROR_SUCCESS) {
            // The toolkit stores an integer as a DWORD holding a signed long.
            if (type == REG_DWORD && size == sizeof(std::int32_t))
                value = std::to_string(Number<std::int32_t>(data));
            else if (type == REG_QWORD && size == sizeof(std::int64_t))
                value = std::to_string(Number<std::int64_t>(data));
            else if (type == REG_SZ || type == REG_EXPAND_SZ)
                value = Utf8(data.c_str());
        }
    }
    RegCloseKey(key);
    return value;
}

} // namespace

std::optional<std::string> FindSilentSetting()
{
    if (auto value = ReadSilent(HKEY_CURRENT_USER))
        return value;
    return ReadSilent(HKEY_LOCAL_MACHINE);
}

} // namespace standin
