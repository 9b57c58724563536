// XInput on Windows: loaded from the system folder only.
#include "base/win32.h"
#include "input/xinput_pad.h"

#include <cstring>
#include <gtest/gtest.h>

// The build plants an xinput1_3.dll beside the tests that claims a pad is
// attached; no controller is attached where the tests run.
TEST(DeviceLayer, XInputComesFromTheSystemFolderNotFromBesideTheProgram)
{
    input::CXInputPad pad;
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
