#pragma once

// Runs the built vekcfg as a user would, from outside: the program that lies
// beside the test executable, in a folder of the test's own, with the test's
// environment (TEMP included).

#include <string>
#include <vector>

namespace cli_testing
{

struct ProgramRun
{
    int exitCode = -1;
    // As UTF-8 with the line ends of Linux, whatever the platform printed
    // them in (on Windows the console's code page and CR LF).
    std::string out;
    std::string err;
};

ProgramRun RunVekcfg(const std::vector<std::string>& arguments, const std::string& folder);

// A UTF-8 literal as the std::string the runs are compared with.
std::string Utf8(const char8_t* text);

} // namespace cli_testing
