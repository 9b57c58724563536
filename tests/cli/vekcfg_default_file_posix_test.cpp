// Linux has no settings file of the tool's own: FILE must be given.
#include "tests/cli/vekcfg_fixture.h"

namespace cli_testing
{
namespace
{

using DefaultFileTest = VekcfgRun;

TEST_F(DefaultFileTest, WithoutFileBothCommandsAreUsageErrors)
{
    for (const char* command : {"show", "check-config"})
    {
        const ProgramRun run = Run({command});
        EXPECT_EQ(run.exitCode, 2) << command;
        EXPECT_EQ(run.err.rfind("vekcfg: FILE is required on this platform\nusage: ", 0), 0u)
            << run.err;
    }
}

} // namespace
} // namespace cli_testing
