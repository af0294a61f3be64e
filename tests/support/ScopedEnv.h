// Environment variables set for one test and put back afterwards, so that a
// run of several tests in one process stays independent.
#pragma once

#include <cstdlib>
#include <optional>
#include <string>
#include <utility>
#include <vector>

class ScopedEnv
{
public:
    // A value of std::nullopt removes the variable.
    explicit ScopedEnv(const std::vector<std::pair<std::string, std::optional<std::string>>>& vars)
    {
        for (const auto& [name, value] : vars) {
            const char* old = std::getenv(name.c_str());
            m_saved.emplace_back(name, old ? std::optional<std::string>(old) : std::nullopt);
            Set(name, value);
        }
    }
    ~ScopedEnv()
    {
        for (const auto& [name, value] : m_saved)
            Set(name, value);
    }
    ScopedEnv(const ScopedEnv&) = delete;
    ScopedEnv& operator=(const ScopedEnv&) = delete;

private:
    static void Set(const std::string& name, const std::optional<std::string>& value)
    {
        if (value)
            setenv(name.c_str(), value->c_str(), 1);
        else
            unsetenv(name.c_str());
    }

    std::vector<std::pair<std::string, std::optional<std::string>>> m_saved;
};
