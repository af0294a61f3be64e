#include "platform/FileRemoval.h"

#include <windows.h>

#include <aclapi.h>

#include <vector>

namespace {

// The SID of the token's information `kind` (the user, or the default owner of
// new files, which for an elevated administrator is the Administrators group).
std::vector<unsigned char> TokenSid(HANDLE token, TOKEN_INFORMATION_CLASS kind)
{
    DWORD size = 0;
    GetTokenInformation(token, kind, nullptr, 0, &size);
    std::vector<unsigned char> info(size);
    if (size == 0 || !GetTokenInformation(token, kind, info.data(), size, &size))
        return {};
    const PSID sid = kind == TokenUser ? reinterpret_cast<TOKEN_USER*>(info.data())->User.Sid
                                       : reinterpret_cast<TOKEN_OWNER*>(info.data())->Owner;
    std::vector<unsigned char> copy(GetLengthSid(sid));
    CopySid(DWORD(copy.size()), copy.data(), sid);
    return copy;
}

bool OwnedByUser(HANDLE file)
{
    PSID owner = nullptr;
    PSECURITY_DESCRIPTOR descriptor = nullptr;
    if (GetSecurityInfo(file, SE_FILE_OBJECT, OWNER_SECURITY_INFORMATION, &owner, nullptr, nullptr,
                        nullptr, &descriptor) != ERROR_SUCCESS)
        return false;
    HANDLE token = nullptr;
    bool own = false;
    if (OpenProcessToken(GetCurrentProcess(), TOKEN_QUERY, &token)) {
        for (const TOKEN_INFORMATION_CLASS kind : {TokenUser, TokenOwner}) {
            std::vector<unsigned char> sid = TokenSid(token, kind);
            own = own || (!sid.empty() && EqualSid(owner, sid.data()));
        }
        CloseHandle(token);
    }
    LocalFree(descriptor);
    return own;
}

} // namespace

// Opened without sharing anything, the file opens only while no other handle
// refers to it, and nobody can open it until it is gone. A reparse point is
// opened as itself, never followed, and left alone.
bool RemoveFileIfUnused(const wxString& path)
{
    const HANDLE file = CreateFileW(path.wc_str(), DELETE | READ_CONTROL | FILE_READ_ATTRIBUTES, 0,
                                    nullptr, OPEN_EXISTING, FILE_FLAG_OPEN_REPARSE_POINT, nullptr);
    if (file == INVALID_HANDLE_VALUE)
        return false;
    BY_HANDLE_FILE_INFORMATION info;
    FILE_DISPOSITION_INFO disposition = {TRUE};
    const bool removed =
        GetFileInformationByHandle(file, &info) &&
        !(info.dwFileAttributes &
          (FILE_ATTRIBUTE_DIRECTORY | FILE_ATTRIBUTE_REPARSE_POINT | FILE_ATTRIBUTE_DEVICE)) &&
        OwnedByUser(file) &&
        SetFileInformationByHandle(file, FileDispositionInfo, &disposition, sizeof disposition);
    CloseHandle(file);
    return removed;
}
