// "GameConfig.dat" on disk: where it lives, what a missing or bad file does,
// and that a failed save never costs the user the file they had.
#include "base/atomic_file.h"
#include "base/file_system.h"
#include "config/save_config.h"
#include "tests/support/temp_folder.h"

#include <filesystem>
#include <gtest/gtest.h>
#include <string>

using config::CSaveConfig;
using namespace testing_support;
using Bytes = std::vector<std::uint8_t>;

namespace fs = std::filesystem;

// Windows refuses paths of MAX_PATH (260) bytes and more to a program that
// does not opt in to long paths; the file is written beside itself first,
// under a name of the same length, so a settings path of 259 bytes works.
TEST(SaveDirectory, IsBuiltBesideTheLastFolderOfTempOrRefused)
{
    TempFolder root;
    const std::string sep(1, base::PathSeparator());
    const std::string base = root.Path().string() + sep;
    const std::string made = "Tolvenik" + sep + "VEK" + sep;
    // Room for the kept part, the two folders and "GameConfig.dat" with its terminator.
    const std::string fits = sep + std::string(config::kSavePathCapacity - 30, 'a') + sep;
    const std::pair<std::string, std::string> cases[] = {
        {base + "Temp", base + made},
        {base + "Temp" + sep, base + "Temp" + sep + made},
        {base + "ソTemp", base + made}, // the trail byte of ソ is not a backslash
        {"X", "X" + made},              // without a separator the first character stays
        {fits + "x", fits + made},
        {fits + "b" + sep + "x", "(refused)"},
    };
    for (const auto& [temp, directory] : cases)
    {
        ScopedEnvironment environment("TEMP", temp.c_str());
        char buffer[config::kSavePathCapacity];
        const bool built = config::BuildSaveDirectory(buffer, "VEK", sizeof buffer);
        EXPECT_EQ(built ? std::string(buffer) : "(refused)", directory) << temp;
    }
    EXPECT_TRUE(fs::is_directory(root.Path() / "Tolvenik" / "VEK"));

    // 27: the parts made below the kept folder.
    const std::string kept = base + std::string(259 - 27 - 1 - base.size(), 'f');
    ASSERT_TRUE(fs::create_directory(kept));
    CSaveConfig record;
    {
        ScopedEnvironment temp("TEMP", (kept + sep + "Temp").c_str());
        ASSERT_TRUE(record.Load());
        EXPECT_EQ(ReadBytes(kept + sep + made + "GameConfig.dat").size(), 6876u);
    }
    ScopedEnvironment unset("TEMP", nullptr);
    EXPECT_FALSE(record.Load());
    EXPECT_FALSE(record.Save());
}

TEST(SaveFile, AMissingFileIsWrittenAndABadFileOrAFailedSaveLeavesThePreviousOne)
{
    TempSaveFolder folder;
    const std::string file = folder.SettingsFile(), temporary = base::TemporaryPathFor(file);
    CSaveConfig record;
    ASSERT_TRUE(record.Load());
    const Bytes defaults = ReadBytes(file);
    EXPECT_EQ(defaults.size(), 6876u);
    EXPECT_FALSE(fs::exists(temporary));
    WriteBytes(file, {0x00, 0x10, 0x00});
    ASSERT_TRUE(record.Load());
    EXPECT_EQ(ReadBytes(file), defaults);
    // The temporary file cannot be created: a folder stands at its name.
    fs::create_directories(temporary);
    record.Graphics()->screenSize = 5;
    EXPECT_FALSE(record.Save());
    EXPECT_EQ(ReadBytes(file), defaults);
    fs::remove(temporary);
    ASSERT_TRUE(record.Save());
    EXPECT_EQ(ReadBytes(file)[8], 5);

    const Bytes newer = {0x01, 0x10, 0x00, 0x13}; // version 0x13001001
    WriteBytes(file, newer);
    EXPECT_FALSE(record.Load());
    EXPECT_EQ(ReadBytes(file), newer);
    fs::remove(file);
    fs::create_directories(fs::path(file) / "inside");
    EXPECT_FALSE(record.Load());
    EXPECT_TRUE(fs::is_directory(fs::path(file) / "inside"));
}
