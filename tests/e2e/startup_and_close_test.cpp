// VEKConfig.exe started as a user starts it: its first file, a file it must
// refuse, and the three ways of closing it.
#include "config/save_config.h"
#include "tests/e2e/tool_driver.h"

#include <cstring>
#include <gtest/gtest.h>

using e2e::ReadFileBytes;
using e2e::SaveFolder;
using e2e::ToolProcess;

namespace
{
constexpr char kCloseQuestion[] = "コンフィグツールを閉じますか？";

std::vector<std::uint8_t> DefaultImage()
{
    config::CSaveConfig record;
    record.ResetAll();
    return record.SaveToBytes();
}

void ExpectExit(ToolProcess& tool, DWORD expected)
{
    DWORD code = 12345;
    ASSERT_TRUE(tool.WaitForExit(code)) << "the tool did not end";
    EXPECT_EQ(code, expected);
}
} // namespace

TEST(Startup, WithoutAFileWritesTheDefaultsAndShowsTheCentredDialog)
{
    SaveFolder folder;
    ToolProcess tool(folder);
    HWND dialog = tool.WaitForMainDialog();
    ASSERT_NE(dialog, nullptr);
    EXPECT_EQ(e2e::WindowText(dialog), "Dialog");
    EXPECT_EQ(ReadFileBytes(folder.SettingsFile()), DefaultImage());

    RECT rect;
    GetWindowRect(dialog, &rect);
    EXPECT_EQ(rect.left, (GetSystemMetrics(SM_CXSCREEN) - (rect.right - rect.left)) / 2);
    EXPECT_EQ(rect.top, (GetSystemMetrics(SM_CYSCREEN) - (rect.bottom - rect.top)) / 2);
    EXPECT_EQ(e2e::WindowText(GetDlgItem(dialog, IDOK)), "保存");
    EXPECT_EQ(e2e::WindowText(GetDlgItem(dialog, IDCANCEL)), "終了");

    tool.PostCommand(dialog, IDCANCEL);
    const e2e::MessageBoxSeen question = tool.AnswerMessageBox(IDYES);
    EXPECT_EQ(question.caption, "終了確認");
    EXPECT_EQ(question.text, std::string("保存されていないデータは失われます\n") + kCloseQuestion);
    ExpectExit(tool, 0);
}

TEST(Startup, ANewerFileIsRefusedWithOneMessageAndNoDialog)
{
    SaveFolder folder;
    CreateDirectoryA((folder.Root() + "\\Tolvenik").c_str(), nullptr);
    CreateDirectoryA(folder.SaveDirectory().c_str(), nullptr);
    std::vector<std::uint8_t> newer = DefaultImage();
    const std::uint32_t version = 0x13001001;
    std::memcpy(newer.data(), &version, sizeof version);
    ASSERT_TRUE(e2e::WriteFileBytes(folder.SettingsFile(), newer));

    ToolProcess tool(folder);
    const e2e::MessageBoxSeen refusal = tool.AnswerMessageBox(IDOK);
    EXPECT_EQ(refusal.text, "コンフィグファイルが読み込めません");
    EXPECT_EQ(refusal.caption, "");
    EXPECT_EQ(tool.WaitForMainDialog(300), nullptr);
    ExpectExit(tool, 0xFFFFFFFF);
    EXPECT_EQ(ReadFileBytes(folder.SettingsFile()), newer) << "the refused file is kept";
}

TEST(Closing, SaveWritesTheFileAndOffersToClose)
{
    SaveFolder folder;
    ToolProcess tool(folder);
    HWND dialog = tool.WaitForMainDialog();
    ASSERT_NE(dialog, nullptr);
    DeleteFileA(folder.SettingsFile().c_str());

    tool.PostCommand(dialog, IDOK);
    const e2e::MessageBoxSeen saved = tool.AnswerMessageBox(IDNO);
    EXPECT_EQ(saved.caption, "終了確認");
    EXPECT_EQ(saved.text, std::string("保存されました\n") + kCloseQuestion);
    EXPECT_EQ(ReadFileBytes(folder.SettingsFile()), DefaultImage());
    EXPECT_TRUE(tool.IsRunning()) << "No keeps the dialog open";
    EXPECT_TRUE(IsWindowVisible(dialog));

    tool.PostCommand(dialog, IDOK);
    EXPECT_TRUE(tool.AnswerMessageBox(IDYES).found);
    ExpectExit(tool, 0);
}

TEST(Closing, TheCloseCommandAsksOnlyWhetherToClose)
{
    SaveFolder folder;
    ToolProcess tool(folder);
    HWND dialog = tool.WaitForMainDialog();
    ASSERT_NE(dialog, nullptr);

    tool.PostClose(dialog);
    const e2e::MessageBoxSeen question = tool.AnswerMessageBox(IDNO);
    EXPECT_EQ(question.caption, "終了確認");
    EXPECT_EQ(question.text, kCloseQuestion);
    EXPECT_TRUE(tool.IsRunning());

    tool.PostCommand(dialog, IDCANCEL);
    EXPECT_TRUE(tool.AnswerMessageBox(IDNO).found);
    EXPECT_TRUE(tool.IsRunning());

    tool.PostClose(dialog);
    EXPECT_TRUE(tool.AnswerMessageBox(IDYES).found);
    ExpectExit(tool, 0);
}

TEST(Closing, AFailedSaveReportsItAndKeepsTheOldFileAndTheDialog)
{
    SaveFolder folder;
    ToolProcess tool(folder);
    HWND dialog = tool.WaitForMainDialog();
    ASSERT_NE(dialog, nullptr);
    const std::vector<std::uint8_t> before = ReadFileBytes(folder.SettingsFile());

    // The game holding the file open without sharing stops it being replaced.
    HANDLE held = CreateFileA(folder.SettingsFile().c_str(), GENERIC_READ, FILE_SHARE_READ, nullptr,
                              OPEN_EXISTING, 0, nullptr);
    ASSERT_NE(held, INVALID_HANDLE_VALUE);
    tool.PostCommand(dialog, IDOK);
    const e2e::MessageBoxSeen failure = tool.AnswerMessageBox(IDOK);
    CloseHandle(held);
    EXPECT_EQ(failure.caption, "エラー");
    EXPECT_EQ(failure.text, "保存に失敗しました");
    EXPECT_EQ(ReadFileBytes(folder.SettingsFile()), before);
    EXPECT_TRUE(tool.IsRunning());

    // A file where the save directory should be: the save fails the same way.
    RemoveDirectoryA(folder.SaveDirectory().c_str());
    DeleteFileA(folder.SettingsFile().c_str());
    RemoveDirectoryA(folder.SaveDirectory().c_str());
    ASSERT_TRUE(e2e::WriteFileBytes(folder.SaveDirectory(), {1, 2, 3}));
    tool.PostCommand(dialog, IDOK);
    EXPECT_EQ(tool.AnswerMessageBox(IDOK).text, "保存に失敗しました");
    EXPECT_EQ(ReadFileBytes(folder.SaveDirectory()), (std::vector<std::uint8_t>{1, 2, 3}));

    DeleteFileA(folder.SaveDirectory().c_str());
    tool.PostClose(dialog);
    tool.AnswerMessageBox(IDYES);
    ExpectExit(tool, 0);
}
