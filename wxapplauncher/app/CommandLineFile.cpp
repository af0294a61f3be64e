#include "app/CommandLineFile.h"

#include "platform/OwnArguments.h"

#include <wx/cmdargs.h>
#include <wx/filefn.h>
#include <wx/filename.h>

wxString MakeAbsolutePath(const wxString& path, const wxString& base)
{
    if (path.empty() || wxIsAbsolutePath(path))
        return path;
    if (!wxIsAbsolutePath(base))
        return wxString();
    const auto isSeparator = [](const wxString& text, size_t at) {
        return at < text.length() && wxFileName::IsPathSeparator(text[at]);
    };
    size_t start = 0;
    while (start < path.length() && path[start] == '.' && isSeparator(path, start + 1)) {
        start += 2;
        while (isSeparator(path, start))
            ++start;
    }
    const wxString relative = path.Mid(start);
    if (relative.empty() || relative == ".")
        return base;
    return (isSeparator(base, base.length() - 1) ? base : base + wxFILE_SEP_PATH) + relative;
}

wxString CommandLineFile(const wxCmdLineArgsArray& argv, int argc, const wxString& startDir)
{
    const wxString converted = argc > 1 ? argv[1] : wxString();
    std::vector<std::string> raw;
    if (!ReadOwnArguments(raw))
        return MakeAbsolutePath(converted, startDir);
    if (raw.size() < 2)
        return wxString();

    // Only a path that comes out byte for byte as it went in names the file the
    // user meant; the toolkit drops what it cannot read and reads some bytes
    // in the wrong character set.
    for (const wxString& candidate : {converted, wxString::FromUTF8(raw[1].c_str())}) {
        if (!candidate.empty() && RawArgument(candidate) == raw[1])
            return MakeAbsolutePath(candidate, startDir);
    }
    return wxString();
}
