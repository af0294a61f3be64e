#include "platform/ResourceIcon.h"

std::optional<wxIcon> SystemIconFromResource(const unsigned char*, std::size_t, int, int)
{
    return std::nullopt;
}
