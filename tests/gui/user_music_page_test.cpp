// The user music page's wiring: files dropped from the shell, the box that
// チェック shows and the two file-open dialogs of 参照, each on its own row.
#include "config/fixed_text.h"
#include "resources/resource.h"
#include "tests/gui/gui_harness.h"
#include "tests/support/audio_fixtures.h"

#include <cstring>
#include <deque>
#include <dlgs.h>
#include <shellapi.h>
#include <shlobj.h>

namespace
{

constexpr int kRow = 6;
constexpr int kMusicEdit = IDC_MUSIC_PATH_FIRST + IDC_MUSIC_ROW_STEP * kRow;

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

TEST(UserMusicPage, ADropTheCheckAndBrowsingEachServeTheirRow)
{
    testing_support::TempFolder folder;
    const std::string music = folder.File("music.wav");
    testing_support::WriteBytes(music, testing_support::MakeWaveOfLength(120));
    for (const char* name : {"b.wav", "b.txt"})
        testing_support::WriteBytes(folder.File(name), {'b'});
    gui::RunningTool tool;
    const HWND page = tool.PageWindow(kUserMusicPageIndex);
    const config::UserBgmRow& row = tool.Record()->UserBgm()->rows[kRow];

    // A drop as the shell hands it: DROPFILES, then names ending in zeros.
    const auto dropOn = [&](int edit, const void* names, std::size_t size, BOOL wide)
    {
        const HGLOBAL drop = GlobalAlloc(GHND, sizeof(DROPFILES) + size);
        auto* header = static_cast<DROPFILES*>(GlobalLock(drop));
        *header = {sizeof(DROPFILES), {}, FALSE, wide};
        std::memcpy(header + 1, names, size);
        GlobalUnlock(drop);
        SendDlgItemMessageA(page, edit, WM_DROPFILES, reinterpret_cast<WPARAM>(drop), 0);
        EXPECT_EQ(GlobalSize(drop), 0u) << "the drop was not released";
    };
    const std::string names = music + '\0' + folder.File("b.wav") + '\0' + '\0';
    dropOn(kMusicEdit, names.data(), names.size(), FALSE);
    EXPECT_EQ(config::FieldText(row.musicPath), music) << "the first file of the drop";
    EXPECT_EQ(gui::ControlText(page, kMusicEdit), music);

    gui::messageBoxes.clear();
    {
        const gui::CbtHook answering(gui::AnswerMessageBox);
        // A path the system's code page cannot hold (Hangul, on a Japanese
        // or a Western system) is refused.
        const wchar_t refused[] = L"C:\\\uD55C.wav\0";
        dropOn(kMusicEdit, refused, sizeof refused, TRUE);
        gui::Notify(page, IDC_MUSIC_CHECK_FIRST + IDC_MUSIC_ROW_STEP * kRow);
    }
    EXPECT_EQ(config::FieldText(row.musicPath), music);
    // The refusal, then the check: the row's music was read; it has no
    // tension file, and a draft is offered (and declined).
    ASSERT_EQ(gui::messageBoxes.size(), 3u);
    EXPECT_EQ(gui::messageBoxes[0].second.substr(0, 12), "このパスには");
    EXPECT_EQ(gui::messageBoxes[1],
              (std::pair<std::string, std::string>{"", "ファイルが開けません!!\n"}));
    EXPECT_EQ(gui::messageBoxes[2].second, "テンションファイルをBGMから作成しますか?");
    EXPECT_EQ(config::FieldText(row.tensionPath), "");

    const std::filesystem::path programFolder = std::filesystem::current_path();
    std::filesystem::current_path(folder.Path());
    filesToOpen = {folder.File("b.wav"), folder.File("b.txt")};
    {
        const gui::CbtHook opening(OpenNextFile);
        gui::Notify(page, IDC_MUSIC_BROWSE_FIRST + IDC_MUSIC_ROW_STEP * kRow);
    }
    EXPECT_EQ(config::FieldText(row.musicPath), folder.File("b.wav"));
    EXPECT_EQ(config::FieldText(row.tensionPath), folder.File("b.txt"));
    EXPECT_EQ(gui::ControlText(page, IDC_TENSION_PATH_FIRST + IDC_MUSIC_ROW_STEP * kRow),
              folder.File("b.txt"));
    EXPECT_TRUE(IsWindowEnabled(tool.System()->GetHwnd()));
    EXPECT_EQ(std::filesystem::current_path(), programFolder);
}
