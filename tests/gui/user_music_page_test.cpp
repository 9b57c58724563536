// The user music page: its ten rows, paths typed, dropped from the shell and
// browsed for through the two file-open dialogs, and the check of a row with
// music and tension files written by the test.
#include "resources/resource.h"
#include "tests/gui/gui_harness.h"
#include "tests/gui/page_checks.h"
#include "tests/support/audio_fixtures.h"
#include "tests/support/temp_folder.h"

#include <cstring>
#include <deque>
#include <dlgs.h>
#include <filesystem>
#include <gtest/gtest.h>
#include <optional>
#include <set>
#include <shellapi.h>
#include <shlobj.h>
#include <string>
#include <utility>
#include <vector>

using gui::RunningTool;
using gui::WindowText;

namespace
{

int MusicEdit(int row)
{
    return IDC_MUSIC_PATH_FIRST + IDC_MUSIC_ROW_STEP * row;
}

int TensionEdit(int row)
{
    return IDC_TENSION_PATH_FIRST + IDC_MUSIC_ROW_STEP * row;
}

int BrowseButton(int row)
{
    return IDC_MUSIC_BROWSE_FIRST + IDC_MUSIC_ROW_STEP * row;
}

int CheckButton(int row)
{
    return IDC_MUSIC_CHECK_FIRST + IDC_MUSIC_ROW_STEP * row;
}

HWND MusicPage(RunningTool& tool)
{
    return tool.Page(kUserMusicPageIndex);
}

std::string Field(const char (&field)[config::kPathCapacity])
{
    return {field, strnlen(field, sizeof field)};
}

std::string MusicPathOf(RunningTool& tool, int row)
{
    return Field(tool.Record().UserBgm()->rows[row].musicPath);
}

std::string TensionPathOf(RunningTool& tool, int row)
{
    return Field(tool.Record().UserBgm()->rows[row].tensionPath);
}

void Store(char (&field)[config::kPathCapacity], const std::string& path)
{
    std::memcpy(field, path.data(), path.size());
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
    header->fWide = FALSE;
    char* name = reinterpret_cast<char*>(header + 1);
    for (const std::string& file : files)
    {
        std::memcpy(name, file.c_str(), file.size() + 1);
        name += file.size() + 1;
    }
    GlobalUnlock(memory);
    return static_cast<HDROP>(memory);
}

// Drops the files on an edit of the page; the page must release the drop.
void Drop(RunningTool& tool, int editId, const std::vector<std::string>& files)
{
    const HDROP drop = MakeDrop(files);
    SendMessageA(tool.Control(MusicPage(tool), editId), WM_DROPFILES,
                 reinterpret_cast<WPARAM>(drop), 0);
    tool.Pump();
    EXPECT_EQ(GlobalSize(drop), 0u) << "the drop was not released";
}

struct FileDialogSeen
{
    std::string title;
    std::vector<std::string> fileTypes;
    bool mainDialogEnabled;
    HWND owner;
};

// Answers the file-open dialogs shown while it exists, in order: a name to
// type into the file name field and open, or nothing to cancel. A dialog is
// answered from a timer of its own modal loop: when it is activated, its
// lists are not filled yet.
class FileDialogAnswerer
{
public:
    FileDialogAnswerer(HWND mainDialog, std::deque<std::optional<std::string>> answers)
        : mainDialog_(mainDialog), answers_(std::move(answers))
    {
        active = this;
        hook_ = SetWindowsHookExA(WH_CBT, Hook, nullptr, GetCurrentThreadId());
    }
    ~FileDialogAnswerer()
    {
        UnhookWindowsHookEx(hook_);
        active = nullptr;
    }
    FileDialogAnswerer(const FileDialogAnswerer&) = delete;
    FileDialogAnswerer& operator=(const FileDialogAnswerer&) = delete;

    const std::vector<FileDialogSeen>& Seen() const { return seen_; }

private:
    static LRESULT CALLBACK Hook(int code, WPARAM wParam, LPARAM lParam)
    {
        const auto dialog = reinterpret_cast<HWND>(wParam);
        if (code == HCBT_ACTIVATE && active != nullptr && IsFileDialog(dialog) &&
            active->answered_.insert(dialog).second)
        {
            active->pending_ = dialog;
            SetTimer(nullptr, 0, 10, AnswerPending);
        }
        return CallNextHookEx(nullptr, code, wParam, lParam);
    }

    static void CALLBACK AnswerPending(HWND, UINT, UINT_PTR timer, DWORD)
    {
        KillTimer(nullptr, timer);
        if (active != nullptr && active->pending_ != nullptr)
            active->Answer(std::exchange(active->pending_, nullptr));
    }

    static bool IsFileDialog(HWND window)
    {
        return GetDlgItem(window, cmb1) != nullptr &&
               (GetDlgItem(window, cmb13) != nullptr || GetDlgItem(window, edt1) != nullptr);
    }

    void Answer(HWND dialog)
    {
        FileDialogSeen seen{WindowText(dialog),
                            {},
                            IsWindowEnabled(mainDialog_) != FALSE,
                            GetWindow(dialog, GW_OWNER)};
        const LRESULT count = SendDlgItemMessageA(dialog, cmb1, CB_GETCOUNT, 0, 0);
        for (LRESULT index = 0; index < count; ++index)
        {
            char text[128] = {};
            SendDlgItemMessageA(dialog, cmb1, CB_GETLBTEXT, index, reinterpret_cast<LPARAM>(text));
            seen.fileTypes.push_back(text);
        }
        seen_.push_back(seen);

        std::optional<std::string> answer;
        if (!answers_.empty())
        {
            answer = answers_.front();
            answers_.pop_front();
        }
        if (answer)
        {
            const int field = GetDlgItem(dialog, cmb13) != nullptr ? cmb13 : edt1;
            SetDlgItemTextA(dialog, field, answer->c_str());
        }
        PostMessageA(dialog, WM_COMMAND, MAKEWPARAM(answer ? IDOK : IDCANCEL, BN_CLICKED), 0);
    }

    static inline FileDialogAnswerer* active = nullptr;
    HHOOK hook_;
    HWND mainDialog_;
    std::deque<std::optional<std::string>> answers_;
    std::set<HWND> answered_;
    HWND pending_ = nullptr;
    std::vector<FileDialogSeen> seen_;
};

const std::vector<std::string> kFileTypes = {"すべての対応ファイル", "すべてのファイル(*.*)"};

// Music and tension files of the test's own, reached from a working folder
// of their own: a tension file without a name entry goes by its path, which
// must stay within 40 bytes.
class UserMusicCheck : public ::testing::Test
{
protected:
    void SetUp() override
    {
        ASSERT_TRUE(tool_.Started());
        previous_ = std::filesystem::current_path();
        std::filesystem::current_path(files_.Path());
        testing_support::WriteBytes("two-minutes.wav", testing_support::MakeWaveOfLength(120.0));
        testing_support::WriteBytes("half-minute.wav", testing_support::MakeWaveOfLength(30.0));
        testing_support::WriteBytes("three-minutes.wav", testing_support::MakeWaveOfLength(180.0));
        WriteText("unknown-key.txt", "SPEED: 3;\n");
        WriteText("named.txt", "NAME: Test;\nLOW: 20;\n");
        WriteText("climax.txt", "FILENAME : Test;\nLOW : 30;\nHI : 60;\nLOW : 90;\n"
                                "CLIMAX : 150;\nFINALE : 170;\n");
    }
    void TearDown() override { std::filesystem::current_path(previous_); }

    static void WriteText(const std::string& path, const std::string& text)
    {
        testing_support::WriteBytes(path, std::vector<std::uint8_t>(text.begin(), text.end()));
    }

    struct Outcome
    {
        LRESULT result;
        std::vector<gui::MessageBoxSeen> boxes;
    };

    // Presses チェック of a row as the page's dialog procedure sees it.
    Outcome Check(int row)
    {
        gui::MessageBoxAnswerer answerer(IDOK);
        const HWND page = MusicPage(tool_);
        const LRESULT result = tool_.App().OnUserMusicPage(
            page, WM_COMMAND, MAKEWPARAM(CheckButton(row), BN_CLICKED),
            reinterpret_cast<LPARAM>(tool_.Control(page, CheckButton(row))));
        tool_.Pump();
        return Outcome{result, answerer.Seen()};
    }

    void Type(int row, const std::string& music, const std::string& tensionFile)
    {
        tool_.Type(MusicPage(tool_), MusicEdit(row), music);
        tool_.Type(MusicPage(tool_), TensionEdit(row), tensionFile);
    }

    RunningTool tool_;
    testing_support::TempFolder files_;
    std::filesystem::path previous_;
};

} // namespace

TEST(UserMusicPage, ShowsTheRecordsPathsInTheirSubclassedEdits)
{
    // A path of 260 bytes without its zero, as a damaged file may hold.
    const std::string unterminated(config::kPathCapacity, 'x');
    RunningTool tool(gui::SettingsWith(
        [&](config::CSaveConfig& record)
        {
            config::UserBgmRow* rows = record.UserBgm()->rows;
            Store(rows[0].musicPath, "C:\\音楽\\戦闘曲.ogg");
            Store(rows[0].tensionPath, "C:\\音楽\\戦闘曲.txt");
            Store(rows[9].musicPath, "D:\\bgm\\last.wav");
            Store(rows[4].musicPath, unterminated);
        }));
    const HWND page = MusicPage(tool);
    EXPECT_EQ(WindowText(tool.Control(page, MusicEdit(0))), "C:\\音楽\\戦闘曲.ogg");
    EXPECT_EQ(WindowText(tool.Control(page, TensionEdit(0))), "C:\\音楽\\戦闘曲.txt");
    EXPECT_EQ(WindowText(tool.Control(page, MusicEdit(9))), "D:\\bgm\\last.wav");
    EXPECT_EQ(WindowText(tool.Control(page, TensionEdit(9))), "");
    EXPECT_EQ(WindowText(tool.Control(page, MusicEdit(4))), std::string(259, 'x'));
    EXPECT_EQ(WindowText(tool.Control(page, TensionEdit(4))), "");

    for (int row = 0; row < config::kUserBgmRowCount; ++row)
    {
        for (const int id : {MusicEdit(row), TensionEdit(row)})
        {
            const HWND edit = tool.Control(page, id);
            EXPECT_EQ(GetWindowLongPtrA(edit, GWLP_WNDPROC),
                      reinterpret_cast<LONG_PTR>(AppWindowProc))
                << id;
            EXPECT_NE(GetWindowLongPtrA(edit, GWL_EXSTYLE) & WS_EX_ACCEPTFILES, 0) << id;
        }
    }
}

TEST(UserMusicPage, EveryEditTypesIntoItsOwnField)
{
    RunningTool tool;
    const HWND page = MusicPage(tool);
    for (int row = 0; row < config::kUserBgmRowCount; ++row)
    {
        tool.Type(page, MusicEdit(row), "music" + std::to_string(row) + ".ogg");
        tool.Type(page, TensionEdit(row), "tension" + std::to_string(row) + ".txt");
    }
    for (int row = 0; row < config::kUserBgmRowCount; ++row)
    {
        EXPECT_EQ(MusicPathOf(tool, row), "music" + std::to_string(row) + ".ogg");
        EXPECT_EQ(TensionPathOf(tool, row), "tension" + std::to_string(row) + ".txt");
    }

    // The field keeps 259 bytes and its zero; a shorter text after a longer
    // one leaves nothing of it behind.
    tool.Type(page, MusicEdit(3), std::string(300, 'a'));
    EXPECT_EQ(MusicPathOf(tool, 3), std::string(259, 'a'));
    tool.Type(page, MusicEdit(3), "b.wav");
    const char* field = tool.Record().UserBgm()->rows[3].musicPath;
    EXPECT_EQ(std::string(field, config::kPathCapacity),
              "b.wav" + std::string(config::kPathCapacity - 5, '\0'));
}

TEST(UserMusicPage, ADropStoresTheFirstFileInTheEditItFellOn)
{
    RunningTool tool(gui::SettingsWith(
        [](config::CSaveConfig& record)
        {
            Store(record.UserBgm()->rows[2].musicPath, "old.wav");
            Store(record.UserBgm()->rows[5].tensionPath, "keep.txt");
        }));
    const HWND page = MusicPage(tool);

    Drop(tool, TensionEdit(2), {"C:\\one.txt", "C:\\two.txt", "C:\\three.txt"});
    EXPECT_EQ(TensionPathOf(tool, 2), "C:\\one.txt");
    EXPECT_EQ(WindowText(tool.Control(page, TensionEdit(2))), "C:\\one.txt");
    EXPECT_EQ(MusicPathOf(tool, 2), "old.wav");

    Drop(tool, MusicEdit(5), {"C:\\音楽\\曲.ogg"});
    EXPECT_EQ(MusicPathOf(tool, 5), "C:\\音楽\\曲.ogg");
    EXPECT_EQ(WindowText(tool.Control(page, MusicEdit(5))), "C:\\音楽\\曲.ogg");
    EXPECT_EQ(TensionPathOf(tool, 5), "keep.txt");
    EXPECT_EQ(WindowText(tool.Control(page, TensionEdit(5))), "keep.txt");

    Drop(tool, MusicEdit(2), {});
    EXPECT_EQ(MusicPathOf(tool, 2), "old.wav");

    const std::string longPath = "C:\\" + std::string(300, 'p') + ".wav";
    Drop(tool, MusicEdit(7), {longPath});
    EXPECT_EQ(MusicPathOf(tool, 7), longPath.substr(0, 259));
}

TEST(UserMusicPage, BrowsingChoosesTheMusicAndThenItsTensionFile)
{
    testing_support::TempFolder folder;
    testing_support::WriteBytes(folder.File("tune.wav"), testing_support::MakeWaveOfLength(61.0));
    testing_support::WriteBytes(folder.File("tune.txt"), {'N', 'A', 'M', 'E', ':', 'x', ';'});
    RunningTool tool;
    const HWND page = MusicPage(tool);
    FileDialogAnswerer answerer(tool.MainDialog(),
                                {folder.File("tune.wav"), folder.File("tune.txt")});
    tool.Click(page, BrowseButton(6));

    ASSERT_EQ(answerer.Seen().size(), 2u);
    EXPECT_EQ(answerer.Seen()[0].title, "BGMファイルを開く");
    EXPECT_EQ(answerer.Seen()[0].fileTypes, kFileTypes);
    EXPECT_EQ(answerer.Seen()[1].title, "テンションファイルを開く");
    EXPECT_EQ(answerer.Seen()[1].fileTypes, kFileTypes);
    for (const FileDialogSeen& seen : answerer.Seen())
    {
        EXPECT_FALSE(seen.mainDialogEnabled) << seen.title;
        EXPECT_EQ(seen.owner, tool.MainDialog()) << seen.title;
    }
    EXPECT_TRUE(IsWindowEnabled(tool.MainDialog()));

    EXPECT_EQ(MusicPathOf(tool, 6), folder.File("tune.wav"));
    EXPECT_EQ(TensionPathOf(tool, 6), folder.File("tune.txt"));
    EXPECT_EQ(WindowText(tool.Control(page, MusicEdit(6))), folder.File("tune.wav"));
    EXPECT_EQ(WindowText(tool.Control(page, TensionEdit(6))), folder.File("tune.txt"));
}

TEST(UserMusicPage, ACancelledBrowseKeepsWhatWasChosenBeforeIt)
{
    testing_support::TempFolder folder;
    testing_support::WriteBytes(folder.File("new.ogg"), {'O', 'g', 'g', 'S'});
    RunningTool tool(gui::SettingsWith(
        [](config::CSaveConfig& record)
        {
            Store(record.UserBgm()->rows[1].musicPath, "old.wav");
            Store(record.UserBgm()->rows[1].tensionPath, "old.txt");
        }));
    const HWND page = MusicPage(tool);
    {
        FileDialogAnswerer answerer(tool.MainDialog(), {std::nullopt});
        tool.Click(page, BrowseButton(1));
        EXPECT_EQ(answerer.Seen().size(), 1u) << "no tension dialog after a cancelled music one";
    }
    EXPECT_TRUE(IsWindowEnabled(tool.MainDialog()));
    EXPECT_EQ(MusicPathOf(tool, 1), "old.wav");
    EXPECT_EQ(TensionPathOf(tool, 1), "old.txt");

    {
        FileDialogAnswerer answerer(tool.MainDialog(), {folder.File("new.ogg"), std::nullopt});
        tool.Click(page, BrowseButton(1));
        EXPECT_EQ(answerer.Seen().size(), 2u);
    }
    EXPECT_TRUE(IsWindowEnabled(tool.MainDialog()));
    EXPECT_EQ(MusicPathOf(tool, 1), folder.File("new.ogg"));
    EXPECT_EQ(WindowText(tool.Control(page, MusicEdit(1))), folder.File("new.ogg"));
    EXPECT_EQ(TensionPathOf(tool, 1), "old.txt");
    EXPECT_EQ(WindowText(tool.Control(page, TensionEdit(1))), "old.txt");
}

TEST_F(UserMusicCheck, ShowsOneUntitledBoxWithTheOutcome)
{
    const std::string isCorrect = "Time Data IsCorrect Error!!\n";
    const std::string conversion = "変換エラー!!\n";
    const struct
    {
        const char* music;
        const char* tensionFile;
        LRESULT result;
        std::string shown;
    } cases[] = {
        {"", "named.txt", 0, "BGMファイルが開けません"},
        {"missing.wav", "named.txt", 0, "BGMファイルが開けません"},
        {"two-minutes.wav", "", 0, "ファイルが開けません!!\n"},
        {"half-minute.wav", "named.txt", 0,
         "ファイル時間 エラー[30.000000秒のファイルです : 60秒以上の長さのファイルが必要です]\n" +
             isCorrect + conversion},
        {"two-minutes.wav", "unknown-key.txt", 1, "テンションファイル作成成功!!"},
        {"two-minutes.wav", "named.txt", 1, "テンションファイル作成成功!!"},
        {"three-minutes.wav", "climax.txt", 0,
         "ClimaxTension 時間オーバー[現在 30.000000 秒です 18 秒以内にしてください]\n" + isCorrect +
             conversion},
    };
    for (const auto& c : cases)
    {
        Type(3, c.music, c.tensionFile);
        const Outcome outcome = Check(3);
        EXPECT_EQ(outcome.result, c.result) << c.music << " " << c.tensionFile;
        ASSERT_EQ(outcome.boxes.size(), 1u) << c.music << " " << c.tensionFile;
        EXPECT_EQ(outcome.boxes[0].caption, "");
        EXPECT_EQ(outcome.boxes[0].text, c.shown) << c.music << " " << c.tensionFile;
    }
}

TEST_F(UserMusicCheck, LeavesTheRecordAsItWas)
{
    Type(0, "two-minutes.wav", "named.txt");
    Type(8, "half-minute.wav", "named.txt");
    Type(9, "missing.wav", "");
    tool_.Save();
    const std::vector<std::uint8_t> before = gui::ReadFile(tool_.SettingsFile());

    {
        gui::MessageBoxAnswerer answerer(IDOK);
        for (const int row : {0, 8, 9})
            tool_.Click(MusicPage(tool_), CheckButton(row));
        EXPECT_EQ(answerer.Seen().size(), 3u);
    }
    tool_.Save();
    EXPECT_EQ(gui::ReadFile(tool_.SettingsFile()), before);
    config::CSaveConfig saved;
    ASSERT_TRUE(saved.LoadFromPath(tool_.SettingsFile().c_str()));
    EXPECT_EQ(Field(saved.UserBgm()->rows[0].musicPath), "two-minutes.wav");
    EXPECT_EQ(Field(saved.UserBgm()->rows[8].tensionPath), "named.txt");
}
