#include "base/atomic_file.h"
#include "tests/support/temp_folder.h"

#include <csignal>
#include <filesystem>
#include <gtest/gtest.h>
#ifndef _WIN32
#include <sys/resource.h>
#endif

using namespace testing_support;
namespace fs = std::filesystem;

// The temporary file's name is never longer than the file's, so a path short
// enough for the system has a temporary one that is too.
TEST(AtomicFile, ReplacesTheFileOrLeavesWhatStandsThereAndNoTemporary)
{
    EXPECT_EQ(base::TemporaryPathFor("GameConfig.dat"), "GameConfig.new");
    EXPECT_EQ(base::TemporaryPathFor("a.b/GameConfig"), "a.b/GameConfig.new");
    EXPECT_EQ(base::TemporaryPathFor("notes.new"), "notes.tmp");
    TempFolder folder;
    const std::string file = folder.File("data.bin"), inTheWay = folder.File("folder.bin");
    WriteBytes(file, {9, 9, 9, 9, 9});
    fs::create_directories(inTheWay);
    const std::vector<std::uint8_t> data = {1, 2, 3}, image(100000, 0x22);
    ASSERT_TRUE(base::WriteFileAtomically(file.c_str(), data.data(), data.size()));
    EXPECT_FALSE(base::WriteFileAtomically(inTheWay.c_str(), data.data(), data.size()));
    EXPECT_TRUE(fs::is_directory(inTheWay));
    EXPECT_FALSE(fs::exists(base::TemporaryPathFor(inTheWay)));
#ifndef _WIN32
    // A write failing part-way, past the file-size limit as on a full disk.
    std::signal(SIGXFSZ, SIG_IGN);
    rlimit previous{};
    getrlimit(RLIMIT_FSIZE, &previous);
    const rlimit limited{8192, previous.rlim_max};
    ASSERT_EQ(setrlimit(RLIMIT_FSIZE, &limited), 0);
    const bool written = base::WriteFileAtomically(file.c_str(), image.data(), image.size());
    setrlimit(RLIMIT_FSIZE, &previous);
    EXPECT_FALSE(written);
#endif
    EXPECT_EQ(ReadBytes(file), data);
    EXPECT_FALSE(fs::exists(base::TemporaryPathFor(file)));
    // A new file is written only where nothing stands.
    const std::string fresh = folder.File("fresh.bin");
    EXPECT_FALSE(base::WriteNewFileAtomically(file.c_str(), image.data(), image.size()));
    EXPECT_TRUE(base::WriteNewFileAtomically(fresh.c_str(), data.data(), data.size()));
    EXPECT_EQ(ReadBytes(file), data);
    EXPECT_EQ(ReadBytes(fresh), data);
    EXPECT_FALSE(fs::exists(base::TemporaryPathFor(file)));
}
