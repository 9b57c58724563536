// A key assigned as a user assigns it: VEKConfig.exe started on its own, the
// key-config tab and an action's edit clicked with the real mouse, a real key
// pressed, the file saved. Only real X events reach DirectInput, so the
// clicks and the key come from xdotool on the Linux side.
#include "config/save_config.h"
#include "resources/resource.h"
#include "tests/e2e/tool_driver.h"
#include "tests/support/temp_folder.h"

#include <algorithm>
#include <commctrl.h>
#include <gtest/gtest.h>
#include <utility>

namespace
{

constexpr int kKeyConfigTab = 5;

// Starts xdotool. Wine cannot wait for a Unix program, so the test waits for
// what it does to the tool instead.
bool Xdotool(const std::string& arguments)
{
    std::string command = "Z:\\usr\\bin\\xdotool " + arguments;
    STARTUPINFOA startup = {};
    startup.cb = sizeof startup;
    PROCESS_INFORMATION process = {};
    if (!CreateProcessA(nullptr, command.data(), nullptr, nullptr, FALSE, 0, nullptr, nullptr,
                        &startup, &process))
        return false;
    CloseHandle(process.hThread);
    CloseHandle(process.hProcess);
    return true;
}

bool ClickAt(POINT point)
{
    return Xdotool("mousemove " + std::to_string(point.x) + " " + std::to_string(point.y) +
                   " click 1");
}

// A tab's item on the screen, near its left end (the right end may lie under
// the scroll arrows). TCM_GETITEMRECT writes through its pointer in the
// tool's own process, so the rectangle is lent from there.
POINT TabItemOnScreen(HWND tab, int index)
{
    RECT rect = {};
    const e2e::LentMemory lent(tab, sizeof rect);
    if (SendMessageA(tab, TCM_GETITEMRECT, index, reinterpret_cast<LPARAM>(lent.Remote())) != 0)
        lent.Read(&rect, sizeof rect);
    MapWindowPoints(tab, nullptr, reinterpret_cast<POINT*>(&rect), 2);
    return {rect.left + std::min<LONG>(12, (rect.right - rect.left) / 2),
            (rect.top + rect.bottom) / 2};
}

POINT CentreOf(HWND window)
{
    RECT rect;
    GetWindowRect(window, &rect);
    return {(rect.left + rect.right) / 2, (rect.top + rect.bottom) / 2};
}

HWND FocusOf(HWND window)
{
    GUITHREADINFO info = {};
    info.cbSize = sizeof info;
    GetGUIThreadInfo(GetWindowThreadProcessId(window, nullptr), &info);
    return info.hwndFocus;
}

} // namespace

TEST(KeyCapture, PressingXOnActionFourteenTakesXFromActionSixteenAndSavesBoth)
{
    testing_support::TempSaveFolder folder;
    e2e::ToolProcess tool;
    const HWND dialog = tool.MainDialog();
    ASSERT_NE(dialog, nullptr);
    const auto edit = [&](int action)
    { return e2e::FindControl(dialog, IDC_KEYBOARD_EDIT_FIRST + action); };
    ASSERT_TRUE(ClickAt(TabItemOnScreen(GetDlgItem(dialog, IDC_MAIN_TAB), kKeyConfigTab)));
    ASSERT_TRUE(e2e::WaitFor([&] { return IsWindowVisible(edit(14)) != FALSE; }));
    ASSERT_TRUE(ClickAt(CentreOf(edit(14))));
    ASSERT_TRUE(e2e::WaitFor([&] { return FocusOf(dialog) == edit(14); }));

    // Held long enough for the tool's polls to see it go down.
    ASSERT_TRUE(Xdotool("keydown x sleep 0.5 keyup x"));
    EXPECT_TRUE(e2e::WaitFor([&] { return e2e::WindowText(edit(14)) == "X"; }));
    EXPECT_EQ(e2e::WindowText(edit(16)), "Z");
    EXPECT_TRUE(e2e::WaitFor([&] { return FocusOf(dialog) == edit(15); }, 2000))
        << "the focus moves on to action 15";

    e2e::PostCommand(dialog, IDOK);
    EXPECT_EQ(tool.AnswerMessageBox(IDYES).caption, "終了確認");
    EXPECT_EQ(tool.ExitCode(), 0u);
    config::CSaveConfig expected;
    expected.ResetAll();
    std::swap(expected.Keys()->keyboardKeys[14], expected.Keys()->keyboardKeys[16]);
    EXPECT_EQ(testing_support::ReadBytes(folder.SettingsFile()), expected.SaveToBytes());
}
