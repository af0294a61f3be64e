#include "platform/Ipc.h"

#include <cstring>

bool ReadPokeText(const void* data, size_t size, wxIPCFormat format, wxString& text)
{
    text.clear();
    if (!data || size > kIpcMaxPokeSize || (format != wxIPC_TEXT && format != wxIPC_UTF8TEXT))
        return false;
    const char* bytes = static_cast<const char*>(data);
    const void* end = std::memchr(bytes, '\0', size);
    const size_t length = end ? static_cast<const char*>(end) - bytes : size;
    text = wxString::FromUTF8(bytes, length);
    return length == 0 || !text.empty();
}
