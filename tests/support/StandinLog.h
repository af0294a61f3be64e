// Reads the start records that the suite's stand-ins append to their log, so a
// test can see exactly which program was started, where and with what.
#pragma once

#include <optional>
#include <string>
#include <sys/types.h>
#include <vector>

struct StandinRecord
{
    std::string exe; // argv[0] as the stand-in received it
    pid_t pid = 0;
    std::string cwd;
    std::vector<std::string> args;     // the arguments after argv[0]
    std::optional<std::string> silent; // the updater only: the "Silent" it found
};

// A field of a record line: \\, \n and \t stand for a backslash, a line
// feed and a tab. The launcher probe's log uses the same escaping.
std::string UnescapeField(const std::string& text);

// Every complete record in the file, oldest first; none when there is no file.
std::vector<StandinRecord> ReadRecords(const std::string& path);

// Waits, with the toolkit's events flowing, until the file holds at least
// `count` records or `timeoutMs` has passed, and returns what it holds then.
std::vector<StandinRecord> WaitForRecords(const std::string& path, size_t count,
                                          int timeoutMs = 10000);

// Every record, once all the stand-ins this process started (but `except`) have ended: a
// stand-in writes its record before it ends, so nothing started so far is missing.
std::vector<StandinRecord> SettledRecords(const std::string& path, pid_t except = 0,
                                          int timeoutMs = 10000);
