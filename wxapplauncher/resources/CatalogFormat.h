// Checks that bytes form a GNU gettext message catalogue (.mo) whose every table and
// string lies inside them, so that a damaged catalogue is skipped before the toolkit reads it.
#pragma once

#include <cstddef>

bool IsWellFormedCatalog(const unsigned char* data, std::size_t size);
