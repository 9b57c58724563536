#include "base/atomic_file.h"
#include "tests/support/temp_folder.h"

#include <filesystem>
#include <gtest/gtest.h>

namespace fs = std::filesystem;

// The temporary file's name is never longer than the file's, so a path short
// enough for the system has a temporary one that is too.
TEST(AtomicFile, ReplacesTheFileOrLeavesWhatStandsThereAndNoTemporary)
{
    EXPECT_EQ(base::TemporaryPathFor("GameConfig.dat"), "GameConfig.new");
    EXPECT_EQ(base::TemporaryPathFor("a.b/GameConfig"), "a.b/GameConfig.new");
    EXPECT_EQ(base::TemporaryPathFor("notes.new"), "notes.tmp");

    testing_support::TempFolder folder;
    const std::string file = folder.File("data.bin"), inTheWay = folder.File("folder.bin");
    testing_support::WriteBytes(file, {9, 9, 9, 9, 9});
    fs::create_directories(inTheWay);
    const std::uint8_t data[] = {1, 2, 3};
    ASSERT_TRUE(base::WriteFileAtomically(file.c_str(), data, sizeof data));
    EXPECT_EQ(testing_support::ReadBytes(file), std::vector<std::uint8_t>(data, data + 3));
    EXPECT_FALSE(base::WriteFileAtomically(inTheWay.c_str(), data, sizeof data));
    EXPECT_TRUE(fs::is_directory(inTheWay));
    EXPECT_FALSE(fs::exists(base::TemporaryPathFor(file)));
    EXPECT_FALSE(fs::exists(base::TemporaryPathFor(inTheWay)));
}
