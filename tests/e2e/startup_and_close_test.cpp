// VEKConfig.exe started as a user starts it: its first file, a file it must
// refuse, saving, a save that fails, and every way of closing.
#include "config/save_config.h"
#include "tests/e2e/tool_driver.h"
#include "tests/support/temp_folder.h"

#include <gtest/gtest.h>

using testing_support::ReadBytes;

namespace
{
const std::string kCloseQuestion = "コンフィグツールを閉じますか？";

std::vector<std::uint8_t> Defaults()
{
    config::CSaveConfig record;
    record.ResetAll();
    return record.SaveToBytes();
}
} // namespace

// Saving and closing each ask their own question; a failed save keeps the
// old file and the dialog, so saving can be tried again.
TEST(Tool, WritesANewFileAndSavesItOrKeepsTheOldOneAndClosesEachWay)
{
    testing_support::TempSaveFolder folder;
    e2e::ToolProcess tool;
    const HWND dialog = tool.MainDialog();
    ASSERT_NE(dialog, nullptr);
    EXPECT_EQ(ReadBytes(folder.SettingsFile()), Defaults());

    testing_support::WriteBytes(folder.SettingsFile(), {'o', 'l', 'd'});
    // The game holding the file open without sharing stops it being replaced.
    const HANDLE held = CreateFileA(folder.SettingsFile().c_str(), GENERIC_READ, FILE_SHARE_READ,
                                    nullptr, OPEN_EXISTING, 0, nullptr);
    e2e::PostCommand(dialog, IDOK);
    const e2e::MessageBoxSeen failure = tool.AnswerMessageBox(IDOK);
    CloseHandle(held);
    EXPECT_EQ(failure.caption + ": " + failure.text, "エラー: 保存に失敗しました");
    EXPECT_EQ(ReadBytes(folder.SettingsFile()), (std::vector<std::uint8_t>{'o', 'l', 'd'}));

    std::filesystem::remove(folder.SettingsFile());
    e2e::PostCommand(dialog, IDOK);
    const e2e::MessageBoxSeen saved = tool.AnswerMessageBox(IDNO);
    EXPECT_EQ(saved.caption + ": " + saved.text, "終了確認: 保存されました\n" + kCloseQuestion);
    EXPECT_EQ(ReadBytes(folder.SettingsFile()), Defaults());
    e2e::PostCommand(dialog, IDCANCEL);
    EXPECT_EQ(tool.AnswerMessageBox(IDNO).text,
              "保存されていないデータは失われます\n" + kCloseQuestion);
    EXPECT_EQ(tool.ExitCode(0), STILL_ACTIVE) << "No keeps the dialog open";

    PostMessageA(dialog, WM_SYSCOMMAND, SC_CLOSE, 0);
    EXPECT_EQ(tool.AnswerMessageBox(IDYES).text, kCloseQuestion);
    EXPECT_EQ(tool.ExitCode(), 0u);
}

TEST(Tool, RefusesANewerFileWithItsMessageAndExitCodeMinusOne)
{
    testing_support::TempSaveFolder folder;
    std::vector<std::uint8_t> newer = Defaults();
    ++newer[0]; // the version word, one above the tool's own
    folder.WriteSettings(newer);

    e2e::ToolProcess tool;
    const e2e::MessageBoxSeen refusal = tool.AnswerMessageBox(IDOK);
    EXPECT_EQ(refusal.caption, "");
    EXPECT_EQ(refusal.text, "コンフィグファイルが読み込めません");
    EXPECT_EQ(tool.ExitCode(), 0xFFFFFFFFu);
    EXPECT_EQ(ReadBytes(folder.SettingsFile()), newer) << "the refused file is kept";
}
