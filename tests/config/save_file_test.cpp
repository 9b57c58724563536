// "GameConfig.dat" on disk: where it lives, what a missing or bad file does,
// and that a failed save never costs the user the file they had.
#include "base/atomic_file.h"
#include "base/file_system.h"
#include "config/save_config.h"
#include "tests/support/temp_folder.h"

#include <cstring>
#include <filesystem>
#include <gtest/gtest.h>
#include <string>

using config::CSaveConfig;
using testing_support::ReadBytes;
using testing_support::ScopedEnvironment;
using testing_support::TempFolder;
using testing_support::TempSaveFolder;
using testing_support::WriteBytes;

namespace fs = std::filesystem;

namespace
{
std::string SaveDirectoryFor(const std::string& temp)
{
    ScopedEnvironment environment("TEMP", temp.c_str());
    char buffer[config::kSavePathCapacity];
    if (!config::BuildSaveDirectory(buffer, "VEK", sizeof buffer))
        return "(refused)";
    return buffer;
}
} // namespace

TEST(SaveDirectory, IsBuiltBesideTheLastFolderOfTemp)
{
    TempFolder root;
    const std::string sep(1, base::PathSeparator());
    const std::string base = root.Path().string() + sep;
    fs::create_directories(root.Path() / "Temp");

    EXPECT_EQ(SaveDirectoryFor(base + "Temp"), base + "Tolvenik" + sep + "VEK" + sep);
    EXPECT_TRUE(fs::is_directory(root.Path() / "Tolvenik" / "VEK"));
    EXPECT_EQ(SaveDirectoryFor(base + "Temp" + sep),
              base + "Temp" + sep + "Tolvenik" + sep + "VEK" + sep)
        << "a trailing separator keeps the whole value";
    EXPECT_EQ(SaveDirectoryFor(base + "ソTemp"), base + "Tolvenik" + sep + "VEK" + sep)
        << "the trail byte of ソ is not a backslash";
    EXPECT_EQ(SaveDirectoryFor("X"), "XTolvenik" + sep + "VEK" + sep)
        << "without a separator only the first character is kept";
}

TEST(SaveDirectory, RefusesATempThatDoesNotFitAndAMissingTemp)
{
    const std::string sep(1, base::PathSeparator());
    // kept + "Tolvenik" + sep + "VEK" + sep + "GameConfig.dat" + terminator.
    const std::size_t fixed = 8 + 1 + 3 + 1 + 14 + 1;
    const std::string fits = sep + std::string(config::kSavePathCapacity - fixed - 2, 'a') + sep;
    const std::string tooLong = fits + "b" + sep;
    EXPECT_EQ(SaveDirectoryFor(fits + "x").size(), config::kSavePathCapacity - 15);
    EXPECT_EQ(SaveDirectoryFor(tooLong + "x"), "(refused)");

    ScopedEnvironment unset("TEMP", nullptr);
    CSaveConfig record;
    EXPECT_FALSE(record.Load());
    EXPECT_FALSE(record.Save());
}

TEST(SaveFile, MissingFileIsCreatedWithEveryDefault)
{
    TempSaveFolder folder;
    CSaveConfig record;
    ASSERT_TRUE(record.Load());
    const std::vector<std::uint8_t> bytes = ReadBytes(folder.SettingsFile());
    ASSERT_EQ(bytes.size(), 6876u);
    CSaveConfig defaults;
    defaults.ResetAll();
    EXPECT_EQ(bytes, defaults.SaveToBytes());
    EXPECT_FALSE(fs::exists(base::TemporaryPathFor(folder.SettingsFile())));
}

TEST(SaveFile, FileShorterThanItsVersionWordIsReplacedByDefaults)
{
    for (std::size_t size : {0, 1, 3})
    {
        TempSaveFolder folder;
        fs::create_directories(folder.SaveDirectory());
        WriteBytes(folder.SettingsFile(), std::vector<std::uint8_t>(size, 0x10));
        CSaveConfig record;
        ASSERT_TRUE(record.Load()) << size;
        EXPECT_EQ(ReadBytes(folder.SettingsFile()).size(), 6876u) << size;
    }
}

TEST(SaveFile, BadFilesAreRefusedAndLeftAsTheyWere)
{
    TempSaveFolder folder;
    fs::create_directories(folder.SaveDirectory());

    std::vector<std::uint8_t> newer(6876, 0);
    const std::uint32_t version = 0x13001001;
    std::memcpy(newer.data(), &version, 4);
    CSaveConfig defaults;
    defaults.ResetNetwork();
    std::vector<std::uint8_t> lyingList = defaults.SaveToBytes();
    const std::uint32_t count = 3;
    std::memcpy(lyingList.data() + 76 + 460, &count, 4);
    lyingList.resize(548 + 40);

    for (const auto& bytes : {newer, lyingList})
    {
        WriteBytes(folder.SettingsFile(), bytes);
        CSaveConfig record;
        EXPECT_FALSE(record.Load());
        EXPECT_EQ(ReadBytes(folder.SettingsFile()), bytes);
    }
}

TEST(SaveFile, AFolderInPlaceOfTheFileIsRefusedAndKept)
{
    TempSaveFolder folder;
    fs::create_directories(fs::path(folder.SettingsFile()) / "inside");
    CSaveConfig record;
    EXPECT_FALSE(record.Load());
    EXPECT_TRUE(fs::is_directory(fs::path(folder.SettingsFile()) / "inside"));
}

TEST(SaveFile, FailedSaveLeavesThePreviousFileByteForByte)
{
    TempSaveFolder folder;
    CSaveConfig record;
    ASSERT_TRUE(record.Load());
    const std::vector<std::uint8_t> before = ReadBytes(folder.SettingsFile());

    // The temporary file cannot be created: a folder stands at its name.
    fs::create_directories(base::TemporaryPathFor(folder.SettingsFile()));
    record.Graphics()->screenSize = 5;
    EXPECT_FALSE(record.Save());
    EXPECT_EQ(ReadBytes(folder.SettingsFile()), before);

    fs::remove(base::TemporaryPathFor(folder.SettingsFile()));
    ASSERT_TRUE(record.Save());
    EXPECT_EQ(ReadBytes(folder.SettingsFile())[8], 5);
}

TEST(SaveFile, SaveIntoAnUnusableDirectoryFails)
{
    TempSaveFolder folder;
    // A file where the save directory's parent should be.
    WriteBytes((folder.Root().Path() / "Tolvenik").string(), {1, 2, 3});
    CSaveConfig record;
    record.ResetGraphics();
    EXPECT_FALSE(record.Save());
    EXPECT_EQ(ReadBytes((folder.Root().Path() / "Tolvenik").string()),
              (std::vector<std::uint8_t>{1, 2, 3}));
}

// Windows refuses paths of MAX_PATH (260) bytes and more to a program that
// does not opt in to long paths; the file is written beside itself first,
// under a name of the same length, so 259 bytes work there and 260 and 300
// do not. POSIX takes them all. Either way the file is created whole with the
// defaults, or start-up is refused with no settings file written, never one
// under a cut path. (Wine creates the temporary file at any length but will
// neither rename nor delete it beyond MAX_PATH, so one may be left there.)
TEST(SaveFile, SettingsPathsOf259260And300BytesAreUsedWholeOrRefused)
{
    const std::string sep(1, base::PathSeparator());
    const std::size_t fixed = 8 + 1 + 3 + 1 + 14; // "Tolvenik", "VEK", "GameConfig.dat"
    for (const std::size_t length : {259u, 260u, 300u})
    {
        TempFolder root;
        const std::string kept = testing_support::PathOfLength(root, length - fixed - 1, "");
        ASSERT_FALSE(kept.empty()) << length;
        std::error_code ignored;
        fs::create_directory(kept, ignored);
        const std::string file = kept + sep + "Tolvenik" + sep + "VEK" + sep + "GameConfig.dat";
        ASSERT_EQ(file.size(), length);
        ScopedEnvironment temp("TEMP", (kept + sep + "Temp").c_str());

        CSaveConfig record;
        const bool loaded = record.Load();
        EXPECT_EQ(loaded, fs::exists(file)) << length;
        if (length == 259)
        {
            EXPECT_TRUE(loaded) << "the longest path a program without long paths may use";
        }
        if (!loaded)
            continue;
        EXPECT_EQ(ReadBytes(file).size(), 6876u) << length;
        record.Graphics()->screenSize = 4;
        ASSERT_TRUE(record.Save()) << length;
        EXPECT_EQ(ReadBytes(file)[8], 4) << length;
    }
}
