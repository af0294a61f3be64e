// The launcher's own command line exactly as the caller passed it, before the
// toolkit converted it (and dropped what it could not convert).
#pragma once

#include <wx/string.h>

#include <string>
#include <vector>

// The raw arguments, argv[0] first; false when the system does not say.
bool ReadOwnArguments(std::vector<std::string>& args);

// The raw form ReadOwnArguments gives of `argument`; empty when it has none.
std::string RawArgument(const wxString& argument);
