// Checks that bytes form a GNU gettext message catalogue (.mo) whose every table and
// string lies inside them and that the toolkit's own reader can take, so that a damaged
// or hostile catalogue is skipped before the toolkit reads it.
#pragma once

#include <cstddef>

bool IsWellFormedCatalog(const unsigned char* data, std::size_t size);
