// A write that fails part-way (here: past the process's file-size limit, as a
// full disk would) must leave the old file whole.
#include "base/atomic_file.h"
#include "tests/support/temp_folder.h"

#include <csignal>
#include <filesystem>
#include <gtest/gtest.h>
#include <sys/resource.h>

using testing_support::ReadBytes;
using testing_support::TempFolder;
using testing_support::WriteBytes;

TEST(AtomicFilePosix, WriteFailingPartWayKeepsTheOldFile)
{
    TempFolder folder;
    const std::string path = folder.File("GameConfig.dat");
    const std::vector<std::uint8_t> old(6876, 0x11);
    WriteBytes(path, old);

    const std::vector<std::uint8_t> image(100000, 0x22);
    std::signal(SIGXFSZ, SIG_IGN);
    rlimit previous{};
    getrlimit(RLIMIT_FSIZE, &previous);
    rlimit limited = previous;
    limited.rlim_cur = 8192;
    ASSERT_EQ(setrlimit(RLIMIT_FSIZE, &limited), 0);
    const bool written = base::WriteFileAtomically(path.c_str(), image.data(), image.size());
    setrlimit(RLIMIT_FSIZE, &previous);

    EXPECT_FALSE(written);
    EXPECT_EQ(ReadBytes(path), old);
    EXPECT_FALSE(std::filesystem::exists(base::TemporaryPathFor(path)));
}
