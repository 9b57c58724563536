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
    std::string jobs;
    bool jobsGiven = false;
    std::string error;
};

// How many rows check-config checks at once: a whole number from 1 up.
bool ReadJobs(const std::string& text, int* jobs)
{
    if (text.empty() || text.size() > 4 ||
        text.find_first_not_of("0123456789") != std::string::npos)
        return false;
    *jobs = std::stoi(text);
    return *jobs >= 1;
}

Split SplitArguments(const std::vector<std::string>& arguments, std::size_t first, bool takesSvg,
                     bool takesJobs)
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
        if (takesJobs && argument.rfind("-j", 0) == 0)
        {
            if (split.jobsGiven)
                split.error = "-j is given twice";
            else if (argument.size() > 2)
                split.jobs = argument.substr(2);
            else if (i + 1 < arguments.size())
                split.jobs = arguments[++i];
            split.jobsGiven = true;
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
    const bool set = name == "set";
    const bool apply = name == "apply";
    const bool draft = name == "draft";
    if (!check && !checkConfig && !show && !set && !apply && !draft)
        return Refuse("unknown command \"" + name + "\"");

    Split split = SplitArguments(arguments, 1, check, checkConfig);
    if (!split.error.empty())
        return Refuse(split.error);
    if (split.jobsGiven && !ReadJobs(split.jobs, &invocation.jobs))
        return Refuse("-j needs the number of rows to check at once, 1 or more");
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
    else if (set)
    {
        // FILE is the first operand that assigns nothing.
        std::vector<std::string>& operands = split.operands;
        std::size_t next = 0;
        if (!operands.empty() && operands[0].find('=') == std::string::npos)
            invocation.settingsPath = operands[next++];
        if (next == operands.size())
            return Refuse("set needs at least one NAME=VALUE");
        for (; next < operands.size(); ++next)
        {
            if (operands[next].find('=') == std::string::npos)
                return Refuse("set takes NAME=VALUE, NAME+=VALUE or NAME-=VALUE, not \"" +
                              operands[next] + "\"");
            invocation.assignments.push_back(operands[next]);
        }
        invocation.command = Command::Set;
    }
    else if (apply || draft)
    {
        if (split.operands.empty() || split.operands.size() > 2)
            return Refuse(apply ? "apply needs [FILE] SETTINGS.json" : "draft needs MUSIC [OUT]");
        if (apply)
        {
            invocation.command = Command::Apply;
            invocation.jsonPath = split.operands.back();
            if (split.operands.size() == 2)
                invocation.settingsPath = split.operands[0];
        }
        else
        {
            invocation.command = Command::Draft;
            invocation.musicPath = split.operands[0];
            if (split.operands.size() == 2)
                invocation.outputPath = split.operands[1];
        }
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
           "       vekcfg check-config [-j N] [FILE]\n"
           "       vekcfg show [--json] [FILE]\n"
           "       vekcfg set [FILE] NAME=VALUE...\n"
           "       vekcfg apply [FILE] SETTINGS.json\n"
           "       vekcfg draft MUSIC [OUT]\n"
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
           "                   and segment count against its limits, how well the levels\n"
           "                   follow the music's loudness, and the finale\n"
           "    --svg OUT.svg  also draws the timeline over the music's loudness into OUT.svg\n"
           "check-config [-j N] [FILE]\n"
           "    Checks every music row of a settings file whose music is set, one line per\n"
           "    row in row order: row, music, tension and result, separated by tabs.\n"
           "    -j N           checks N rows at once (default: one per core)\n"
           "show [FILE]\n"
           "    Prints every setting by its name with its meaning; --json as JSON in\n"
           "    ASCII, every other character as a \\u escape.\n"
           "set [FILE] NAME=VALUE...\n"
           "    Sets each named setting and saves the file. NAME is as show prints it; VALUE\n"
           "    is a number or the meaning show prints for it (1280x960, UP, BUTTON3, on).\n"
           "    NAME+=ADDRESS and NAME-=ADDRESS add to and remove from network.connectList,\n"
           "    network.allowList and network.denyList.\n"
           "apply [FILE] SETTINGS.json\n"
           "    Sets every setting of a tree that show --json printed, whole or in part;\n"
           "    - reads it from standard input. The tree is UTF-8 JSON of at most 64 MiB,\n"
           "    nested no deeper than show nests it, with no member named twice.\n"
           "draft MUSIC [OUT]\n"
           "    Writes a tension file for MUSIC whose levels follow its loudness and that\n"
           "    the check accepts, to OUT or to standard output.\n"
           "\n"
           "FILE is a \"GameConfig.dat\". On Windows it defaults to the tool's own, found\n"
           "from TEMP as the tool finds it; elsewhere it must be given. It must be a\n"
           "settings file exactly as the tool writes one (its version, its section\n"
           "lengths and the size they make); anything else is refused and never written.\n"
           "Only set and apply write it: every value is checked first, and nothing is\n"
           "written when one is refused. Only what the pages can change is changed. Paths\n"
           "inside it are used as stored (relative ones from the current folder).\n"
           "\n"
           "Exit status: 0 done (check-config: every checked row passes); 1 a check\n"
           "failed, or music draft cannot use; 2 refused or not written: a usage error, a\n"
           "refused value or file, a save that failed (the file is left as it was), or\n"
           "output that could not be written.\n";
}

} // namespace cli
