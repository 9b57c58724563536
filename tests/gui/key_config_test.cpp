// The keyboard and controller sub-pages of the key-config page: what they
// show of the record, the reset buttons, the player and controller lists and
// the focused action.
#include "input/input.h"
#include "input/name_tables.h"
#include "resources/resource.h"
#include "tests/gui/gui_harness.h"
#include "tests/gui/page_checks.h"

#include <gtest/gtest.h>

using gui::RunningTool;
using gui::WindowText;

namespace
{

constexpr int kActions = config::kActionCount;

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

std::string KeyboardEdit(RunningTool& tool, int action)
{
    return WindowText(
        tool.Control(tool.KeyPage(kKeyboardPageIndex), IDC_KEYBOARD_EDIT_FIRST + action));
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

TEST(KeyPages, BothPagesShowTheNamesOfTheRecordsCodes)
{
    config::CSaveConfig record = Shuffled();
    config::ConfigKeys& keys = *record.Keys();
    // Only the low byte names a code; codes without a name show nothing.
    keys.keyboardKeys[14] = 0x12D;
    keys.keyboardKeys[15] = 0xFD;
    keys.padConfigs[0].buttons[16] = 0x30E;
    keys.padConfigs[0].buttons[17] = 200;
    RunningTool tool(record.SaveToBytes());

    EXPECT_EQ(KeyboardEdit(tool, 14), "X");
    EXPECT_EQ(KeyboardEdit(tool, 15), "");
    EXPECT_EQ(PadEdit(tool, 16), "BUTTON1");
    EXPECT_EQ(PadEdit(tool, 17), "");
    for (int action = 0; action < kActions; ++action)
        EXPECT_EQ(KeyboardEdit(tool, action), input::KeyName(keys.keyboardKeys[action] & 0xFF))
            << action;
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
    EXPECT_EQ(KeyboardEdit(tool, 14), "Z");
    EXPECT_EQ(KeyboardEdit(tool, 23), "SPACE");
}

TEST(KeyPages, WithoutControllersTheControllerListIsEmptyAndThePlayersAreListed)
{
    RunningTool tool;
    if (tool.App().Input()->GetJoystickCount() != 0)
        GTEST_SKIP() << "a controller is attached here";
    const HWND pad = tool.KeyPage(kPadPageIndex);
    EXPECT_EQ(gui::ItemCount(pad, IDC_PAD_DEVICE), 0);
    EXPECT_EQ(gui::Selection(pad, IDC_PAD_DEVICE), CB_ERR);
    ASSERT_EQ(gui::ItemCount(pad, IDC_PAD_PLAYER), 4);
    for (int index = 0; index < 4; ++index)
        EXPECT_EQ(gui::ItemText(pad, IDC_PAD_PLAYER, index), std::to_string(index + 1) + "P");
    EXPECT_EQ(gui::Selection(pad, IDC_PAD_PLAYER), 0);
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
        EXPECT_EQ(gui::Selection(pad, IDC_PAD_DEVICE), CB_ERR) << "3P's controller is not attached";
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
