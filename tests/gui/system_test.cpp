// The window object: the dialog it hosts, the program's directory, and the
// file-open dialog that must hand the current directory back.
#include "app/system.h"
#include "tests/gui/gui_harness.h"

#include <cstring>
#include <gtest/gtest.h>
#include <string>

namespace
{
// Cancels the first dialog that becomes active on this thread.
HHOOK cancelHook = nullptr;

LRESULT CALLBACK CancelFirstDialog(int code, WPARAM wParam, LPARAM lParam)
{
    if (code == HCBT_ACTIVATE)
        PostMessageA(reinterpret_cast<HWND>(wParam), WM_COMMAND, IDCANCEL, 0);
    return CallNextHookEx(cancelHook, code, wParam, lParam);
}

std::string CurrentDirectory()
{
    char directory[MAX_PATH] = {};
    GetCurrentDirectoryA(sizeof directory, directory);
    return directory;
}
} // namespace

TEST(System, ModuleDirectoryIsTheProgramsFolderWithItsBackslash)
{
    gui::RunningTool tool;
    char directory[MAX_PATH];
    ASSERT_TRUE(tool.App().System()->GetModuleDir(directory, sizeof directory));
    char program[MAX_PATH] = {};
    GetModuleFileNameA(nullptr, program, sizeof program);
    const std::string expected(program, std::strrchr(program, '\\') + 1);
    EXPECT_EQ(directory, expected);
    EXPECT_EQ(CurrentDirectory() + "\\", expected)
        << "the dialog host moves to the program's folder";
    EXPECT_STREQ(tool.App().System()->GetClassName(), "CSystem");
}

TEST(System, ACancelledFileDialogStillRestoresTheProgramsFolder)
{
    gui::RunningTool tool;
    const std::string programFolder = CurrentDirectory();
    char elsewhere[MAX_PATH] = {};
    GetTempPathA(sizeof elsewhere, elsewhere);
    ASSERT_TRUE(SetCurrentDirectoryA(elsewhere));

    char file[MAX_PATH] = "";
    cancelHook = SetWindowsHookExA(WH_CBT, CancelFirstDialog, nullptr, GetCurrentThreadId());
    const bool chosen = tool.App().System()->OpenFileDialog(file, "title", "All\0*.*\0", "txt");
    UnhookWindowsHookEx(cancelHook);

    EXPECT_FALSE(chosen);
    EXPECT_EQ(CurrentDirectory(), programFolder);
}
