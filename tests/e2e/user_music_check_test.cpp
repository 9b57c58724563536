// A music row checked as a user checks it: VEKConfig.exe started on its own,
// the two paths of row 0 typed in, チェック pressed and the message box read,
// then the row saved.
#include "config/save_config.h"
#include "resources/resource.h"
#include "tests/e2e/tool_driver.h"
#include "tests/support/audio_fixtures.h"

#include <cstring>
#include <gtest/gtest.h>
#include <string>

using e2e::SaveFolder;
using e2e::ToolProcess;

namespace
{

bool WriteText(const std::string& path, const std::string& text)
{
    return e2e::WriteFileBytes(path, std::vector<std::uint8_t>(text.begin(), text.end()));
}

// Types both paths into row 0 of the page, presses its チェック and answers
// the box the check shows.
e2e::MessageBoxSeen CheckRow0(ToolProcess& tool, HWND page, const std::string& music,
                              const std::string& tensionFile, HWND* owner)
{
    SendMessageA(GetDlgItem(page, IDC_MUSIC_PATH_FIRST), WM_SETTEXT, 0,
                 reinterpret_cast<LPARAM>(music.c_str()));
    SendMessageA(GetDlgItem(page, IDC_TENSION_PATH_FIRST), WM_SETTEXT, 0,
                 reinterpret_cast<LPARAM>(tensionFile.c_str()));
    tool.PostCommand(page, IDC_MUSIC_CHECK_FIRST);
    const HWND box = tool.WaitForMessageBox();
    *owner = box != nullptr ? GetWindow(box, GW_OWNER) : nullptr;
    return tool.AnswerMessageBox(IDOK);
}

std::string Field(const char (&field)[config::kPathCapacity])
{
    return {field, strnlen(field, sizeof field)};
}

} // namespace

TEST(UserMusicCheck, TypedPathsAreCheckedAndSavedAsTyped)
{
    SaveFolder folder;
    const std::string music = folder.Root() + "\\two-minutes.wav";
    const std::string shortMusic = folder.Root() + "\\half-minute.wav";
    const std::string tensionFile = folder.Root() + "\\battle.txt";
    ASSERT_TRUE(e2e::WriteFileBytes(music, testing_support::MakeWaveOfLength(120.0)));
    ASSERT_TRUE(e2e::WriteFileBytes(shortMusic, testing_support::MakeWaveOfLength(30.0)));
    ASSERT_TRUE(WriteText(tensionFile, "NAME: Battle;\nLOW: 20;\nHI: 40;\nLOW: 50;\n"));

    ToolProcess tool(folder);
    const HWND dialog = tool.WaitForMainDialog();
    ASSERT_NE(dialog, nullptr);
    // The dialog shows before its pages are made.
    HWND musicEdit = nullptr;
    for (int attempt = 0; attempt < 500 && musicEdit == nullptr; ++attempt, Sleep(20))
        musicEdit = e2e::FindControl(dialog, IDC_MUSIC_PATH_FIRST);
    ASSERT_NE(musicEdit, nullptr);
    const HWND page = GetParent(musicEdit);

    HWND owner = dialog;
    const e2e::MessageBoxSeen accepted = CheckRow0(tool, page, music, tensionFile, &owner);
    ASSERT_TRUE(accepted.found);
    EXPECT_EQ(accepted.caption, "");
    EXPECT_EQ(accepted.text, "テンションファイル作成成功!!");
    EXPECT_EQ(owner, nullptr);

    const e2e::MessageBoxSeen rejected = CheckRow0(tool, page, shortMusic, tensionFile, &owner);
    ASSERT_TRUE(rejected.found);
    EXPECT_EQ(rejected.caption, "");
    // Every message of the load, in order: the entries beyond the music's end
    // first, then the length and the verdict.
    EXPECT_EQ(
        rejected.text,
        "Time Data Outside Range!!\nTime Data Outside Range!!\n"
        "ファイル時間 エラー[30.000000秒のファイルです : 60秒以上の長さのファイルが必要です]\n"
        "Time Data IsCorrect Error!!\n変換エラー!!\n");

    const e2e::MessageBoxSeen unreadable =
        CheckRow0(tool, page, folder.Root() + "\\missing.ogg", tensionFile, &owner);
    EXPECT_EQ(unreadable.text, "BGMファイルが開けません");

    CheckRow0(tool, page, music, tensionFile, &owner);
    tool.PostCommand(dialog, IDOK);
    EXPECT_EQ(tool.AnswerMessageBox(IDYES).caption, "終了確認");
    DWORD exitCode = 12345;
    ASSERT_TRUE(tool.WaitForExit(exitCode));
    EXPECT_EQ(exitCode, 0u);

    const std::vector<std::uint8_t> saved = e2e::ReadFileBytes(folder.SettingsFile());
    config::CSaveConfig record;
    ASSERT_TRUE(record.LoadFromBytes(saved.data(), saved.size()));
    EXPECT_EQ(Field(record.UserBgm()->rows[0].musicPath), music);
    EXPECT_EQ(Field(record.UserBgm()->rows[0].tensionPath), tensionFile);
}
