// Music rows checked as a user checks them: VEKConfig.exe started on its
// own, the paths typed in, チェック pressed and its boxes answered, then the
// rows saved as typed.
#include "base/window_text_win32.h"
#include "config/fixed_text.h"
#include "config/save_config.h"
#include "resources/resource.h"
#include "tests/e2e/tool_driver.h"
#include "tests/support/audio_fixtures.h"
#include "tests/support/temp_folder.h"

#include <gtest/gtest.h>

// A missing tension file: after the page's own box a draft from the music
// is offered; Yes writes it where the field says (named in code page 932 on
// any system), fills the field and checks again. With the field empty and a
// file beside the music, nothing is offered and that file stays.
TEST(UserMusicCheck, AMissingTensionFileIsDraftedFromTheMusicOnYesNeverOverAFile)
{
    testing_support::TempSaveFolder folder;
    const std::string music = folder.Root().File("") + *base::AnsiFrom(L"rising\xD7") + ".wav";
    const std::string kept = folder.Root().File("kept.wav"), drafted = folder.Root().File("n.txt");
    testing_support::WriteBytes(
        music, testing_support::MakeToneWave({1, 1, 8000, 16, {}, 0}, 90.0,
                                             [](double t) { return t < 60 ? -30.0 : -12.0; }));
    testing_support::WriteBytes(kept, testing_support::ReadBytes(music));
    testing_support::WriteBytes(folder.Root().File("kept.txt"), {'k'});
    e2e::ToolProcess tool;
    const HWND dialog = tool.MainDialog();
    HWND page = nullptr;
    ASSERT_TRUE(
        e2e::WaitFor([&] { return (page = e2e::FindControl(dialog, IDC_MUSIC_PATH_FIRST)); }));
    page = GetParent(page);
    for (const auto& [id, text] : {std::pair{IDC_MUSIC_PATH_FIRST, music},
                                   {IDC_TENSION_PATH_FIRST, drafted},
                                   {IDC_MUSIC_PATH_FIRST + IDC_MUSIC_ROW_STEP, kept}})
        SendDlgItemMessageA(page, id, WM_SETTEXT, 0, reinterpret_cast<LPARAM>(text.c_str()));

    e2e::PostCommand(page, IDC_MUSIC_CHECK_FIRST);
    EXPECT_EQ(tool.AnswerMessageBox(IDOK).text, "ファイルが開けません!!\n");
    EXPECT_NE(tool.AnswerMessageBox(IDYES).text.find("作成しますか?"), std::string::npos);
    const e2e::MessageBoxSeen success = tool.AnswerMessageBox(IDOK);
    EXPECT_EQ(success.caption + success.text, "テンションファイル作成成功!!");
    EXPECT_EQ(success.owner, nullptr);
    const std::vector<std::uint8_t> draft = testing_support::ReadBytes(drafted);
    EXPECT_NE(std::string(draft.begin(), draft.end()).find("\nFILENAME:rising\x81\x7E;"),
              std::string::npos);
    EXPECT_EQ(e2e::WindowText(GetDlgItem(page, IDC_TENSION_PATH_FIRST)), drafted);

    e2e::PostCommand(page, IDC_MUSIC_CHECK_FIRST + IDC_MUSIC_ROW_STEP);
    EXPECT_EQ(tool.AnswerMessageBox(IDOK).text, "ファイルが開けません!!\n");
    // No offer: the next box is the closing question.
    e2e::PostCommand(dialog, IDOK);
    EXPECT_EQ(tool.AnswerMessageBox(IDYES).caption, "終了確認");
    EXPECT_EQ(tool.ExitCode(), 0u);
    EXPECT_EQ(testing_support::ReadBytes(folder.Root().File("kept.txt")),
              std::vector<std::uint8_t>{'k'});
    config::CSaveConfig saved;
    const std::vector<std::uint8_t> file = testing_support::ReadBytes(folder.SettingsFile());
    ASSERT_TRUE(saved.LoadFromBytes(file.data(), file.size()));
    EXPECT_EQ(config::FieldText(saved.UserBgm()->rows[0].musicPath), music);
    EXPECT_EQ(config::FieldText(saved.UserBgm()->rows[0].tensionPath), drafted);
}
