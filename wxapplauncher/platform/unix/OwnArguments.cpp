#include "platform/OwnArguments.h"

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
