// Environment variables set for one test and put back afterwards, so that
// tests run one after the other in one process stay independent. Through the
// toolkit, which sets both the system's and the C runtime's copy on Windows.
#pragma once

#include <wx/utils.h>

#include <optional>
#include <string>
#include <utility>
#include <vector>

class ScopedEnv
{
public:
    explicit ScopedEnv(const std::vector<std::pair<std::string, std::string>>& vars)
    {
        for (const auto& [name, value] : vars) {
            wxString old;
            m_saved.emplace_back(name, wxGetEnv(name, &old)
                                           ? std::optional<std::string>(old.utf8_string())
                                           : std::nullopt);
            wxSetEnv(name, wxString::FromUTF8(value));
        }
    }
    ~ScopedEnv()
    {
        // Backwards, so that a name given twice gets its first value back.
        for (auto saved = m_saved.rbegin(); saved != m_saved.rend(); ++saved)
            saved->second ? wxSetEnv(saved->first, wxString::FromUTF8(*saved->second))
                          : wxUnsetEnv(saved->first);
    }

private:
    std::vector<std::pair<std::string, std::optional<std::string>>> m_saved;
};
