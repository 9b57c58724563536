// The user music page's wiring: files dropped from the shell, the two
// file-open dialogs of 参照 and the box that チェック shows.
#include "config/fixed_text.h"
#include "resources/resource.h"
#include "tests/gui/gui_harness.h"
#include "tests/support/audio_fixtures.h"

#include <cstring>
#include <deque>
#include <dlgs.h>
#include <shellapi.h>
#include <shlobj.h>

using gui::ControlText;
using gui::RunningTool;

namespace
{

constexpr int kRow = 6;
constexpr int kMusicEdit = IDC_MUSIC_PATH_FIRST + IDC_MUSIC_ROW_STEP * kRow;
constexpr int kTensionEdit = IDC_TENSION_PATH_FIRST + IDC_MUSIC_ROW_STEP * kRow;

std::string MusicPath(RunningTool& tool)
{
    return config::FieldText(tool.Record().UserBgm()->rows[kRow].musicPath);
}

std::string TensionPath(RunningTool& tool)
{
    return config::FieldText(tool.Record().UserBgm()->rows[kRow].tensionPath);
}

// What the shell hands a window that files are dropped on: a DROPFILES
// header followed by the zero-terminated names and one more zero.
HDROP MakeDrop(const std::vector<std::string>& files)
{
    std::size_t size = sizeof(DROPFILES) + 1;
    for (const std::string& file : files)
        size += file.size() + 1;
    const HGLOBAL memory = GlobalAlloc(GHND, size);
    auto* header = static_cast<DROPFILES*>(GlobalLock(memory));
    header->pFiles = sizeof(DROPFILES);
    char* name = reinterpret_cast<char*>(header + 1);
    for (const std::string& file : files)
        name = std::strcpy(name, file.c_str()) + file.size() + 1;
    GlobalUnlock(memory);
    return static_cast<HDROP>(memory);
}

// The files still to be opened, each in the next file-open dialog that
// becomes active.
std::deque<std::string> filesToOpen;
HWND lastFileDialog = nullptr;

LRESULT CALLBACK OpenNextFile(int code, WPARAM wParam, LPARAM lParam)
{
    const HWND dialog = reinterpret_cast<HWND>(wParam);
    const HWND name =
        GetDlgItem(dialog, cmb13) != nullptr ? GetDlgItem(dialog, cmb13) : GetDlgItem(dialog, edt1);
    if (code == HCBT_ACTIVATE && dialog != lastFileDialog && GetDlgItem(dialog, cmb1) != nullptr &&
        name != nullptr && !filesToOpen.empty())
    {
        lastFileDialog = dialog;
        SetWindowTextA(name, filesToOpen.front().c_str());
        filesToOpen.pop_front();
        PostMessageA(dialog, WM_COMMAND, IDOK, 0);
    }
    return CallNextHookEx(nullptr, code, wParam, lParam);
}

} // namespace

TEST(UserMusicPage, ADropStoresTheFirstFileInTheEditItFellOn)
{
    RunningTool tool;
    const HDROP drop = MakeDrop({"C:\\音楽\\一.txt", "C:\\two.txt"});
    SendDlgItemMessageA(tool.Page(kUserMusicPageIndex), kTensionEdit, WM_DROPFILES,
                        reinterpret_cast<WPARAM>(drop), 0);
    EXPECT_EQ(TensionPath(tool), "C:\\音楽\\一.txt");
    EXPECT_EQ(ControlText(tool.Page(kUserMusicPageIndex), kTensionEdit), "C:\\音楽\\一.txt");
    EXPECT_EQ(MusicPath(tool), "");
    EXPECT_EQ(GlobalSize(drop), 0u) << "the drop was not released";
}

TEST(UserMusicPage, BrowsingChoosesTheMusicThenItsTensionFileAndGivesTheFolderBack)
{
    testing_support::TempFolder folder;
    testing_support::WriteBytes(folder.File("tune.wav"), {'R'});
    testing_support::WriteBytes(folder.File("tune.txt"), {'L'});
    RunningTool tool;
    const std::filesystem::path programFolder = std::filesystem::current_path();
    std::filesystem::current_path(folder.Path());
    filesToOpen = {folder.File("tune.wav"), folder.File("tune.txt")};
    {
        const gui::CbtHook hook(OpenNextFile);
        gui::Notify(tool.Page(kUserMusicPageIndex),
                    IDC_MUSIC_BROWSE_FIRST + IDC_MUSIC_ROW_STEP * kRow);
    }

    EXPECT_EQ(MusicPath(tool), folder.File("tune.wav"));
    EXPECT_EQ(TensionPath(tool), folder.File("tune.txt"));
    EXPECT_EQ(ControlText(tool.Page(kUserMusicPageIndex), kTensionEdit), folder.File("tune.txt"));
    EXPECT_TRUE(IsWindowEnabled(tool.App().System()->GetHwnd()));
    EXPECT_EQ(std::filesystem::current_path(), programFolder);
}

TEST(UserMusicPage, CheckShowsTheOutcomeOfItsRowInAnUntitledBox)
{
    testing_support::TempFolder folder;
    testing_support::WriteBytes(folder.File("music.wav"), testing_support::MakeWaveOfLength(120));
    RunningTool tool;
    SetDlgItemTextA(tool.Page(kUserMusicPageIndex), kMusicEdit, folder.File("music.wav").c_str());
    gui::messageBoxes.clear();
    const gui::CbtHook answering(gui::AnswerMessageBox);
    gui::Notify(tool.Page(kUserMusicPageIndex), IDC_MUSIC_CHECK_FIRST + IDC_MUSIC_ROW_STEP * kRow);
    // The row has music but no tension file.
    EXPECT_EQ(gui::messageBoxes, (decltype(gui::messageBoxes){{"", "ファイルが開けません!!\n"}}));
}
