// A key assigned as a user assigns it: VEKConfig.exe started on its own,
// the key-config tab and an action's edit clicked with the real mouse, a
// real key pressed, the file saved. Only real X events reach DirectInput, so
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

HWND FindControl(HWND dialog, int id)
{
    struct Search
    {
        int id;
        HWND found;
    } search{id, nullptr};
    EnumChildWindows(
        dialog,
        [](HWND window, LPARAM parameter) -> BOOL
        {
            auto* s = reinterpret_cast<Search*>(parameter);
            if (GetDlgCtrlID(window) != s->id)
                return TRUE;
            s->found = window;
            return FALSE;
        },
        reinterpret_cast<LPARAM>(&search));
    return search.found;
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

} // namespace

TEST(KeyCapture, PressingXOnActionFourteenTakesXFromActionSixteenAndSavesBoth)
{
    e2e::SaveFolder folder;
    ToolProcess tool(folder);
    const HWND dialog = tool.WaitForMainDialog();
    ASSERT_NE(dialog, nullptr);

    const HWND mainTab = GetDlgItem(dialog, IDC_MAIN_TAB);
    const RECT keyConfigTab = TabItemOnScreen(mainTab, 5);
    ASSERT_LT(keyConfigTab.left, keyConfigTab.right) << "no rectangle for the tab";
    // Near the left end: the tab may be cut off on the right by the scroll arrows.
    const LONG x =
        keyConfigTab.left + std::min<LONG>(12, (keyConfigTab.right - keyConfigTab.left) / 2);
    ASSERT_TRUE(ClickAt({x, (keyConfigTab.top + keyConfigTab.bottom) / 2})) << "xdotool missing";

    const HWND slide = FindControl(dialog, IDC_KEYBOARD_EDIT_FIRST + 14);
    const HWND guard = FindControl(dialog, IDC_KEYBOARD_EDIT_FIRST + 15);
    const HWND shoot = FindControl(dialog, IDC_KEYBOARD_EDIT_FIRST + 16);
    ASSERT_NE(slide, nullptr);
    ASSERT_TRUE(WaitFor([&] { return IsWindowVisible(slide) != FALSE; }))
        << "the key-config page did not come up";
    EXPECT_EQ(WindowText(slide), "Z");
    EXPECT_EQ(WindowText(shoot), "X");

    ASSERT_TRUE(ClickAt(CentreOf(slide)));
    ASSERT_TRUE(WaitFor([&] { return FocusOf(dialog) == slide; }));
    // Held long enough for the tool's polls to see it go down, then let go.
    ASSERT_TRUE(Xdotool("keydown x sleep 0.5 keyup x"));
    ASSERT_TRUE(WaitFor([&] { return WindowText(slide) == "X"; }));
    EXPECT_EQ(WindowText(shoot), "Z");
    EXPECT_TRUE(WaitFor([&] { return FocusOf(dialog) == guard; }, 2000))
        << "the focus moves on to action 15";

    tool.PostCommand(dialog, IDOK);
    const e2e::MessageBoxSeen saved = tool.AnswerMessageBox(IDYES);
    EXPECT_EQ(saved.text, "保存されました\nコンフィグツールを閉じますか？");
    DWORD exitCode = 1;
    ASSERT_TRUE(tool.WaitForExit(exitCode));
    EXPECT_EQ(exitCode, 0u);

    const std::vector<std::uint8_t> file = e2e::ReadFileBytes(folder.SettingsFile());
    config::CSaveConfig savedRecord;
    ASSERT_TRUE(savedRecord.LoadFromBytes(file.data(), file.size()));
    EXPECT_EQ(savedRecord.Keys()->keyboardKeys[14], 0x2Du);
    EXPECT_EQ(savedRecord.Keys()->keyboardKeys[16], 0x2Cu);
    config::CSaveConfig expected;
    expected.ResetAll();
    expected.Keys()->keyboardKeys[14] = 0x2D;
    expected.Keys()->keyboardKeys[16] = 0x2C;
    EXPECT_EQ(file, expected.SaveToBytes()) << "nothing else changed";
}
