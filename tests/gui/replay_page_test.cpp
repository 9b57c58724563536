// The Replay page: saving replays and the thirty locks, each box bound to its
// own field, and the rows at their places.
#include "resources/resource.h"
#include "tests/gui/gui_harness.h"
#include "tests/gui/page_checks.h"

#include <gtest/gtest.h>
#include <string>

using gui::RunningTool;

namespace
{
int LockBox(int replay)
{
    return IDC_SAVE_REPLAYS + replay;
}

// The record's replay section as the file holds it.
std::vector<std::uint8_t> ReplayBytes(config::CSaveConfig& record)
{
    const auto* bytes = reinterpret_cast<const std::uint8_t*>(record.Replay());
    return {bytes, bytes + sizeof(config::ConfigReplay)};
}
} // namespace

TEST(ReplayPage, ShowsTheRecordsValues)
{
    RunningTool tool(gui::SettingsWith(
        [](config::CSaveConfig& record)
        {
            record.Replay()->saveReplays = 0;
            for (int index : {0, 14, 15, 29})
                record.Replay()->replayLock[index] = 1;
        }));
    const HWND page = tool.Page(kReplayPageIndex);
    EXPECT_FALSE(gui::IsChecked(page, IDC_SAVE_REPLAYS));
    for (int replay = 1; replay <= config::kReplayCount; ++replay)
    {
        const bool locked = replay == 1 || replay == 15 || replay == 16 || replay == 30;
        EXPECT_EQ(gui::IsChecked(page, LockBox(replay)), locked) << replay;
    }
}

TEST(ReplayPage, EveryBoxReachesItsOwnFieldAlone)
{
    RunningTool tool;
    const HWND page = tool.Page(kReplayPageIndex);
    // Locks change whether or not replays are saved.
    tool.SetCheck(page, IDC_SAVE_REPLAYS, false);
    EXPECT_EQ(tool.Record().Replay()->saveReplays, 0u);
    const std::vector<std::uint8_t> cleared = ReplayBytes(tool.Record());

    for (int replay = 1; replay <= config::kReplayCount; ++replay)
    {
        tool.SetCheck(page, LockBox(replay), true);
        config::ConfigReplay expected = {};
        expected.replayLock[replay - 1] = 1;
        EXPECT_EQ(ReplayBytes(tool.Record()),
                  std::vector<std::uint8_t>(reinterpret_cast<std::uint8_t*>(&expected),
                                            reinterpret_cast<std::uint8_t*>(&expected + 1)))
            << replay;
        tool.SetCheck(page, LockBox(replay), false);
        EXPECT_EQ(ReplayBytes(tool.Record()), cleared) << replay;
    }
    tool.SetCheck(page, IDC_SAVE_REPLAYS, true);
    EXPECT_EQ(tool.Record().Replay()->saveReplays, 1u);
}

TEST(ReplayPage, SavingWritesWhatTheBoxesSet)
{
    RunningTool tool;
    const HWND page = tool.Page(kReplayPageIndex);
    tool.SetCheck(page, IDC_SAVE_REPLAYS, false);
    tool.SetCheck(page, LockBox(2), true);
    tool.SetCheck(page, LockBox(30), true);
    tool.Save();

    const std::vector<std::uint8_t> file = gui::ReadFile(tool.SettingsFile());
    EXPECT_EQ(gui::LittleEndianAt(file, gui::kReplayInFile - 4), 124) << "the section's length";
    std::vector<std::uint8_t> expected(124, 0);
    expected[4 + 4 * 1] = 1;
    expected[4 + 4 * 29] = 1;
    EXPECT_EQ(std::vector<std::uint8_t>(file.begin() + gui::kReplayInFile,
                                        file.begin() + gui::kReplayInFile + 124),
              expected);
}
