#include "tests/cli/vekcfg_fixture.h"

#include "tests/support/audio_fixtures.h"

namespace cli_testing
{

std::string VekcfgRun::WriteText(const std::string& name, const std::string& text) const
{
    const std::string path = Path(name);
    testing_support::WriteBytes(path, std::vector<std::uint8_t>(text.begin(), text.end()));
    return path;
}

std::string VekcfgRun::WriteMusic(const std::string& name, double seconds) const
{
    const std::string path = Path(name);
    testing_support::WriteBytes(path, testing_support::MakeWaveOfLength(seconds));
    return path;
}

config::CSaveConfig VekcfgRun::DefaultRecord()
{
    config::CSaveConfig record;
    record.ResetAll();
    return record;
}

std::string VekcfgRun::WriteSettings(const std::string& name,
                                     const config::CSaveConfig& record) const
{
    const std::string path = Path(name);
    EXPECT_TRUE(record.SaveToPath(path.c_str())) << path;
    return path;
}

} // namespace cli_testing
