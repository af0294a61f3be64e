#include "help/HelpLanguage.h"

namespace {

struct HelpFolder
{
    const char* names[2];
    const char* folder;
};

const HelpFolder kHelpFolders[] = {
    {{"nl_NL", "nl"}, "nl"},    {{"en_US", nullptr}, "en"}, {{"fr_FR", "fr"}, "fr"},
    {{"de_DE", "de"}, "de"},    {{"it_IT", "it"}, "it"},    {{"ja_JP", "ja"}, "ja"},
    {{"pt_BR", nullptr}, "pt"}, {{"es_ES", "es"}, "es"},
};

} // namespace

wxString HelpFolderLanguage(const wxString& canonicalName)
{
    for (const HelpFolder& row : kHelpFolders)
        for (const char* name : row.names)
            if (name && canonicalName == name)
                return row.folder;
    return "en";
}
