// How the pages are wired to the record: each control shows its field at
// start and writes it when the user changes it; and every page fits its tab.
#include "resources/resource.h"
#include "tests/gui/gui_harness.h"

#include <cstdio>
#include <cstring>
#include <windowsx.h>

using gui::RunningTool;

namespace
{

// Kinds of control, by their row in kValues.
constexpr int kCheck = 0, kInvertedCheck = 1, kChoice = 2, kSlider = 3, kEdit = 4;

// By kind: the field's value at start, then the value the user changes it to.
// An inverted check box is checked while its field is 0.
constexpr int kValues[][2] = {{1, 0}, {0, 1}, {1, 0}, {-1230, -20}, {4321, 18001}};

// A field of the record; one wider than a number holds its number as text.
struct Field
{
    void* data;
    std::size_t size;

    void Put(int value) const
    {
        if (size > 4)
            std::snprintf(static_cast<char*>(data), size, "%d", value);
        else
            std::memcpy(data, &value, size);
    }
    int Get() const
    {
        int value = 0;
        std::memcpy(&value, data, size > 4 ? 0 : size);
        return size > 4 ? std::atoi(static_cast<const char*>(data)) : value;
    }
};

#define FIELD(m) [](config::CSaveConfig& r) { return Field{&r.m, sizeof r.m}; }

struct Wiring
{
    int page;
    int id;
    int kind;
    Field (*field)(config::CSaveConfig&);
};

constexpr int kChatRow = IDC_RADIO_CHAT_ROW_STEP * (config::kRadioChatCount - 1);
constexpr int kMusicRow = IDC_MUSIC_ROW_STEP * (config::kUserBgmRowCount - 1);

// One control of each kind on each page.
const Wiring kWirings[] = {
    {kGraphicsPageIndex, IDC_SCREEN_SIZE, kChoice, FIELD(Graphics()->screenSize)},
    {kGraphicsPageIndex, IDC_FULL_SCREEN, kCheck, FIELD(Graphics()->fullScreen)},
    {kGamePageIndex, IDC_CAPTURE_ENABLED, kCheck, FIELD(Game()->captureEnabled)},
    {kGamePageIndex, IDC_SE_VOLUME, kSlider, FIELD(Game()->seVolume)},
    {kGamePageIndex, IDC_LOCK_ON_TYPE, kChoice, FIELD(Game()->lockOnType)},
    {kNetworkPageIndex, IDC_NETWORK_PLAY_BGM, kCheck, FIELD(Network()->playBgm)},
    {kNetworkPageIndex, IDC_NETWORK_KEY_RESPONSE, kChoice, FIELD(Network()->keyResponse)},
    {kNetworkPageIndex, IDC_NETWORK_PORT, kEdit, FIELD(Network()->port)},
    {kReplayPageIndex, IDC_SAVE_REPLAYS + 30, kCheck, FIELD(Replay()->replayLock[29])},
    {kRadioChatPageIndex, IDC_RADIO_CHAT_TEXT_FIRST + kChatRow, kEdit,
     FIELD(RadioChat()->entries[11].text)},
    {kRadioChatPageIndex, IDC_RADIO_CHAT_TO_ALL_FIRST + kChatRow, kInvertedCheck,
     FIELD(RadioChat()->entries[11].notToAll)},
    {kUserMusicPageIndex, IDC_MUSIC_PATH_FIRST + kMusicRow, kEdit,
     FIELD(UserBgm()->rows[9].musicPath)},
};

// What the control shows, in the field's terms.
int Shows(HWND page, const Wiring& wiring)
{
    if (wiring.kind == kCheck || wiring.kind == kInvertedCheck)
        return (IsDlgButtonChecked(page, wiring.id) == BST_CHECKED) == (wiring.kind == kCheck);
    if (wiring.kind == kEdit)
        return std::atoi(gui::ControlText(page, wiring.id).c_str());
    const UINT get = wiring.kind == kChoice ? CB_GETCURSEL : TBM_GETPOS;
    return static_cast<int>(SendDlgItemMessageA(page, wiring.id, get, 0, 0));
}

// The user's change: the control takes its new state and tells its page.
void Change(HWND page, const Wiring& wiring)
{
    const HWND control = GetDlgItem(page, wiring.id);
    const int value = kValues[wiring.kind][1];
    if (wiring.kind == kChoice)
        ComboBox_SetCurSel(control, value);
    else if (wiring.kind == kSlider)
        SendMessageA(control, TBM_SETPOS, TRUE, value);
    else if (wiring.kind == kEdit) // a single-line edit tells its page by itself
        SetWindowTextA(control, std::to_string(value).c_str());
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
        EXPECT_EQ(Shows(tool.PageWindow(wiring.page), wiring), kValues[wiring.kind][0])
            << wiring.id;
    for (const Wiring& wiring : kWirings)
    {
        Change(tool.PageWindow(wiring.page), wiring);
        EXPECT_EQ(wiring.field(*tool.Record()).Get(), kValues[wiring.kind][1]) << wiring.id;
    }
}

// Run at 96 dpi and again at 144 (150 %): whatever the scale, every control
// lies inside its page and every page inside its tab's display area.
TEST(Pages, EveryControlLiesInsideItsPageAndEveryPageInsideItsTab)
{
    char dpi[8] = "96"; // tools/wine-run's scale
    GetEnvironmentVariableA("VEK_WINE_DPI", dpi, sizeof dpi);
    EXPECT_EQ(GetDeviceCaps(GetDC(nullptr), LOGPIXELSY), std::atoi(dpi));
    RunningTool tool;
    const auto inside = [](HWND window, RECT outer)
    {
        RECT rect, both;
        GetWindowRect(window, &rect);
        UnionRect(&both, &rect, &outer);
        return EqualRect(&both, &outer) != FALSE;
    };
    for (int index = 0; index < kPageCount + kKeyPageCount; ++index)
    {
        const bool keyPage = index >= kPageCount;
        const HWND page = keyPage ? tool.KeyPageWindow(index - kPageCount) : tool.PageWindow(index);
        const HWND tab = keyPage ? tool.KeyTab() : tool.MainTab();
        RECT area, pageRect;
        GetClientRect(tab, &area);
        TabCtrl_AdjustRect(tab, FALSE, &area);
        MapWindowPoints(tab, nullptr, reinterpret_cast<POINT*>(&area), 2);
        EXPECT_TRUE(inside(page, area)) << "page " << index;
        GetWindowRect(page, &pageRect);
        for (HWND control = GetWindow(page, GW_CHILD); control;
             control = GetWindow(control, GW_HWNDNEXT))
            EXPECT_TRUE(inside(control, pageRect))
                << "control " << GetDlgCtrlID(control) << " of page " << index;
    }
}
