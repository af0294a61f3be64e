// Helpers for the resource tests: building .res images, reading .mo catalogues, and
// bringing up translations the way start-up does.
#pragma once

#include <wx/intl.h>

#include <cstdint>
#include <map>
#include <string>
#include <vector>

// Writes a .res image entry by entry, in the layout windres produces.
class ResBuilder
{
public:
    ResBuilder();
    ResBuilder& Add(std::uint16_t type, const std::string& name,
                    const std::vector<unsigned char>& data);
    ResBuilder& Add(std::uint16_t type, std::uint16_t id, const std::vector<unsigned char>& data);
    const std::vector<unsigned char>& Bytes() const { return m_bytes; }

private:
    void AddEntry(std::uint16_t type, const std::vector<unsigned char>& nameField,
                  const std::vector<unsigned char>& data);
    std::vector<unsigned char> m_bytes;
};

// Original to translated text of a catalogue, the header entry left out.
std::map<std::string, std::string> ReadCatalog(const unsigned char* data, std::size_t size);

// The catalogue bytes embedded under a resource name such as "DE/VELTRO.MO".
std::vector<unsigned char> EmbeddedCatalog(const std::string& resourceName);

std::vector<unsigned char> ReadWholeFile(const std::string& path);

// The start-up steps that set the language and load the catalogues, for the
// language that LANG names.
void StartTranslationsLikeLauncher(wxLocale& locale, const char* lang);
