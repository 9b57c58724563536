// A write that fails part-way (here: past the process's file-size limit, as a
// full disk would) must leave the old file whole.
#include "base/atomic_file.h"
#include "tests/support/temp_folder.h"

#include <csignal>
#include <filesystem>
#include <gtest/gtest.h>
#include <sys/resource.h>

TEST(AtomicFilePosix, WriteFailingPartWayKeepsTheOldFile)
{
    testing_support::TempFolder folder;
    const std::string path = folder.File("GameConfig.dat");
    const std::vector<std::uint8_t> old(6876, 0x11), image(100000, 0x22);
    testing_support::WriteBytes(path, old);
    std::signal(SIGXFSZ, SIG_IGN);
    rlimit previous{};
    getrlimit(RLIMIT_FSIZE, &previous);
    const rlimit limited{8192, previous.rlim_max};
    ASSERT_EQ(setrlimit(RLIMIT_FSIZE, &limited), 0);
    const bool written = base::WriteFileAtomically(path.c_str(), image.data(), image.size());
    setrlimit(RLIMIT_FSIZE, &previous);
    EXPECT_FALSE(written);
    EXPECT_EQ(testing_support::ReadBytes(path), old);
    EXPECT_FALSE(std::filesystem::exists(base::TemporaryPathFor(path)));
}
