// The device layer on the real DirectInput and XInput: start-up on a
// window, its failure messages, and XInput loaded at run time.
#include "input/input.h"

#include <cstring>
#include <gtest/gtest.h>
#include <string>
#include <vector>

using namespace input;

namespace
{

struct ShownBox
{
    std::string caption;
    std::string text;
};

std::vector<ShownBox> shownBoxes;
HHOOK boxHook = nullptr;

// Answers every message box of this thread with OK and records it.
LRESULT CALLBACK RecordBox(int code, WPARAM wParam, LPARAM lParam)
{
    if (code == HCBT_ACTIVATE)
    {
        const auto box = reinterpret_cast<HWND>(wParam);
        char className[32] = {};
        ::GetClassNameA(box, className, sizeof className);
        if (std::string(className) == "#32770")
        {
            char caption[256] = {};
            char text[256] = {};
            ::GetWindowTextA(box, caption, sizeof caption);
            ::GetDlgItemTextA(box, 0xFFFF, text, sizeof text);
            shownBoxes.push_back({caption, text});
            ::PostMessageA(box, WM_COMMAND, MAKEWPARAM(IDOK, BN_CLICKED), 0);
        }
    }
    return ::CallNextHookEx(boxHook, code, wParam, lParam);
}

class DeviceLayer : public testing::Test
{
protected:
    DeviceLayer()
    {
        shownBoxes.clear();
        boxHook = ::SetWindowsHookExA(WH_CBT, RecordBox, nullptr, ::GetCurrentThreadId());
        window = ::CreateWindowExA(0, "STATIC", "input test", WS_OVERLAPPEDWINDOW, 0, 0, 320, 240,
                                   nullptr, nullptr, instance, nullptr);
    }
    ~DeviceLayer() override
    {
        ::DestroyWindow(window);
        ::UnhookWindowsHookEx(boxHook);
    }

    HINSTANCE instance = ::GetModuleHandleA(nullptr);
    HWND window = nullptr;
};

TEST_F(DeviceLayer, StartsOnAWindowWithKeyboardAndMouseAndNoController)
{
    ASSERT_NE(window, nullptr);
    CInput in;
    const InputWindow bound = {instance, window};
    ASSERT_TRUE(in.Init(&bound));
    EXPECT_TRUE(shownBoxes.empty());
    EXPECT_EQ(in.GetJoystickCount(), 0);
    EXPECT_EQ(in.GetJoystickInfo(0), nullptr);
    for (int n = 0; n < 3; ++n)
        in.Update();
    EXPECT_EQ(in.GetSlot(0).analogValid, 0u);
    EXPECT_EQ(in.GetSlot(0).xinputAllowed, 1u);
    in.Release();
    in.Release();
}

// The build plants an xinput1_3.dll beside the tests that claims a pad is
// attached; no controller is attached where the tests run.
TEST_F(DeviceLayer, XInputComesFromTheSystemFolderNotFromBesideTheProgram)
{
    CXInputPad pad;
    ASSERT_TRUE(pad.Init(0));
    EXPECT_FALSE(pad.Poll());
    char loaded[MAX_PATH] = {};
    char system[MAX_PATH] = {};
    ASSERT_NE(::GetModuleFileNameA(::GetModuleHandleA("xinput1_3.dll"), loaded, MAX_PATH), 0u);
    ::GetSystemDirectoryA(system, MAX_PATH);
    EXPECT_EQ(::CompareStringA(LOCALE_INVARIANT, NORM_IGNORECASE, loaded,
                               static_cast<int>(std::strlen(system)), system, -1),
              CSTR_EQUAL)
        << loaded;
    EXPECT_TRUE(pad.SetVibration(100, 200));
}

TEST_F(DeviceLayer, NoWindowObjectFailsWithoutAMessage)
{
    CInput in;
    EXPECT_FALSE(in.Init(nullptr));
    EXPECT_TRUE(shownBoxes.empty());
}

TEST_F(DeviceLayer, AKeyboardThatCannotBindToTheWindowIsReported)
{
    CInput in;
    const InputWindow unbound = {instance, nullptr};
    EXPECT_FALSE(in.Init(&unbound));
    ASSERT_EQ(shownBoxes.size(), 1u);
    EXPECT_EQ(shownBoxes[0].caption, "Error");
    EXPECT_EQ(shownBoxes[0].text, "DirectInput8\nキーボードの協調設定に失敗しました");
}

TEST_F(DeviceLayer, ADirectInputThatCannotBeCreatedIsReported)
{
    CInput in;
    const InputWindow noInstance = {nullptr, window};
    EXPECT_FALSE(in.Init(&noInstance));
    ASSERT_EQ(shownBoxes.size(), 1u);
    EXPECT_EQ(shownBoxes[0].caption, "Error");
    EXPECT_EQ(shownBoxes[0].text, "DirectInput8オブジェクトの生成に失敗しました");
}

} // namespace
