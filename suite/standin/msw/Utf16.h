// Conversions between the stand-ins' UTF-8 text and the UTF-16 of Windows' own
// functions.
#pragma once

#include <string>

namespace standin {

std::wstring Utf16(const std::string& text);
std::string Utf8(const std::wstring& text);

} // namespace standin
