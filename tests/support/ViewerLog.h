// Reads what the help viewer stand-in logs: one line per event ("poke" with
// item and text, "refused" with item, "page" with the file shown).
#pragma once

#include <string>
#include <vector>

using ViewerLine = std::vector<std::string>; // kind, then the fields

std::vector<ViewerLine> ReadViewerLog(const std::string& path);
