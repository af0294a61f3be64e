#include "frame/Veltro3MainAppStandardView.h"
#include "platform/UserLanguage.h"

namespace {

// A row matches a whole language family by its code ("de" matches "de", "de_AT"),
// or exact canonical names only.
struct LanguageRow
{
    bool family;
    const char* names[3];
    int id;
};

const LanguageRow kLanguageRows[] = {
    {false, {"en_GB"}, 0x0809},
    {true, {"en"}, 0x0409},
    {true, {"fr"}, 0x040C},
    {false, {"it_IT", "it", "it_CH"}, 0x0410},
    {true, {"de"}, 0x0407},
    {true, {"es"}, 0x040A},
    {false, {"nl_NL", "nl", "nl_BE"}, 0x0413},
    {false, {"pt_BR"}, 0x0416},
    {false, {"ja_JP", "ja"}, 0x0411},
    {false, {"zh_CN"}, 0x0804},
};

bool Matches(const LanguageRow& row, const wxString& name)
{
    for (const char* candidate : row.names) {
        if (!candidate)
            break;
        if (name == candidate || (row.family && name.StartsWith(wxString(candidate) + "_")))
            return true;
    }
    return false;
}

} // namespace

int GetModuleLanguageId()
{
    const wxString name = GetUserLanguageName();
    for (const LanguageRow& row : kLanguageRows)
        if (Matches(row, name))
            return row.id;
    return 0x0409;
}
