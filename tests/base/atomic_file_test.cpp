#include "base/atomic_file.h"
#include "tests/support/temp_folder.h"

#include <filesystem>
#include <gtest/gtest.h>

using testing_support::ReadBytes;
using testing_support::TempFolder;
using testing_support::WriteBytes;

TEST(AtomicFile, ReplacesAnExistingFileAndLeavesNoTemporary)
{
    TempFolder folder;
    const std::string path = folder.File("data.bin");
    WriteBytes(path, {9, 9, 9, 9, 9});
    const std::uint8_t data[] = {1, 2, 3};
    ASSERT_TRUE(base::WriteFileAtomically(path.c_str(), data, sizeof data));
    EXPECT_EQ(ReadBytes(path), (std::vector<std::uint8_t>{1, 2, 3}));
    EXPECT_FALSE(std::filesystem::exists(base::TemporaryPathFor(path)));
}

TEST(AtomicFile, TheTemporaryNameIsNeverLongerThanTheFile)
{
    const struct
    {
        const char* path;
        const char* temporary;
    } cases[] = {
        {"GameConfig.dat", "GameConfig.new"},
        {"a.b/GameConfig", "a.b/GameConfig.new"},
        {"notes.new", "notes.tmp"},
    };
    for (const auto& c : cases)
        EXPECT_EQ(base::TemporaryPathFor(c.path), c.temporary) << c.path;
}

TEST(AtomicFile, AFolderInTheWayFailsWithoutTouchingIt)
{
    TempFolder folder;
    const std::string path = folder.File("data.bin");
    std::filesystem::create_directories(path);
    const std::uint8_t data[] = {1};
    EXPECT_FALSE(base::WriteFileAtomically(path.c_str(), data, sizeof data));
    EXPECT_TRUE(std::filesystem::is_directory(path));
    EXPECT_FALSE(std::filesystem::exists(base::TemporaryPathFor(path)));
}
