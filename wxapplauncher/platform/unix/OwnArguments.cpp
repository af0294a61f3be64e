#include "platform/OwnArguments.h"

#include <wx/strconv.h>

#include <fstream>
#include <iterator>

bool ReadOwnArguments(std::vector<std::string>& args)
{
    std::ifstream in("/proc/self/cmdline", std::ios::binary);
    if (!in)
        return false;
    const std::string all((std::istreambuf_iterator<char>(in)), std::istreambuf_iterator<char>());
    args.clear();
    for (size_t start = 0; start < all.size();) {
        const size_t end = all.find('\0', start);
        args.push_back(
            all.substr(start, end == std::string::npos ? std::string::npos : end - start));
        if (end == std::string::npos)
            break;
        start = end + 1;
    }
    return !args.empty();
}

// The bytes of the locale's character set, as the caller's shell passed them.
std::string RawArgument(const wxString& argument)
{
    const wxCharBuffer bytes = wxSafeConvertWX2MB(argument.wc_str());
    return bytes ? std::string(bytes.data()) : std::string();
}
