// VEKConfig.exe on any player's system. The black-box tests run twice:
// under the Japanese locale, where this test writes down every text the tool
// shows, and under an English one (code page 1252, as Western Windows and
// Proton have it), where every text must read the same.
#include "base/window_text_win32.h"
#include "config/fixed_text.h"
#include "config/save_config.h"
#include "resources/resource.h"
#include "tests/e2e/tool_driver.h"
#include "tests/support/temp_folder.h"

#include <filesystem>
#include <gtest/gtest.h>

namespace
{

// The English run is the one started under an English locale.
bool JapaneseRun()
{
    char locale[64] = {};
    GetEnvironmentVariableA("VEK_WINE_LANG", locale, sizeof locale);
    const bool english = std::string(locale).starts_with("en_");
    EXPECT_EQ(GetACP(), english ? 1252u : 932u);
    return !english;
}

} // namespace

TEST(AnySystem, EveryTextReadsAsInTheJapaneseRun)
{
    testing_support::TempSaveFolder folder;
    config::CSaveConfig record; // lists and typed fields with something to show
    record.ResetAll();
    const config::IpEntry address = {{"192", "168", "000", "*"}};
    record.AddConnectEntry(address);
    record.AddAllowEntry(address);
    record.AddDenyEntry(address);
    config::StoreFieldText(record.RadioChat()->entries[0].text, config::kRadioChatTextLimit,
                           "了解！援護する");
    config::StoreFieldText(record.Network()->lobbyId, config::kIdTextLimit, "ＶＥＫ－ＩＤ");
    folder.WriteSettings(record.SaveToBytes());

    e2e::ToolProcess tool;
    const HWND dialog = tool.MainDialog();
    ASSERT_NE(dialog, nullptr);
    std::wstring texts = e2e::ShownTexts(dialog);
    PostMessageW(e2e::FindControl(dialog, IDC_CONNECT_ADD), BM_CLICK, 0, 0);
    const HWND entry = tool.DialogWith(IDC_IP_OCTET1);
    ASSERT_NE(entry, nullptr);
    texts += e2e::ShownTexts(entry);

    // Beside the test, in code page 932: the English run's are converted
    // from what it reads wide, so a text it reads wrongly differs.
    const std::string shown = base::Cp932From(texts), written = "window-texts-932.txt";
    if (JapaneseRun())
    {
        EXPECT_NE(texts.find(L"/510 SysTabControl32: キーコンフィグ\n"), std::wstring::npos);
        testing_support::WriteBytes(written, {shown.begin(), shown.end()});
        return;
    }
    const std::vector<std::uint8_t> japanese = testing_support::ReadBytes(written);
    EXPECT_EQ(shown, std::string(japanese.begin(), japanese.end()));
}

TEST(AnySystem, TypedTextIsKeptInCodePage932AndPathsInTheSystemsCodePage)
{
    // What a player types into a field, and what the field then holds: the
    // same in the edit and in the file. A character the field's code page
    // cannot hold is refused, never kept as a stand-in ('e' for é, '?').
    const bool japanese = JapaneseRun();
    struct Typed
    {
        int id;
        const wchar_t* keys;
        const char* kept;        // code page 932, or the system's for a path
        const char* keptIn1252;  // a path's, where the code pages differ
        bool refusedWithMessage; // in this run's code page
    };
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
    const HWND dialog = tool.MainDialog();
    ASSERT_NE(dialog, nullptr);
    for (const Typed& t : typed)
    {
        const HWND edit = e2e::FindControl(dialog, t.id);
        for (const wchar_t* key = t.keys; *key != L'\0'; ++key)
            PostMessageW(edit, WM_CHAR, *key, 1);
        if (t.refusedWithMessage)
        {
            EXPECT_EQ(tool.AnswerMessageBox(IDOK).text,
                      "このパスには、このシステムの文字コードで表せない文字が含まれているため、"
                      "ゲームが開けません。\n別の名前のファイルかフォルダーを選んでください。");
        }
        const std::wstring shown =
            t.keptIn1252 != nullptr ? base::WideFromAnsi(kept(t)) : base::WideFrom932(kept(t));
        EXPECT_TRUE(e2e::WaitFor([&] { return e2e::WideText(edit) == shown; })) << t.id;
    }

    e2e::PostCommand(dialog, IDOK);
    tool.AnswerMessageBox(IDYES);
    EXPECT_EQ(tool.ExitCode(), 0u);
    config::CSaveConfig saved;
    ASSERT_TRUE(saved.LoadFromPath(folder.SettingsFile().c_str()));
    const config::UserBgmRow* rows = saved.UserBgm()->rows;
    const config::RadioChatEntry* messages = saved.RadioChat()->entries;
    const char* const held[] = {messages[0].text,         messages[1].text,  messages[2].text,
                                saved.Network()->lobbyId, rows[0].musicPath, rows[1].musicPath,
                                rows[2].musicPath};
    for (std::size_t i = 0; i < std::size(typed); ++i)
        EXPECT_EQ(held[i], kept(typed[i])) << typed[i].id;
}
