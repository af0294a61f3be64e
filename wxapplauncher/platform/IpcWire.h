// The toolkit's socket IPC protocol as the launcher's client and server speak
// it: one code byte per message; names and data as a little-endian 32-bit
// length and the bytes (names in UTF-8).
#pragma once

#include <cstdint>
#include <string>

enum IpcCode : unsigned char
{
    kIpcPoke = 3,
    kIpcFail = 9,
    kIpcConnect = 10,
    kIpcDisconnect = 11,
};

inline void AppendIpcBlock(std::string& out, const void* data, std::uint32_t size)
{
    for (int shift = 0; shift < 32; shift += 8)
        out += static_cast<char>((size >> shift) & 0xff);
    out.append(static_cast<const char*>(data), size);
}
