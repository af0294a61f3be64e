// Environment variables set for one test and put back afterwards, so that
// tests run one after the other in one process stay independent.
#pragma once

#include <cstdlib>
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
            const char* old = std::getenv(name.c_str());
            m_saved.emplace_back(name, old ? std::optional<std::string>(old) : std::nullopt);
            setenv(name.c_str(), value.c_str(), 1);
        }
    }
    ~ScopedEnv()
    {
        // Backwards, so that a name given twice gets its first value back.
        for (auto saved = m_saved.rbegin(); saved != m_saved.rend(); ++saved)
            saved->second ? setenv(saved->first.c_str(), saved->second->c_str(), 1)
                          : unsetenv(saved->first.c_str());
    }

private:
    std::vector<std::pair<std::string, std::optional<std::string>>> m_saved;
};
