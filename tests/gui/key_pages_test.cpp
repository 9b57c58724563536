// The key-config sub-pages' wiring: the record's codes shown, the player list,
// the resets, the tabs that show the pages and the edit naming the action.
// Capturing a real key press is a black-box run (tests/e2e).
#include "input/input.h"
#include "base/input_codes.h"
#include "resources/resource.h"
#include "tests/gui/gui_harness.h"

#include <windowsx.h>

using gui::ControlText;

TEST(KeyPages, ShowTheShownPlayersCodesResetThemAndNameTheFocusedActionWhenInView)
{
    const auto shuffle = [](config::CSaveConfig& record)
    {
        config::ConfigKeys& keys = *record.Keys();
        keys.keyboardKeys[14] = 0x2D;
        keys.padConfigs[0].buttons[16] = 14;
        keys.padConfigs[2].buttons[16] = 30;
        keys.padConfigs[2].device = 7;
    };
    gui::RunningTool tool(shuffle);
    const HWND keyboard = tool.KeyPageWindow(kKeyboardPageIndex);
    const HWND pad = tool.KeyPageWindow(kPadPageIndex);
    EXPECT_EQ(ControlText(keyboard, IDC_KEYBOARD_EDIT_FIRST + 14), input::KeyName(0x2D));
    EXPECT_EQ(ControlText(pad, IDC_PAD_EDIT_FIRST + 16), input::PadButtonName(14));

    ComboBox_SetCurSel(GetDlgItem(pad, IDC_PAD_PLAYER), 2);
    gui::Notify(pad, IDC_PAD_PLAYER, CBN_SELCHANGE);
    EXPECT_EQ(ControlText(pad, IDC_PAD_EDIT_FIRST + 16), input::PadButtonName(30));
    const input::InputSlot& slot = tool.Input()->GetSlot(0);
    EXPECT_EQ(slot.joyMap[16], 30u) << "slot 0 reads the shown player's buttons";
    EXPECT_EQ(slot.joystickIndex, 7);

    gui::Notify(keyboard, IDC_KEYBOARD_RESET);
    gui::Notify(pad, IDC_PAD_RESET);
    config::CSaveConfig expected;
    expected.ResetAll();
    shuffle(expected);
    expected.ResetKeyboardKeys();
    expected.ResetPadButtons(2);
    EXPECT_EQ(tool.Record()->SaveToBytes(), expected.SaveToBytes());
    EXPECT_EQ(ControlText(pad, IDC_PAD_EDIT_FIRST + 16),
              input::PadButtonName(expected.Keys()->padConfigs[2].buttons[16]));

    gui::ClickTab(tool.MainTab(), kKeyConfigPageIndex);
    for (int page = 0; page < kPageCount; ++page)
        EXPECT_EQ(IsWindowVisible(tool.PageWindow(page)) != FALSE, page == kKeyConfigPageIndex);
    SetFocus(GetDlgItem(keyboard, IDC_KEYBOARD_EDIT_FIRST + 14));
    EXPECT_EQ(tool.FocusedAction(), 14);
    gui::ClickTab(tool.KeyTab(), kPadPageIndex);
    EXPECT_TRUE(IsWindowVisible(pad) && !IsWindowVisible(keyboard));
    SetFocus(GetDlgItem(pad, IDC_PAD_EDIT_FIRST + 23));
    EXPECT_EQ(tool.FocusedAction(), 23);
}
