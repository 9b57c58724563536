// VEKConfig.exe on any player's system. The same program runs twice: under
// the Japanese locale, where it writes down every text the tool shows, and
// under an English one (code page 1252, as Western Windows and Proton give
// it), where every text must read the same. In both, typed text is kept in
// code page 932 and paths in the system's code page, and at 150 % every
// control stays inside its page.
#include "base/window_text_win32.h"
#include "config/fixed_text.h"
#include "config/save_config.h"
#include "resources/resource.h"
#include "tests/e2e/tool_driver.h"
#include "tests/support/temp_folder.h"

#include <commctrl.h>
#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <sstream>
#include <vector>

namespace
{

// The English run is the one its runner starts under an English locale.
bool JapaneseRun()
{
    char locale[64] = {};
    GetEnvironmentVariableA("VEK_WINE_LANG", locale, sizeof locale);
    const bool english = std::string(locale).starts_with("en_");
    EXPECT_EQ(GetACP(), english ? 1252u : 932u);
    return !english;
}

// A settings file whose lists and typed fields hold something to show.
void WriteFilledSettings(const testing_support::TempSaveFolder& folder)
{
    config::CSaveConfig record;
    record.ResetAll();
    config::IpEntry address = {{"192", "168", "000", "*"}};
    record.AddConnectEntry(address);
    record.AddAllowEntry(address);
    record.AddDenyEntry(address);
    config::StoreFieldText(record.RadioChat()->entries[0].text, config::kRadioChatTextLimit,
                           "了解！援護する");
    config::StoreFieldText(record.Network()->lobbyId, config::kIdTextLimit, "ＶＥＫ－ＩＤ");
    std::filesystem::create_directories(folder.SaveDirectory());
    testing_support::WriteBytes(folder.SettingsFile(), record.SaveToBytes());
}

// Written by the Japanese run beside the program, read by the English run.
std::filesystem::path JapaneseTexts()
{
    wchar_t path[MAX_PATH] = {};
    GetModuleFileNameW(nullptr, path, MAX_PATH);
    return std::filesystem::path(path).parent_path() / "window-texts-932.txt";
}

std::vector<std::wstring> Lines(const std::wstring& text)
{
    std::vector<std::wstring> lines;
    std::wistringstream stream(text);
    for (std::wstring line; std::getline(stream, line);)
        lines.push_back(line);
    return lines;
}

// For the failure messages.
std::string Utf8(const std::wstring& text)
{
    std::string utf8(text.size() * 3, '\0');
    utf8.resize(static_cast<std::size_t>(WideCharToMultiByte(CP_UTF8, 0, text.data(),
                                                             int(text.size()), utf8.data(),
                                                             int(utf8.size()), nullptr, nullptr)));
    return utf8;
}

// The main dialog once every page is made and filled: a message sent from
// here is taken only by the tool's message loop, which starts after that.
HWND ReadyDialog(e2e::ToolProcess& tool)
{
    const HWND dialog = tool.MainDialog();
    const int lastMade = IDC_RADIO_CHAT_TO_ALL_FIRST + IDC_RADIO_CHAT_ROW_STEP * 11;
    if (dialog == nullptr || !e2e::WaitFor([&] { return e2e::FindControl(dialog, lastMade); }))
        return nullptr;
    SendMessageW(dialog, WM_NULL, 0, 0);
    return dialog;
}

void Type(HWND edit, const wchar_t* keys)
{
    for (const wchar_t* key = keys; *key != L'\0'; ++key)
        PostMessageW(edit, WM_CHAR, *key, 1);
}

constexpr char kPathRefused[] =
    "このパスには、このシステムの文字コードで表せない文字が含まれているため、"
    "ゲームが開けません。\n別の名前のファイルかフォルダーを選んでください。";

} // namespace

TEST(AnySystem, EveryTextReadsAsInTheJapaneseRun)
{
    testing_support::TempSaveFolder folder;
    WriteFilledSettings(folder);
    e2e::ToolProcess tool;
    const HWND dialog = ReadyDialog(tool);
    ASSERT_NE(dialog, nullptr);
    std::wstring texts = e2e::ShownTexts(dialog);
    PostMessageW(e2e::FindControl(dialog, IDC_CONNECT_ADD), BM_CLICK, 0, 0);
    const HWND entry = tool.DialogWith(IDC_IP_OCTET1);
    ASSERT_NE(entry, nullptr);
    texts += e2e::ShownTexts(entry);
    e2e::PostCommand(entry, IDCANCEL);

    const std::filesystem::path reference = JapaneseTexts();
    if (JapaneseRun())
    {
        EXPECT_NE(texts.find(L"/510 SysTabControl32: キーコンフィグ\n"), std::wstring::npos);
        std::ofstream(reference, std::ios::binary)
            .write(reinterpret_cast<const char*>(texts.data()),
                   std::streamsize(texts.size() * sizeof(wchar_t)));
    }
    else
    {
        std::stringstream written;
        written << std::ifstream(reference, std::ios::binary).rdbuf();
        const std::string bytes = written.str();
        ASSERT_FALSE(bytes.empty()) << "the Japanese run writes " << reference;
        const std::wstring japanese(reinterpret_cast<const wchar_t*>(bytes.data()),
                                    bytes.size() / sizeof(wchar_t));
        const std::vector<std::wstring> lines = Lines(texts), expected = Lines(japanese);
        EXPECT_EQ(lines.size(), expected.size());
        int shown = 0;
        for (std::size_t i = 0; i < std::min(lines.size(), expected.size()); ++i)
        {
            if (lines[i] != expected[i] && shown++ < 10)
                ADD_FAILURE() << Utf8(lines[i])
                              << "\n    in the Japanese run: " << Utf8(expected[i]);
        }
    }

    e2e::PostCommand(dialog, IDOK);
    const e2e::MessageBoxSeen saved = tool.AnswerMessageBox(IDNO);
    EXPECT_EQ(saved.caption + ": " + saved.text,
              "終了確認: 保存されました\nコンフィグツールを閉じますか？");
    e2e::PostCommand(dialog, IDCANCEL);
    const e2e::MessageBoxSeen closing = tool.AnswerMessageBox(IDYES);
    EXPECT_EQ(closing.caption + ": " + closing.text,
              "終了確認: 保存されていないデータは失われます\nコンフィグツールを閉じますか？");
    EXPECT_EQ(tool.ExitCode(), 0u);
}

TEST(AnySystem, TypedTextIsKeptInCodePage932AndPathsInTheSystemsCodePage)
{
    // What a player types into a field, and what the field then holds: the
    // same in the edit and in the file. A character the field's code page
    // cannot hold is refused, never kept as a stand-in ('e' for é, '?').
    struct Typed
    {
        int id;
        const wchar_t* keys;
        const char* kept;        // code page 932; a path in the system's code page
        const char* keptIn1252;  // a path's, where the code pages differ
        bool refusedWithMessage; // in the run's own code page
    };
    const bool japanese = JapaneseRun();
    const int chat = IDC_RADIO_CHAT_TEXT_FIRST, step = IDC_RADIO_CHAT_ROW_STEP;
    const int music = IDC_MUSIC_PATH_FIRST, row = IDC_MUSIC_ROW_STEP;
    const Typed typed[] = {
        {chat, L"日本語のメッセージ", "日本語のメッセージ", nullptr, false},
        {chat + step, L"a\uD55Cb", "ab", nullptr, false},         // Hangul
        {chat + 2 * step, L"caf\u00E9!", "caf!", nullptr, false}, // no best fit
        {IDC_NETWORK_LOBBY_ID, L"ＩＤ\u00E9\U0001F600x", "ＩＤx", nullptr, false},
        {music, L"a\u00E9b", "ab", "a\xE9\x62", japanese}, // aéb in code page 1252
        {music + row, L"a\u97F3b", "a音b", "ab", !japanese},
        {music + 2 * row, L"a\uD55Cb", "ab", "ab", true},
    };

    const auto kept = [&](const Typed& t)
    { return std::string(t.keptIn1252 != nullptr && !japanese ? t.keptIn1252 : t.kept); };

    testing_support::TempSaveFolder folder;
    e2e::ToolProcess tool;
    const HWND dialog = ReadyDialog(tool);
    ASSERT_NE(dialog, nullptr);
    for (const Typed& t : typed)
    {
        const HWND edit = e2e::FindControl(dialog, t.id);
        Type(edit, t.keys);
        if (t.refusedWithMessage)
        {
            EXPECT_EQ(tool.AnswerMessageBox(IDOK).text, kPathRefused) << t.id;
        }
        const std::wstring shown =
            t.keptIn1252 != nullptr ? base::WideFromAnsi(kept(t)) : base::WideFrom932(kept(t));
        EXPECT_TRUE(e2e::WaitFor([&] { return e2e::WideText(edit) == shown; }))
            << t.id << ": " << base::Cp932From(e2e::WideText(edit));
    }

    e2e::PostCommand(dialog, IDOK);
    EXPECT_EQ(tool.AnswerMessageBox(IDYES).caption, "終了確認");
    EXPECT_EQ(tool.ExitCode(), 0u);
    config::CSaveConfig saved;
    ASSERT_TRUE(saved.LoadFromPath(folder.SettingsFile().c_str()));
    const std::string held[] = {
        config::FieldText(saved.RadioChat()->entries[0].text),
        config::FieldText(saved.RadioChat()->entries[1].text),
        config::FieldText(saved.RadioChat()->entries[2].text),
        config::FieldText(saved.Network()->lobbyId),
        config::FieldText(saved.UserBgm()->rows[0].musicPath),
        config::FieldText(saved.UserBgm()->rows[1].musicPath),
        config::FieldText(saved.UserBgm()->rows[2].musicPath),
    };
    for (std::size_t i = 0; i < std::size(typed); ++i)
        EXPECT_EQ(held[i], kept(typed[i])) << typed[i].id;
}

namespace
{

// The display scale of the prefix's user for the scope: Wine reads it at
// each process's start.
class ScopedLogPixels
{
public:
    explicit ScopedLogPixels(DWORD dpi)
    {
        RegCreateKeyExW(HKEY_CURRENT_USER, L"Control Panel\\Desktop", 0, nullptr, 0,
                        KEY_QUERY_VALUE | KEY_SET_VALUE, nullptr, &key_, nullptr);
        DWORD size = sizeof old_;
        had_ = RegQueryValueExW(key_, L"LogPixels", nullptr, nullptr,
                                reinterpret_cast<BYTE*>(&old_), &size) == ERROR_SUCCESS;
        Set(dpi);
    }
    ~ScopedLogPixels()
    {
        if (had_)
            Set(old_);
        else
            RegDeleteValueW(key_, L"LogPixels");
        RegCloseKey(key_);
    }

private:
    void Set(DWORD dpi)
    {
        RegSetValueExW(key_, L"LogPixels", 0, REG_DWORD, reinterpret_cast<const BYTE*>(&dpi),
                       sizeof dpi);
    }

    HKEY key_ = nullptr;
    DWORD old_ = 0;
    bool had_ = false;
};

RECT ScreenRect(HWND window)
{
    RECT rect = {};
    GetWindowRect(window, &rect);
    return rect;
}

// The tab's client area less its tabs, on the screen.
RECT DisplayArea(HWND tab)
{
    RECT area = {};
    GetClientRect(tab, &area);
    e2e::LentMemory lent(tab, sizeof area);
    lent.Write(&area, sizeof area);
    SendMessageW(tab, TCM_ADJUSTRECT, FALSE, reinterpret_cast<LPARAM>(lent.Remote()));
    lent.Read(&area, sizeof area);
    MapWindowPoints(tab, nullptr, reinterpret_cast<POINT*>(&area), 2);
    return area;
}

testing::AssertionResult Inside(const RECT& inner, const RECT& outer)
{
    if (inner.left >= outer.left && inner.top >= outer.top && inner.right <= outer.right &&
        inner.bottom <= outer.bottom)
        return testing::AssertionSuccess();
    return testing::AssertionFailure()
           << "(" << inner.left << "," << inner.top << ")-(" << inner.right << "," << inner.bottom
           << ") outside (" << outer.left << "," << outer.top << ")-(" << outer.right << ","
           << outer.bottom << ")";
}

} // namespace

TEST(AnySystem, At150PercentEveryControlLiesInsideItsPageAndEveryPageInsideItsTab)
{
    const ScopedLogPixels scale(144);
    testing_support::TempSaveFolder folder;
    e2e::ToolProcess tool;
    const HWND dialog = ReadyDialog(tool);
    ASSERT_NE(dialog, nullptr);
    const HWND mainTab = e2e::FindControl(dialog, IDC_MAIN_TAB);
    const HWND keyTab = e2e::FindControl(dialog, IDC_KEY_TAB);
    const HWND keyConfigPage = GetParent(keyTab);
    int pages = 0;
    for (HWND tab : {mainTab, keyTab})
    {
        const RECT area = DisplayArea(tab);
        EXPECT_GT(area.bottom - area.top, 300) << "the dialog's units follow the scale";
        for (HWND page = GetWindow(tab == mainTab ? mainTab : keyConfigPage, GW_CHILD); page;
             page = GetWindow(page, GW_HWNDNEXT))
        {
            if (page == keyTab)
                continue;
            const int index = pages++;
            EXPECT_TRUE(Inside(ScreenRect(page), area)) << "page " << index;
            for (HWND control = GetWindow(page, GW_CHILD); control;
                 control = GetWindow(control, GW_HWNDNEXT))
                EXPECT_TRUE(Inside(ScreenRect(control), ScreenRect(page)))
                    << "control " << GetDlgCtrlID(control) << " of page " << index;
        }
    }
    EXPECT_EQ(pages, 9);
}
