// How the pages are wired to the record: each control shows its field at
// start and writes it when the user changes it; the tabs show their pages,
// and every page fits its tab.
#include "config/fixed_text.h"
#include "resources/resource.h"
#include "tests/gui/gui_harness.h"

#include <cstring>
#include <windowsx.h>

using gui::RunningTool;

namespace
{

enum Kind
{
    kCheck,
    kInvertedCheck,
    kChoice,
    kSlider,
    kEdit
};

// By kind: the field's value at start, then the value the user changes it to.
// An inverted check box is checked while its field is 0.
const char* const kValues[][2] = {
    {"1", "0"}, {"0", "1"}, {"1", "0"}, {"-1230", "-20"}, {"4321", "18001"}};

// A field of the record; one wider than a number holds text.
struct Field
{
    std::uint8_t* data;
    std::size_t size;

    void Put(const std::string& value) const
    {
        const std::int32_t number = size > 4 ? 0 : std::stoi(value);
        std::memcpy(data, size > 4 ? value.c_str() : static_cast<const void*>(&number),
                    size > 4 ? value.size() + 1 : size);
    }
    std::string Get() const
    {
        std::int32_t number = 0;
        std::memcpy(&number, data, size > 4 ? 0 : size);
        return size > 4 ? config::FieldText(reinterpret_cast<const char*>(data), size)
                        : std::to_string(number);
    }
};

#define FIELD(member)                                                                              \
    [](config::CSaveConfig& r) {                                                                   \
        return Field{reinterpret_cast<std::uint8_t*>(&r.member), sizeof r.member};                 \
    }

struct Wiring
{
    int page;
    int id;
    Kind kind;
    Field (*field)(config::CSaveConfig&);
};

constexpr int kNetwork = 2;
constexpr int kChatRow = IDC_RADIO_CHAT_ROW_STEP * (config::kRadioChatCount - 1);
constexpr int kMusicRow = IDC_MUSIC_ROW_STEP * (config::kUserBgmRowCount - 1);

// One control of each kind on each page.
const Wiring kWirings[] = {
    {kGraphicsPageIndex, IDC_SCREEN_SIZE, kChoice, FIELD(Graphics()->screenSize)},
    {kGraphicsPageIndex, IDC_FULL_SCREEN, kCheck, FIELD(Graphics()->fullScreen)},
    {kGamePageIndex, IDC_CAPTURE_ENABLED, kCheck, FIELD(Game()->captureEnabled)},
    {kGamePageIndex, IDC_SE_VOLUME, kSlider, FIELD(Game()->seVolume)},
    {kGamePageIndex, IDC_LOCK_ON_TYPE, kChoice, FIELD(Game()->lockOnType)},
    {kNetwork, IDC_NETWORK_PLAY_BGM, kCheck, FIELD(Network()->playBgm)},
    {kNetwork, IDC_NETWORK_KEY_RESPONSE, kChoice, FIELD(Network()->keyResponse)},
    {kNetwork, IDC_NETWORK_PORT, kEdit, FIELD(Network()->port)},
    {kNetwork, IDC_NETWORK_DIRECT_ID, kEdit, FIELD(Network()->directId)},
    {kReplayPageIndex, IDC_SAVE_REPLAYS + 30, kCheck, FIELD(Replay()->replayLock[29])},
    {kRadioChatPageIndex, IDC_RADIO_CHAT_TEXT_FIRST + kChatRow, kEdit,
     FIELD(RadioChat()->entries[11].text)},
    {kRadioChatPageIndex, IDC_RADIO_CHAT_TO_ALL_FIRST + kChatRow, kInvertedCheck,
     FIELD(RadioChat()->entries[11].notToAll)},
    {kUserMusicPageIndex, IDC_MUSIC_PATH_FIRST + kMusicRow, kEdit,
     FIELD(UserBgm()->rows[9].musicPath)},
    {kUserMusicPageIndex, IDC_TENSION_PATH_FIRST + kMusicRow, kEdit,
     FIELD(UserBgm()->rows[9].tensionPath)},
};

// What the control shows, in the field's terms.
std::string Shows(HWND page, const Wiring& wiring)
{
    const bool checked = IsDlgButtonChecked(page, wiring.id) == BST_CHECKED;
    if (wiring.kind == kCheck || wiring.kind == kInvertedCheck)
        return checked == (wiring.kind == kCheck) ? "1" : "0";
    if (wiring.kind == kEdit)
        return gui::ControlText(page, wiring.id);
    const UINT get = wiring.kind == kChoice ? CB_GETCURSEL : TBM_GETPOS;
    return std::to_string(SendDlgItemMessageA(page, wiring.id, get, 0, 0));
}

// The user's change: the control takes its new state and tells its page.
void Change(HWND page, const Wiring& wiring)
{
    const HWND control = GetDlgItem(page, wiring.id);
    const char* value = kValues[wiring.kind][1];
    if (wiring.kind == kChoice)
        ComboBox_SetCurSel(control, std::stoi(value));
    else if (wiring.kind == kSlider)
        SendMessageA(control, TBM_SETPOS, TRUE, std::stoi(value));
    else if (wiring.kind == kEdit)
        SetWindowTextA(control, value); // a single-line edit tells its page by itself
    else
        Button_SetCheck(control, BST_UNCHECKED); // every box starts checked
    if (wiring.kind == kSlider)
        SendMessageA(page, WM_HSCROLL, TB_THUMBPOSITION, reinterpret_cast<LPARAM>(control));
    else if (wiring.kind != kEdit)
        gui::Notify(page, wiring.id, wiring.kind == kChoice ? CBN_SELCHANGE : BN_CLICKED);
}

} // namespace

TEST(Pages, EachControlShowsItsFieldAtStartAndWritesItWhenChanged)
{
    RunningTool tool(
        [](config::CSaveConfig& record)
        {
            for (const Wiring& wiring : kWirings)
                wiring.field(record).Put(kValues[wiring.kind][0]);
        });
    for (const Wiring& wiring : kWirings)
        EXPECT_EQ(Shows(tool.Page(wiring.page), wiring), kValues[wiring.kind][0]) << wiring.id;
    for (const Wiring& wiring : kWirings)
    {
        Change(tool.Page(wiring.page), wiring);
        EXPECT_EQ(wiring.field(tool.Record()).Get(), kValues[wiring.kind][1]) << wiring.id;
    }
}

TEST(Pages, ATabShowsItsPageAloneAndTheKeyTabItsSubPage)
{
    RunningTool tool;
    for (int index : {6, 2, kKeyConfigPageIndex})
    {
        gui::ClickTab(tool.App().MainTab(), index);
        for (int other = 0; other < kPageCount; ++other)
            EXPECT_EQ(IsWindowVisible(tool.Page(other)) != FALSE, other == index) << other;
    }
    gui::ClickTab(tool.App().KeyTab(), kPadPageIndex);
    EXPECT_TRUE(IsWindowVisible(tool.KeyPage(kPadPageIndex)));
    EXPECT_FALSE(IsWindowVisible(tool.KeyPage(kKeyboardPageIndex)));
}

TEST(Pages, EveryVisibleControlOfEveryPageLiesInsideItsTab)
{
    RunningTool tool;
    for (int index = 0; index < kPageCount + kKeyPageCount; ++index)
    {
        const bool keyPage = index >= kPageCount;
        const HWND page = keyPage ? tool.KeyPage(index - kPageCount) : tool.Page(index);
        const HWND tab = keyPage ? tool.App().KeyTab() : tool.App().MainTab();
        RECT inside, rect, both;
        GetClientRect(tab, &inside);
        MapWindowPoints(tab, nullptr, reinterpret_cast<POINT*>(&inside), 2);
        for (HWND control = GetWindow(page, GW_CHILD); control;
             control = GetWindow(control, GW_HWNDNEXT))
        {
            GetWindowRect(control, &rect);
            UnionRect(&both, &inside, &rect);
            EXPECT_TRUE((GetWindowLongPtrA(control, GWL_STYLE) & WS_VISIBLE) == 0 ||
                        EqualRect(&both, &inside))
                << "control " << GetDlgCtrlID(control) << " of page " << index;
        }
    }
}
