#include "support/ViewerLog.h"

#include "support/StandinLog.h"

#include <fstream>
#include <sstream>

std::vector<ViewerLine> ReadViewerLog(const std::string& path)
{
    std::vector<ViewerLine> lines;
    std::ifstream in(path);
    std::string text;
    while (std::getline(in, text)) {
        ViewerLine line;
        std::stringstream fields(text);
        std::string field;
        while (std::getline(fields, field, '\t'))
            line.push_back(UnescapeField(field));
        lines.push_back(line);
    }
    return lines;
}
