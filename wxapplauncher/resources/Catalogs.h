// Translation catalogues stored in the executable, copied into the memory file system.
#pragma once

#include <wx/intl.h>
#include <wx/string.h>

class ResourceImage;

// Copies every catalogue resource of the executable into the memory file system.
void LoadCatalogResources();
void LoadCatalogResources(const ResourceImage& image);

// The memory file name of a catalogue resource: "DE/VELTRO.MO" gives "./de/Veltro.mo",
// "ZH_CN/VELTRO.MO" gives "./zh_CN/Veltro.mo"; empty for a name that does not fit.
wxString CatalogMemoryName(const wxString& resourceName);

// Copies one catalogue resource; a missing, misnamed or damaged one is skipped.
// Always true, so that an enumeration goes on over all resources.
bool LoadCatalogResource(const ResourceImage& image, const wxString& resourceName);

// Sets up the locale and the translations for the user's decided language
// (DecideUserLanguage), so that catalogues are found in the memory file system
// also when the system locale itself is not installed.
void InitLocale(wxLocale& locale);
