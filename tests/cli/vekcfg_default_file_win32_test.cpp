// On Windows FILE defaults to the tool's own "GameConfig.dat", found from
// TEMP as the tool finds it (the run inherits the test's TEMP).
#include "tests/cli/vekcfg_fixture.h"

#include <filesystem>

namespace cli_testing
{
namespace
{

using DefaultFileTest = VekcfgRun;

TEST_F(DefaultFileTest, WithoutFileTheToolsOwnFileIsUsed)
{
    testing_support::TempSaveFolder save;
    std::filesystem::create_directories(save.SaveDirectory());
    config::CSaveConfig record = DefaultRecord();
    record.Network()->port = 12345;
    ASSERT_TRUE(record.SaveToPath(save.SettingsFile().c_str()));

    const ProgramRun shown = Run({"show"});
    EXPECT_EQ(shown.exitCode, 0) << shown.err;
    EXPECT_NE(shown.out.find("file = \"" + save.SettingsFile() + "\"\n"), std::string::npos)
        << shown.out;
    EXPECT_NE(shown.out.find("network.port = 12345\n"), std::string::npos);
    const ProgramRun checked = Run({"check-config"});
    EXPECT_EQ(checked.exitCode, 0) << checked.err;
}

TEST_F(DefaultFileTest, AMissingOwnFileIsNotMadeButReported)
{
    testing_support::TempSaveFolder save;
    const ProgramRun run = Run({"show"});
    EXPECT_EQ(run.exitCode, 2);
    EXPECT_EQ(run.err, "vekcfg: cannot read the settings file \"" + save.SettingsFile() +
                           "\": No such file or directory\n");
    EXPECT_FALSE(std::filesystem::exists(save.SettingsFile()));
}

} // namespace
} // namespace cli_testing
