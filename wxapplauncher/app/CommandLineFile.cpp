#include "app/CommandLineFile.h"

#include "platform/OwnArguments.h"

#include <wx/cmdargs.h>
#include <wx/strconv.h>

wxString MakeAbsolutePath(const wxString& path, const wxString& base)
{
    if (path.empty() || path.StartsWith("/"))
        return path;
    if (!base.StartsWith("/"))
        return wxString();
    wxString relative = path;
    while (relative.StartsWith("./")) {
        relative.erase(0, 2);
        while (relative.StartsWith("/"))
            relative.erase(0, 1);
    }
    if (relative.empty() || relative == ".")
        return base;
    return (base.EndsWith("/") ? base : base + "/") + relative;
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
        const wxCharBuffer back = wxSafeConvertWX2MB(candidate.wc_str());
        if (!candidate.empty() && back && raw[1] == back.data())
            return MakeAbsolutePath(candidate, startDir);
    }
    return wxString();
}
