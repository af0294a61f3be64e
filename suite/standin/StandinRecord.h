// The start record a stand-in appends to its log: who was started, where and
// with which arguments, in a line format the tests parse back.
#pragma once

#include <string>
#include <utility>
#include <vector>

namespace standin {

// Backslash, newline and tab become two-character escapes; nothing else changes.
std::string EscapeField(const std::string& text);

// `extra` lines ("key<TAB>value") go before the record's end.
std::string FormatRecord(const std::vector<std::string>& argv, long pid, const std::string& cwd,
                         const std::vector<std::pair<std::string, std::string>>& extra = {});

// The working directory as UTF-8, or an empty string when it cannot be read.
std::string CurrentDirectory();

long ProcessId();

// Appends with one write to a file opened for appending only, so records of
// programs started at the same moment never interleave. The path is UTF-8.
bool AppendRecord(const std::string& path, const std::string& record);

} // namespace standin
