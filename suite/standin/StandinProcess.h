// How a stand-in was started, as the system tells it: its arguments and
// environment as UTF-8 text, and the file name it was started under.
#pragma once

#include <string>
#include <vector>

namespace standin {

// The program's arguments, its own path first. On Windows they come from the
// command line the system keeps, since main's are in the ANSI code page.
std::vector<std::string> ProgramArguments(int argc, char** argv);

// The variable's value; empty when it is unset or empty.
std::string EnvironmentValue(const char* name);

// The last part of a program path.
std::string BaseName(const std::string& path);

} // namespace standin
