// Keys and buttons assigned as a user assigns them: VEKConfig.exe started on
// its own, the key-config tab and an action's edit clicked with the real
// mouse, a real key pressed, the file saved. Only real X events reach DirectInput, so
// the clicks and the key come from xdotool on the Linux side.
#include "config/save_config.h"
#include "resources/resource.h"
#include "tests/e2e/tool_driver.h"

#include <algorithm>
#include <commctrl.h>
#include <gtest/gtest.h>
#include <string>

using e2e::ToolProcess;
using e2e::WindowText;

namespace
{

constexpr char kXdotool[] = "Z:\\usr\\bin\\xdotool";

// Starts xdotool with `arguments`. Wine cannot wait for a Unix program, so
// callers wait for what it does to the tool instead.
bool Xdotool(const std::string& arguments)
{
    std::string command = std::string(kXdotool) + " " + arguments;
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

bool ClickAt(POINT screen)
{
    return Xdotool("mousemove " + std::to_string(screen.x) + " " + std::to_string(screen.y) +
                   " click 1");
}

template <typename Predicate> bool WaitFor(Predicate predicate, DWORD timeoutMs = 10000)
{
    const DWORD start = GetTickCount();
    while (!predicate())
    {
        if (GetTickCount() - start > timeoutMs)
            return false;
        Sleep(20);
    }
    return true;
}

// A tab's item in screen coordinates. TCM_GETITEMRECT writes through its
// pointer in the tool's own process, so the rectangle is lent from there.
RECT TabItemOnScreen(HWND tab, int index)
{
    RECT rect = {};
    DWORD processId = 0;
    GetWindowThreadProcessId(tab, &processId);
    HANDLE process =
        OpenProcess(PROCESS_VM_OPERATION | PROCESS_VM_READ | PROCESS_VM_WRITE, FALSE, processId);
    if (process == nullptr)
        return rect;
    void* lent = VirtualAllocEx(process, nullptr, sizeof rect, MEM_COMMIT, PAGE_READWRITE);
    if (lent != nullptr &&
        SendMessageA(tab, TCM_GETITEMRECT, index, reinterpret_cast<LPARAM>(lent)) != 0)
    {
        ReadProcessMemory(process, lent, &rect, sizeof rect, nullptr);
        MapWindowPoints(tab, nullptr, reinterpret_cast<POINT*>(&rect), 2);
    }
    if (lent != nullptr)
        VirtualFreeEx(process, lent, 0, MEM_RELEASE);
    CloseHandle(process);
    return rect;
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
    if (!GetGUIThreadInfo(GetWindowThreadProcessId(window, nullptr), &info))
        return nullptr;
    return info.hwndFocus;
}

// Clicks a tab near its left end (the right end may lie under the scroll
// arrows) and waits until `shown` is visible.
testing::AssertionResult ClickTab(HWND tab, int index, HWND shown)
{
    const RECT item = TabItemOnScreen(tab, index);
    if (item.left >= item.right)
        return testing::AssertionFailure() << "no rectangle for tab " << index;
    const LONG x = item.left + std::min<LONG>(12, (item.right - item.left) / 2);
    if (!ClickAt({x, (item.top + item.bottom) / 2}))
        return testing::AssertionFailure() << "xdotool cannot be started";
    if (!WaitFor([&] { return IsWindowVisible(shown) != FALSE; }))
        return testing::AssertionFailure() << "tab " << index << " did not show its page";
    return testing::AssertionSuccess();
}

testing::AssertionResult ClickEdit(HWND dialog, HWND edit)
{
    if (!ClickAt(CentreOf(edit)))
        return testing::AssertionFailure() << "xdotool cannot be started";
    if (!WaitFor([&] { return FocusOf(dialog) == edit; }))
        return testing::AssertionFailure() << "the edit did not take the focus";
    return testing::AssertionSuccess();
}

// Held long enough for the tool's polls to see it go down, then let go.
testing::AssertionResult PressKey(const std::string& key, HWND edit, const std::string& shows)
{
    if (!Xdotool("keydown " + key + " sleep 0.5 keyup " + key))
        return testing::AssertionFailure() << "xdotool cannot be started";
    if (!WaitFor([&] { return WindowText(edit) == shows; }))
        return testing::AssertionFailure() << "the edit shows " << WindowText(edit);
    return testing::AssertionSuccess();
}

// The tool on its key-config page, opened with the mouse.
class KeyConfigPage : public testing::Test
{
protected:
    void SetUp() override
    {
        dialog_ = tool_.WaitForMainDialog();
        ASSERT_NE(dialog_, nullptr);
        // The dialog shows before its pages exist; the player list is filled last.
        ASSERT_TRUE(
            WaitFor([&] { return SendMessageA(Control(IDC_PAD_PLAYER), CB_GETCOUNT, 0, 0) == 4; }));
        const HWND keyTab = Control(IDC_KEY_TAB);
        ASSERT_TRUE(ClickTab(GetDlgItem(dialog_, IDC_MAIN_TAB), kKeyConfigTab, keyTab));
    }

    HWND Control(int id) { return e2e::FindControl(dialog_, id); }

    // Saves with 保存, closes with Yes and answers the file the tool wrote.
    std::vector<std::uint8_t> SaveAndClose()
    {
        tool_.PostCommand(dialog_, IDOK);
        EXPECT_EQ(tool_.AnswerMessageBox(IDYES).text,
                  "保存されました\nコンフィグツールを閉じますか？");
        DWORD exitCode = 1;
        EXPECT_TRUE(tool_.WaitForExit(exitCode));
        EXPECT_EQ(exitCode, 0u);
        return e2e::ReadFileBytes(folder_.SettingsFile());
    }

    static std::vector<std::uint8_t> Defaults(void (*change)(config::ConfigKeys& keys))
    {
        config::CSaveConfig record;
        record.ResetAll();
        change(*record.Keys());
        return record.SaveToBytes();
    }

    static constexpr int kKeyConfigTab = 5;
    e2e::SaveFolder folder_;
    ToolProcess tool_{folder_};
    HWND dialog_ = nullptr;
};

} // namespace

TEST_F(KeyConfigPage, PressingXOnActionFourteenTakesXFromActionSixteenAndSavesBoth)
{
    const HWND slide = Control(IDC_KEYBOARD_EDIT_FIRST + 14);
    const HWND shoot = Control(IDC_KEYBOARD_EDIT_FIRST + 16);
    EXPECT_EQ(WindowText(slide), "Z");
    EXPECT_EQ(WindowText(shoot), "X");

    ASSERT_TRUE(ClickEdit(dialog_, slide));
    ASSERT_TRUE(PressKey("x", slide, "X"));
    EXPECT_EQ(WindowText(shoot), "Z");
    EXPECT_TRUE(
        WaitFor([&] { return FocusOf(dialog_) == Control(IDC_KEYBOARD_EDIT_FIRST + 15); }, 2000))
        << "the focus moves on to action 15";

    const std::vector<std::uint8_t> file = SaveAndClose();
    config::CSaveConfig saved;
    ASSERT_TRUE(saved.LoadFromBytes(file.data(), file.size()));
    EXPECT_EQ(saved.Keys()->keyboardKeys[14], 0x2Du);
    EXPECT_EQ(saved.Keys()->keyboardKeys[16], 0x2Cu);
    EXPECT_EQ(file, Defaults(
                        [](config::ConfigKeys& keys)
                        {
                            keys.keyboardKeys[14] = 0x2D;
                            keys.keyboardKeys[16] = 0x2C;
                        }))
        << "nothing else changed";
}

TEST_F(KeyConfigPage, OnTheControllerPageTheKeyOfAnActionStandsInForItsButton)
{
    const HWND shoot = Control(IDC_PAD_EDIT_FIRST + 16);
    const HWND slide = Control(IDC_PAD_EDIT_FIRST + 14);
    ASSERT_TRUE(ClickTab(Control(IDC_KEY_TAB), 1, shoot));
    ASSERT_TRUE(ClickEdit(dialog_, shoot));
    // Z is slot 0's key for action 14: its button comes over to action 16.
    ASSERT_TRUE(PressKey("z", shoot, "BUTTON1"));
    EXPECT_EQ(WindowText(slide), "BUTTON3");
    EXPECT_TRUE(
        WaitFor([&] { return FocusOf(dialog_) == Control(IDC_PAD_EDIT_FIRST + 17); }, 2000));

    EXPECT_EQ(SaveAndClose(), Defaults(
                                  [](config::ConfigKeys& keys)
                                  {
                                      keys.padConfigs[0].buttons[14] = 16;
                                      keys.padConfigs[0].buttons[16] = 14;
                                  }));
}
