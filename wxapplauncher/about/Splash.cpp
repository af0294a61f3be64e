#include "about/Splash.h"

#include "about/SplashScreen.h"
#include "about/VersionInfo.h"
#include "resources/ImageSets.h"

#include <wx/display.h>
#include <wx/intl.h>

namespace {

const int kStartupWindowLines = 7;
const int kMargin = 48;

const char* const kLegalWarning[] = {
    wxTRANSLATE("Warning: This program is protected by law."),
    wxTRANSLATE("Copyright law and international treaties apply."),
    wxTRANSLATE("Copying it without permission is prohibited."),
    wxTRANSLATE("Distributing it without permission is prohibited."),
    wxTRANSLATE("Violations may result in severe penalties."),
    wxTRANSLATE("Offenders will be prosecuted."),
    wxTRANSLATE("All use is governed by the license agreement."),
    wxTRANSLATE("By using this program, you accept its terms."),
};

const char* const kPatentIntroduction[] = {
    wxTRANSLATE("Patent notice"),
    wxTRANSLATE("This product is covered by the patents below."),
    wxTRANSLATE("Further patents are pending."),
};

const char* const kPatents[] = {
    wxTRANSLATE("U.S. Patent 0,000,001"),
    wxTRANSLATE("U.S. Patent 0,000,002"),
    wxTRANSLATE("U.S. Patent 0,000,003"),
    wxTRANSLATE("U.S. Patent 0,000,004"),
    wxTRANSLATE("U.S. Patent 0,000,005"),
    wxTRANSLATE("U.S. Patent 0,000,006"),
    wxTRANSLATE("U.S. Patent 0,000,007"),
    wxTRANSLATE("U.S. Patent 0,000,008"),
    wxTRANSLATE("U.S. Patent 0,000,009"),
    wxTRANSLATE("U.S. Patent 0,000,010"),
    wxTRANSLATE("U.S. Patent 0,000,011"),
    wxTRANSLATE("U.S. Patent 0,000,012"),
    wxTRANSLATE("U.S. Patent 0,000,013"),
    wxTRANSLATE("U.S. Patent 0,000,014"),
    wxTRANSLATE("U.S. Patent 0,000,015"),
    wxTRANSLATE("U.S. Patent 0,000,016"),
    wxTRANSLATE("U.S. Patent 0,000,017"),
    wxTRANSLATE("U.S. Patent 0,000,018"),
    wxTRANSLATE("U.S. Patent 0,000,019"),
    wxTRANSLATE("U.S. Patent 0,000,020"),
    wxTRANSLATE("U.S. Patent 0,000,021"),
    wxTRANSLATE("U.S. Patent 0,000,022"),
    wxTRANSLATE("U.S. Patent 0,000,023"),
    wxTRANSLATE("U.S. Patent 0,000,024"),
    wxTRANSLATE("U.S. Patent 0,000,025"),
    wxTRANSLATE("U.S. Patent 0,000,026"),
    wxTRANSLATE("U.S. Patent 0,000,027"),
    wxTRANSLATE("U.S. Patent 0,000,028"),
    wxTRANSLATE("European Patent EP 0 000 029"),
    wxTRANSLATE("European Patent EP 0 000 030"),
    wxTRANSLATE("European Patent EP 0 000 031"),
    wxTRANSLATE("European Patent EP 0 000 032"),
    wxTRANSLATE("European Patent EP 0 000 033"),
    wxTRANSLATE("European Patent EP 0 000 034"),
    wxTRANSLATE("European Patent EP 0 000 035"),
    wxTRANSLATE("European Patent EP 0 000 036"),
    wxTRANSLATE("German Patent DE 00 0000 000 037"),
    wxTRANSLATE("German Patent DE 00 0000 000 038"),
    wxTRANSLATE("German Patent DE 00 0000 000 039"),
    wxTRANSLATE("German Patent DE 00 0000 000 040"),
    wxTRANSLATE("Japanese Patent JP 0000041"),
    wxTRANSLATE("Japanese Patent JP 0000042"),
    wxTRANSLATE("Japanese Patent JP 0000043"),
    wxTRANSLATE("Chinese Patent ZL 000000000044.X"),
    wxTRANSLATE("Chinese Patent ZL 000000000004.5"),
    wxTRANSLATE("Canadian Patent CA 0000046"),
    wxTRANSLATE("Canadian Patent CA 0000047"),
};

// The licensor's own wording, shown as it stands in every language.
const char* const kCredits[] = {
    "Colour measurement technology licensed from",
    "Example Spectral Laboratories.",
    "Copyright 2003-2012 Example Spectral Laboratories.",
    "Used under licence.",
};

template <size_t N> void AddTranslated(wxArrayString& lines, const char* const (&texts)[N])
{
    for (const char* text : texts)
        lines.Add(wxGetTranslation(text));
}

void AddEmpty(wxArrayString& lines, int count)
{
    for (int i = 0; i < count; ++i)
        lines.Add(wxString());
}

// A translation equal to its key means the catalogue has none for this language.
bool AddIfTranslated(wxArrayString& lines, const wxString& key)
{
    const wxString text = wxGetTranslation(key);
    if (text == key)
        return false;
    lines.Add(text);
    return true;
}

} // namespace

wxArrayString SplashLines(bool startup, int& windowLineCount)
{
    wxArrayString lines;
    lines.Add(_("Version: ") + GetLauncherVersion());
    lines.Add(_("Copyright 2005-2012 Zelgrave Imaging Inc."));
    lines.Add(_("A member of the Quenta Group"));
    lines.Add(_("All rights reserved."));
    AddEmpty(lines, 3);
    if (startup) {
        windowLineCount = kStartupWindowLines;
        return lines;
    }
    AddEmpty(lines, 2);
    AddTranslated(lines, kLegalWarning);
    if (AddIfTranslated(lines, "EXTRALEGAL_1"))
        AddIfTranslated(lines, "EXTRALEGAL_2");
    windowLineCount = int(lines.size());
    AddEmpty(lines, 1);
    AddTranslated(lines, kPatentIntroduction);
    AddTranslated(lines, kPatents);
    AddEmpty(lines, 2);
    for (const char* credit : kCredits)
        lines.Add(credit);
    AddEmpty(lines, 2);
    lines.Add("All Rights Reserved.");
    AddEmpty(lines, 8);
    return lines;
}

void ShowSplash(bool startup, int milliseconds)
{
    EnsureLauncherImages();
    int windowLineCount = 0;
    const wxArrayString lines = SplashLines(startup, windowLineCount);
    const wxBitmap picture = LoadPicture(startup ? "Veltro2AppFrame::SplashMainApp"
                                                 : "Veltro2AppFrame::SplashAboutMainApp",
                                         wxDisplay().GetScaleFactor());
    const wxPoint textCentre = startup ? wxPoint(162, 346) : wxPoint(192, 372);
    // The About box may be dismissed at once; the start-up splash only by its timer.
    new ZelAboutSplashScreen(-1, startup, milliseconds, picture, lines, textCentre, windowLineCount,
                             kMargin, wxColour(180, 180, 180, 255), !startup);
}
