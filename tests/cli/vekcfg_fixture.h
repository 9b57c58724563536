#pragma once

// A folder of the test's own with music, tension and settings files made by
// the test, and vekcfg run inside it.

#include "config/save_config.h"
#include "tests/cli/vekcfg_runner.h"
#include "tests/support/temp_folder.h"

#include <gtest/gtest.h>
#include <string>
#include <vector>

namespace cli_testing
{

// The worked example: 180 s of music, Normal 30, Low 105, Hi 30 of at most
// 36, Climax 15 of at most 18, the finale at 170.
inline constexpr char kWorkedExample[] = "FILENAME:Test;\nLOW:30;\nHI:60;\nLOW:90;\nCLIMAX:165;\n"
                                         "FINALE:170;\n";
// The same with the climax from 150: 30 s of Climax fail.
inline constexpr char kClimaxTooLong[] = "FILENAME:Test;\nLOW:30;\nHI:60;\nLOW:90;\nCLIMAX:150;\n"
                                         "FINALE:170;\n";

class VekcfgRun : public ::testing::Test
{
protected:
    std::string Folder() const { return folder_.Path().string(); }
    std::string Path(const std::string& name) const { return folder_.File(name); }

    // Writes `text` (code page 932 bytes) and returns the file's full path.
    std::string WriteText(const std::string& name, const std::string& text) const;
    // A wave of `seconds`; returns its full path.
    std::string WriteMusic(const std::string& name, double seconds) const;
    // A record with every default; the test changes it and saves it.
    static config::CSaveConfig DefaultRecord();
    std::string WriteSettings(const std::string& name, const config::CSaveConfig& record) const;

    ProgramRun Run(const std::vector<std::string>& arguments) const
    {
        return RunVekcfg(arguments, Folder());
    }

private:
    testing_support::TempFolder folder_;
};

} // namespace cli_testing
