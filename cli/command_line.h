#pragma once

// What vekcfg is asked to do, read from its arguments. Scripts rely on this
// interface; it changes only by adding to it.

#include <string>
#include <vector>

namespace cli
{

// The project's version, given by the build.
inline constexpr char kVersion[] = VEK_VERSION;

enum class Command
{
    Help,
    Version,
    Check,
    CheckConfig,
    Show,
};

struct Invocation
{
    Command command = Command::Help;
    // check
    bool details = false;
    std::string svgPath; // empty: no picture
    std::string musicPath;
    std::string tensionPath;
    // check-config, show; empty: the platform's default file
    std::string settingsPath;
    // show
    bool json = false;
};

struct ParsedCommandLine
{
    bool valid = false;
    Invocation invocation;
    // Why the arguments were refused, for the usage error.
    std::string error;
};

// `arguments` without the program's name. "--help" (or "-h") anywhere
// before "--" asks for the help; "--" ends the options of a command, so that
// a path may begin with "-".
ParsedCommandLine ParseCommandLine(const std::vector<std::string>& arguments);

// The short usage printed with a usage error, and the whole help.
std::string UsageText();
std::string HelpText();

} // namespace cli
