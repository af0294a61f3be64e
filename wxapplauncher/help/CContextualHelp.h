// The launcher's side of the channel to the suite's help viewer.
#pragma once

#include <wx/string.h>

class CContextualHelp
{
public:
    explicit CContextualHelp(const wxString& appName);
    ~CContextualHelp();

    void Start();
    void ShowTopic(const wxString& page);

private:
    wxString m_appName;
};
