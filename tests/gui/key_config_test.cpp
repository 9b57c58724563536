// The keyboard and controller sub-pages of the key-config page: their
// templates, what they show of the record, the reset buttons, the player
// and controller lists and the focused action.
#include "input/input.h"
#include "input/name_tables.h"
#include "resources/resource.h"
#include "tests/gui/gui_harness.h"

#include <cstring>
#include <gtest/gtest.h>

using gui::RunningTool;
using gui::WindowText;

namespace
{

constexpr int kActions = config::kActionCount;

struct Placement
{
    int action;
    POINT label;
    POINT edit;
};

// Where each page shows its actions, in dialog units.
const Placement kKeyboardPlacements[] = {
    {4, {4, 9}, {56, 6}},         {5, {119, 9}, {171, 6}},      {6, {4, 34}, {56, 31}},
    {7, {119, 34}, {171, 31}},    {14, {4, 59}, {56, 56}},      {15, {119, 59}, {171, 56}},
    {16, {4, 84}, {56, 81}},      {17, {119, 84}, {171, 81}},   {19, {4, 109}, {56, 106}},
    {21, {119, 109}, {171, 106}}, {18, {4, 134}, {56, 131}},    {20, {119, 134}, {171, 131}},
    {8, {4, 159}, {56, 156}},     {23, {119, 159}, {171, 156}}, {22, {4, 184}, {56, 181}},
};
const Placement kPadPlacements[] = {
    {14, {4, 32}, {60, 29}},      {15, {115, 32}, {171, 29}},   {16, {4, 62}, {60, 59}},
    {17, {115, 62}, {171, 59}},   {19, {4, 93}, {60, 90}},      {21, {115, 93}, {171, 90}},
    {18, {4, 122}, {60, 119}},    {20, {115, 122}, {171, 119}}, {8, {4, 152}, {60, 149}},
    {23, {115, 152}, {171, 149}}, {22, {4, 182}, {60, 179}},
};

struct Label
{
    int action;
    const char* text;
};

const Label kSomeLabels[] = {
    {0, "使用しない"},         {4, "移動上"}, {8, "カメラ正面"},         {13, "使用しない"},
    {15, "ガード/キャンセル"}, {21, "下降"},  {22, "メニュー/スタート"}, {23, "命令変更"},
};

struct PageLayout
{
    int keyPage;
    int firstEdit;
    int firstLabel;
    const Placement* placements;
    int placementCount;
};

const PageLayout kLayouts[] = {
    {kKeyboardPageIndex, IDC_KEYBOARD_EDIT_FIRST, IDC_KEYBOARD_LABEL_FIRST, kKeyboardPlacements,
     static_cast<int>(std::size(kKeyboardPlacements))},
    {kPadPageIndex, IDC_PAD_EDIT_FIRST, IDC_PAD_LABEL_FIRST, kPadPlacements,
     static_cast<int>(std::size(kPadPlacements))},
};

// A control's place and size in the page's dialog units, as pixels.
RECT Expected(HWND page, int x, int y, int width, int height)
{
    RECT rect = {x, y, width, height};
    MapDialogRect(page, &rect);
    return rect;
}

RECT Actual(HWND page, HWND control)
{
    RECT rect;
    GetWindowRect(control, &rect);
    MapWindowPoints(nullptr, page, reinterpret_cast<POINT*>(&rect), 2);
    return {rect.left, rect.top, rect.right - rect.left, rect.bottom - rect.top};
}

void ExpectAt(HWND page, int id, int x, int y, int width, int height)
{
    const HWND control = GetDlgItem(page, id);
    ASSERT_NE(control, nullptr) << id;
    const RECT expected = Expected(page, x, y, width, height);
    const RECT actual = Actual(page, control);
    EXPECT_EQ(actual.left, expected.left) << id;
    EXPECT_EQ(actual.top, expected.top) << id;
    EXPECT_EQ(actual.right, expected.right) << id << " width";
    if (height != 0)
    {
        EXPECT_EQ(actual.bottom, expected.bottom) << id << " height";
    }
}

LONG_PTR Style(HWND page, int id)
{
    return GetWindowLongPtrA(GetDlgItem(page, id), GWL_STYLE);
}

// A record unlike the defaults everywhere the pages look: every player has
// its own buttons and controller, and some codes carry high bytes.
config::CSaveConfig Shuffled()
{
    config::CSaveConfig record;
    record.ResetAll();
    config::ConfigKeys& keys = *record.Keys();
    for (int action = 0; action < kActions; ++action)
    {
        keys.keyboardKeys[action] = 0x10 + action;
        for (int player = 0; player < config::kPlayerCount; ++player)
            keys.padConfigs[player].buttons[action] = (action + 5 * player + 1) % 48;
    }
    for (int player = 0; player < config::kPlayerCount; ++player)
        keys.padConfigs[player].device = static_cast<std::uint8_t>(9 - player);
    return record;
}

std::string PadEdit(RunningTool& tool, int action)
{
    return WindowText(tool.Control(tool.KeyPage(kPadPageIndex), IDC_PAD_EDIT_FIRST + action));
}

void ExpectPlayerShown(RunningTool& tool, const config::PadConfig& player)
{
    const input::InputSlot& slot = tool.App().Input()->GetSlot(0);
    for (int action = 0; action < kActions; ++action)
    {
        EXPECT_EQ(PadEdit(tool, action), input::PadButtonName(player.buttons[action] & 0xFF))
            << action;
        EXPECT_EQ(slot.joyMap[action], player.buttons[action]) << action;
        EXPECT_EQ(slot.xinputMap[action], player.buttons[action]) << action;
    }
    EXPECT_EQ(slot.joystickIndex, player.device);
}

} // namespace

TEST(KeyPages, EveryActionHasItsEditAndLabelShownWhereThePageOffersItAndHiddenElsewhere)
{
    RunningTool tool;
    for (const PageLayout& layout : kLayouts)
    {
        const HWND page = tool.KeyPage(layout.keyPage);
        bool shown[kActions] = {};
        for (int i = 0; i < layout.placementCount; ++i)
        {
            const Placement& at = layout.placements[i];
            shown[at.action] = true;
            ExpectAt(page, layout.firstEdit + at.action, at.edit.x, at.edit.y, 50, 14);
            ExpectAt(page, layout.firstLabel + at.action, at.label.x, at.label.y,
                     at.action == 15 ? 55 : 50, 8);
        }
        for (int action = 0; action < kActions; ++action)
        {
            const int edit = layout.firstEdit + action;
            const LONG_PTR style = Style(page, edit);
            const LONG_PTR editStyle = ES_READONLY | ES_CENTER | ES_AUTOHSCROLL | WS_TABSTOP;
            EXPECT_EQ(style & editStyle, editStyle) << edit;
            // The edit draws its border itself and drops WS_BORDER for it.
            EXPECT_TRUE(
                (style & WS_BORDER) != 0 ||
                (GetWindowLongPtrA(GetDlgItem(page, edit), GWL_EXSTYLE) & WS_EX_CLIENTEDGE) != 0)
                << edit;
            EXPECT_EQ((style & WS_VISIBLE) != 0, shown[action]) << edit;
            EXPECT_EQ((style & WS_DISABLED) != 0, !shown[action]) << edit;
            if (shown[action])
                continue;
            ExpectAt(page, edit, 4, 200, 50, 14);
            if (action == 3)
            {
                EXPECT_EQ(GetDlgItem(page, layout.firstLabel + 3), nullptr);
                continue;
            }
            ExpectAt(page, layout.firstLabel + action, 4, 200, 50, 8);
            EXPECT_EQ(Style(page, layout.firstLabel + action) & (WS_VISIBLE | WS_DISABLED),
                      WS_DISABLED);
        }
    }
}

TEST(KeyPages, TheButtonsAndListsStandWhereTheyBelong)
{
    RunningTool tool;
    const HWND keyboard = tool.KeyPage(kKeyboardPageIndex);
    const HWND pad = tool.KeyPage(kPadPageIndex);
    ExpectAt(keyboard, IDC_KEYBOARD_RESET, 157, 200, 64, 14);
    ExpectAt(pad, IDC_PAD_RESET, 157, 200, 64, 14);
    ExpectAt(pad, IDC_PAD_PLAYER_LABEL, 4, 10, 50, 8);
    ExpectAt(pad, IDC_PAD_PLAYER, 60, 6, 50, 0);
    ExpectAt(pad, IDC_PAD_DEVICE_LABEL, 115, 182, 50, 8);
    ExpectAt(pad, IDC_PAD_DEVICE, 171, 179, 50, 0);
    EXPECT_EQ(WindowText(GetDlgItem(keyboard, IDC_KEYBOARD_RESET)), "デフォルト設定に戻す");
    EXPECT_EQ(WindowText(GetDlgItem(pad, IDC_PAD_RESET)), "デフォルト設定に戻す");
    EXPECT_EQ(WindowText(GetDlgItem(pad, IDC_PAD_PLAYER_LABEL)), "プレイヤー番号");
    EXPECT_EQ(WindowText(GetDlgItem(pad, IDC_PAD_DEVICE_LABEL)), "使用パッド");
    for (int list : {IDC_PAD_PLAYER, IDC_PAD_DEVICE})
        EXPECT_EQ(Style(pad, list) & 0x3, CBS_DROPDOWNLIST) << list;
}

TEST(KeyPages, BothPagesShowTheLabelsAndTheNamesOfTheRecordsCodes)
{
    config::CSaveConfig record = Shuffled();
    config::ConfigKeys& keys = *record.Keys();
    // Only the low byte names a code; codes without a name show nothing.
    keys.keyboardKeys[14] = 0x12D;
    keys.keyboardKeys[15] = 0xFD;
    keys.padConfigs[0].buttons[16] = 0x30E;
    keys.padConfigs[0].buttons[17] = 200;
    RunningTool tool(record.SaveToBytes());
    const HWND keyboard = tool.KeyPage(kKeyboardPageIndex);
    const HWND pad = tool.KeyPage(kPadPageIndex);

    EXPECT_EQ(WindowText(GetDlgItem(keyboard, IDC_KEYBOARD_EDIT_FIRST + 14)), "X");
    EXPECT_EQ(WindowText(GetDlgItem(keyboard, IDC_KEYBOARD_EDIT_FIRST + 15)), "");
    EXPECT_EQ(PadEdit(tool, 16), "BUTTON1");
    EXPECT_EQ(PadEdit(tool, 17), "");
    for (int action = 0; action < kActions; ++action)
    {
        EXPECT_EQ(WindowText(GetDlgItem(keyboard, IDC_KEYBOARD_EDIT_FIRST + action)),
                  input::KeyName(keys.keyboardKeys[action] & 0xFF))
            << action;
    }
    for (const Label& label : kSomeLabels)
    {
        EXPECT_EQ(WindowText(GetDlgItem(keyboard, IDC_KEYBOARD_LABEL_FIRST + label.action)),
                  label.text);
        EXPECT_EQ(WindowText(GetDlgItem(pad, IDC_PAD_LABEL_FIRST + label.action)), label.text);
    }
    ExpectPlayerShown(tool, keys.padConfigs[0]);
    EXPECT_EQ(tool.Record().SaveToBytes(), record.SaveToBytes()) << "showing changes nothing";
}

TEST(KeyPages, TheKeyboardResetRestoresTheDefaultKeysAndNothingElse)
{
    const config::CSaveConfig shuffled = Shuffled();
    RunningTool tool(shuffled.SaveToBytes());
    tool.Click(tool.KeyPage(kKeyboardPageIndex), IDC_KEYBOARD_RESET);

    config::CSaveConfig expected(shuffled);
    expected.ResetKeyboardKeys();
    EXPECT_EQ(tool.Record().SaveToBytes(), expected.SaveToBytes());
    const HWND keyboard = tool.KeyPage(kKeyboardPageIndex);
    EXPECT_EQ(WindowText(GetDlgItem(keyboard, IDC_KEYBOARD_EDIT_FIRST + 14)), "Z");
    EXPECT_EQ(WindowText(GetDlgItem(keyboard, IDC_KEYBOARD_EDIT_FIRST + 23)), "SPACE");
}

TEST(KeyPages, WithoutControllersTheControllerListIsEmptyAndThePlayersAreListed)
{
    RunningTool tool;
    if (tool.App().Input()->GetJoystickCount() != 0)
        GTEST_SKIP() << "a controller is attached here";
    const HWND pad = tool.KeyPage(kPadPageIndex);
    EXPECT_EQ(SendDlgItemMessageA(pad, IDC_PAD_DEVICE, CB_GETCOUNT, 0, 0), 0);
    EXPECT_EQ(SendDlgItemMessageA(pad, IDC_PAD_DEVICE, CB_GETCURSEL, 0, 0), CB_ERR);
    ASSERT_EQ(SendDlgItemMessageA(pad, IDC_PAD_PLAYER, CB_GETCOUNT, 0, 0), 4);
    const char* const players[] = {"1P", "2P", "3P", "4P"};
    for (int index = 0; index < 4; ++index)
    {
        char text[8] = {};
        SendDlgItemMessageA(pad, IDC_PAD_PLAYER, CB_GETLBTEXT, index,
                            reinterpret_cast<LPARAM>(text));
        EXPECT_STREQ(text, players[index]);
    }
    EXPECT_EQ(SendDlgItemMessageA(pad, IDC_PAD_PLAYER, CB_GETCURSEL, 0, 0), 0);
}

TEST(KeyPages, ChoosingAPlayerShowsItsButtonsAndLetsSlotZeroReadItsController)
{
    const config::CSaveConfig shuffled = Shuffled();
    RunningTool tool(shuffled.SaveToBytes());
    const HWND pad = tool.KeyPage(kPadPageIndex);
    for (int player : {2, 1, 3, 0})
    {
        tool.Choose(pad, IDC_PAD_PLAYER, player);
        EXPECT_EQ(tool.App().SelectedPlayer(), static_cast<std::uint32_t>(player));
        ExpectPlayerShown(tool, shuffled.Keys()->padConfigs[player]);
    }
    EXPECT_EQ(tool.Record().SaveToBytes(), shuffled.SaveToBytes());
}

TEST(KeyPages, TheControllerResetRestoresOnlyTheShownPlayerAndItsOwnController)
{
    const config::CSaveConfig shuffled = Shuffled();
    RunningTool tool(shuffled.SaveToBytes());
    const HWND pad = tool.KeyPage(kPadPageIndex);
    tool.Choose(pad, IDC_PAD_PLAYER, 2);
    tool.Click(pad, IDC_PAD_RESET);

    config::CSaveConfig expected(shuffled);
    expected.ResetPadButtons(2);
    EXPECT_EQ(tool.Record().SaveToBytes(), expected.SaveToBytes());
    EXPECT_EQ(tool.Record().Keys()->padConfigs[2].device, 2);
    ExpectPlayerShown(tool, expected.Keys()->padConfigs[2]);
    EXPECT_EQ(PadEdit(tool, 14), "BUTTON1");
    if (tool.App().Input()->GetJoystickCount() <= 2)
    {
        EXPECT_EQ(SendDlgItemMessageA(pad, IDC_PAD_DEVICE, CB_GETCURSEL, 0, 0), CB_ERR)
            << "3P's controller is not attached";
    }
}

TEST(KeyPages, AListReportingNoSelectionChangesNeitherThePlayerNorItsController)
{
    const config::CSaveConfig shuffled = Shuffled();
    RunningTool tool(shuffled.SaveToBytes());
    const HWND pad = tool.KeyPage(kPadPageIndex);
    tool.Choose(pad, IDC_PAD_PLAYER, 1);
    tool.Choose(pad, IDC_PAD_PLAYER, -1);
    tool.Choose(pad, IDC_PAD_DEVICE, -1);
    EXPECT_EQ(tool.App().SelectedPlayer(), 1u);
    EXPECT_EQ(tool.Record().SaveToBytes(), shuffled.SaveToBytes());
    EXPECT_EQ(tool.App().Input()->GetSlot(0).joystickIndex, shuffled.Keys()->padConfigs[1].device);
}

TEST(KeyPages, TheEditTakingTheFocusNamesTheFocusedActionOnEitherPage)
{
    RunningTool tool;
    EXPECT_EQ(tool.App().FocusedAction(), 0);
    tool.ClickTab(kKeyConfigPageIndex);
    SetFocus(tool.Control(tool.KeyPage(kKeyboardPageIndex), IDC_KEYBOARD_EDIT_FIRST + 14));
    tool.Pump();
    EXPECT_EQ(tool.App().FocusedAction(), 14);

    tool.ClickKeyTab(kPadPageIndex);
    EXPECT_EQ(tool.App().FocusedAction(), 14) << "switching sub-pages keeps the action";
    SetFocus(tool.Control(tool.KeyPage(kPadPageIndex), IDC_PAD_EDIT_FIRST + 23));
    tool.Pump();
    EXPECT_EQ(tool.App().FocusedAction(), 23);
    SetFocus(tool.Control(tool.KeyPage(kPadPageIndex), IDC_PAD_PLAYER));
    tool.Pump();
    EXPECT_EQ(tool.App().FocusedAction(), 23) << "only the edits name an action";
}
