// The launcher's IPC over Unix sockets: where a service's socket lives, and the
// toolkit's socket IPC protocol as the client and server speak it: one code
// byte per message; names and data as a little-endian 32-bit length and the
// bytes (names in UTF-8).
#pragma once

#include <wx/string.h>

#include <cstdint>
#include <string>

// The socket path of `service` in the private directory. Empty when the name is
// empty, ".", "..", or holds a "/" or a NUL, when the private directory is not
// safe to use, or when the path does not fit a Unix socket address.
wxString GetServiceSocketPath(const wxString& service);

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
