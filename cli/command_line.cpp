#include "cli/command_line.h"

#include <cstddef>

namespace cli
{
namespace
{

ParsedCommandLine Refuse(std::string error)
{
    ParsedCommandLine parsed;
    parsed.error = std::move(error);
    return parsed;
}

bool IsOption(const std::string& argument)
{
    return argument.size() > 1 && argument[0] == '-';
}

// The options and operands of one command. Options may stand anywhere
// before "--".
struct Split
{
    std::vector<std::string> options;
    std::vector<std::string> operands;
    std::string svgPath;
    bool svgGiven = false;
    std::string error;
};

Split SplitArguments(const std::vector<std::string>& arguments, std::size_t first, bool takesSvg)
{
    Split split;
    bool optionsEnded = false;
    for (std::size_t i = first; i < arguments.size(); ++i)
    {
        const std::string& argument = arguments[i];
        if (optionsEnded || !IsOption(argument))
        {
            split.operands.push_back(argument);
            continue;
        }
        if (argument == "--")
        {
            optionsEnded = true;
            continue;
        }
        if (takesSvg && argument == "--svg")
        {
            if (split.svgGiven)
                split.error = "--svg is given twice";
            else if (i + 1 >= arguments.size() || arguments[i + 1].empty())
                split.error = "--svg needs the path of the picture to write";
            else
                split.svgPath = arguments[++i];
            split.svgGiven = true;
            continue;
        }
        split.options.push_back(argument);
    }
    return split;
}

} // namespace

ParsedCommandLine ParseCommandLine(const std::vector<std::string>& arguments)
{
    for (const std::string& argument : arguments)
    {
        if (argument == "--")
            break;
        if (argument == "--help" || argument == "-h")
        {
            ParsedCommandLine parsed;
            parsed.valid = true;
            parsed.invocation.command = Command::Help;
            return parsed;
        }
    }
    if (arguments.empty())
        return Refuse("no command given");

    const std::string& name = arguments[0];
    ParsedCommandLine parsed;
    Invocation& invocation = parsed.invocation;
    if (name == "--version")
    {
        if (arguments.size() != 1)
            return Refuse("--version takes no arguments");
        invocation.command = Command::Version;
        parsed.valid = true;
        return parsed;
    }

    const bool check = name == "check";
    const bool checkConfig = name == "check-config";
    const bool show = name == "show";
    if (!check && !checkConfig && !show)
        return Refuse("unknown command \"" + name + "\"");

    Split split = SplitArguments(arguments, 1, check);
    if (!split.error.empty())
        return Refuse(split.error);
    for (const std::string& option : split.options)
    {
        if (check && option == "--details" && !invocation.details)
            invocation.details = true;
        else if (show && option == "--json" && !invocation.json)
            invocation.json = true;
        else
            return Refuse("unknown or repeated option \"" + option + "\" for " + name);
    }

    if (check)
    {
        if (split.operands.size() != 2)
            return Refuse("check needs MUSIC and TENSION");
        invocation.command = Command::Check;
        invocation.svgPath = split.svgPath;
        invocation.musicPath = split.operands[0];
        invocation.tensionPath = split.operands[1];
    }
    else
    {
        if (split.operands.size() > 1)
            return Refuse(name + " takes at most one FILE");
        invocation.command = checkConfig ? Command::CheckConfig : Command::Show;
        if (!split.operands.empty())
            invocation.settingsPath = split.operands[0];
    }
    parsed.valid = true;
    return parsed;
}

std::string UsageText()
{
    return "usage: vekcfg check [--details] [--svg OUT.svg] MUSIC TENSION\n"
           "       vekcfg check-config [FILE]\n"
           "       vekcfg show [--json] [FILE]\n"
           "       vekcfg --help | --version\n";
}

std::string HelpText()
{
    return "vekcfg " + std::string(kVersion) +
           ": the command-line companion of VEK Config\n"
           "\n" +
           UsageText() +
           "\n"
           "check MUSIC TENSION\n"
           "    Checks a tension file against its music exactly as the BGM page's check\n"
           "    button does, and prints what the button would show.\n"
           "    --details      also prints the warnings the page does not show, the music's\n"
           "                   length, the segments in time order, each level's total time\n"
           "                   and segment count against its limits, and the finale\n"
           "    --svg OUT.svg  also draws the timeline into OUT.svg\n"
           "check-config [FILE]\n"
           "    Checks every music row of a settings file whose music is set, one line per\n"
           "    row: row, music, tension and result, separated by tabs.\n"
           "show [FILE]\n"
           "    Prints every setting by its name with its meaning; --json as JSON.\n"
           "\n"
           "FILE is a \"GameConfig.dat\". On Windows it defaults to the tool's own, found\n"
           "from TEMP as the tool finds it; elsewhere it must be given. It is only read.\n"
           "Paths inside it are used as stored (relative ones from the current folder).\n"
           "\n"
           "Exit status: 0 success (check-config: every checked row passes), 1 a check\n"
           "failed, 2 a usage error, an unreadable settings file, or a file that could\n"
           "not be written.\n";
}

} // namespace cli
