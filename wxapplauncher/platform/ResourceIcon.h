// Window icons that the system makes itself from icon image resources, where
// it makes them.
#pragma once

#include <wx/icon.h>

#include <cstddef>
#include <optional>

// The system's icon of an icon image resource of `size` bytes, made at the
// width and height its group gives; invalid when the system cannot make it.
// Empty where the system makes no icons from resources: the launcher then
// decodes the image itself.
std::optional<wxIcon> SystemIconFromResource(const unsigned char* data, std::size_t size, int width,
                                             int height);
