// How vekcfg reads its arguments; the refusals are run black-box.
#include "cli/command_line.h"

#include <gtest/gtest.h>

namespace
{

using cli::Command;

TEST(CommandLine, OptionsMayStandAnywhereBeforeTheDoubleDash)
{
    struct Case
    {
        std::vector<std::string> arguments;
        Command command;
        bool details;
        std::string svg, music, tension, settings;
        bool json;
    };
    const Case cases[] = {
        {{"check", "m", "t"}, Command::Check, false, "", "m", "t", "", false},
        {{"check", "--details", "--svg", "o.svg", "m", "t"},
         Command::Check,
         true,
         "o.svg",
         "m",
         "t",
         "",
         false},
        {{"check", "m", "--svg", "o.svg", "t", "--details"},
         Command::Check,
         true,
         "o.svg",
         "m",
         "t",
         "",
         false},
        {{"check", "--", "--details", "-t"},
         Command::Check,
         false,
         "",
         "--details",
         "-t",
         "",
         false},
        {{"check", "-", "t"}, Command::Check, false, "", "-", "t", "", false},
        {{"check-config"}, Command::CheckConfig, false, "", "", "", "", false},
        {{"check-config", "f.dat"}, Command::CheckConfig, false, "", "", "", "f.dat", false},
        {{"show", "f.dat", "--json"}, Command::Show, false, "", "", "", "f.dat", true},
        {{"show", "--", "--json"}, Command::Show, false, "", "", "", "--json", false},
        {{"--version"}, Command::Version, false, "", "", "", "", false},
        {{"show", "--help", "extra", "words"}, Command::Help, false, "", "", "", "", false},
    };
    for (const Case& c : cases)
    {
        const cli::ParsedCommandLine parsed = cli::ParseCommandLine(c.arguments);
        ASSERT_TRUE(parsed.valid) << c.arguments[0] << ": " << parsed.error;
        const cli::Invocation& got = parsed.invocation;
        EXPECT_EQ(got.command, c.command) << c.arguments.size();
        EXPECT_EQ(got.details, c.details);
        EXPECT_EQ(got.svgPath, c.svg);
        EXPECT_EQ(got.musicPath, c.music);
        EXPECT_EQ(got.tensionPath, c.tension);
        EXPECT_EQ(got.settingsPath, c.settings);
        EXPECT_EQ(got.json, c.json);
    }
}

TEST(CommandLine, AHelpAfterTheDoubleDashIsAnOperand)
{
    const cli::ParsedCommandLine parsed = cli::ParseCommandLine({"check", "--", "--help", "t"});
    ASSERT_TRUE(parsed.valid);
    EXPECT_EQ(parsed.invocation.command, Command::Check);
    EXPECT_EQ(parsed.invocation.musicPath, "--help");
}

} // namespace
