// The whole input update on the stand-in devices: what a slot makes of the
// keyboard, the mouse and the controllers, and captures on live input.
#include "config/config_sections.h"
#include "input/input.h"
#include "input/key_assignment.h"
#include "input/virtual_devices_posix.h"

#include <cstring>
#include <gtest/gtest.h>

using namespace input;
using virtual_devices::Devices;

namespace
{

constexpr int kW = 0x11;
constexpr int kZ = 0x2C;

class InputUpdate : public testing::Test
{
protected:
    InputUpdate() { virtual_devices::ResetDevices(); }
    ~InputUpdate() override { virtual_devices::ResetDevices(); }

    // Starts with `joysticks` controllers, the first `broken` of them failing
    // their set-up.
    CInput& Start(int joysticks = 0, int broken = 0)
    {
        Devices().joystickCount = joysticks;
        for (int i = 0; i < joysticks; ++i)
        {
            std::strcpy(Devices().joysticks[i].name, "Pad");
            Devices().joysticks[i].setUpFails = i < broken;
            Devices().joysticks[i].state.rgdwPOV[0] = 0xFFFFFFFF;
        }
        EXPECT_TRUE(input.Init(&window));
        return input;
    }
    const InputWindow window = {reinterpret_cast<void*>(0x400000), reinterpret_cast<void*>(0x1234)};
    CInput input;
};

// Every slot reads the keyboard and the mouse. With a frame clock a held key
// counts its time from the update after its press.
TEST_F(InputUpdate, AHeldKeyPressesOnceOnEverySlotCountsItsTimeAndSteersTheStick)
{
    CInput& in = Start();
    in.SetFrameTime(16);
    Devices().mouse.rgbButtons[1] = 0x80;
    Devices().mouse.lZ = 6; // one notch exactly
    Devices().cursorY = -5;
    const int w = kFirstVirtualButton + 4;
    const std::uint32_t held[] = {1, 1, 1, 0, 0}, heldTime[] = {0, 16, 32, 0, 0};
    for (int n = 0; n < 5; ++n)
    {
        Devices().keys[kW] = held[n] != 0 ? 0x80 : 0;
        Devices().cursorX = n == 0 ? 5.0f : 200.0f; // first inside the box around (0, 0)
        in.Update();
        EXPECT_EQ(in.IsKeyTriggered(kW), n == 0 ? 1 : 0);
        for (const std::uint8_t s : {3, 4})
        {
            const InputSlot& slot = in.GetSlot(s);
            EXPECT_EQ(slot.pressed[w] + 2 * slot.released[w], n == 0 ? 1u : n == 3 ? 2u : 0u);
            EXPECT_EQ(slot.heldTime[w], heldTime[n]) << n;
            EXPECT_EQ(slot.upTime[w], n == 4 ? 16u : 0u) << n;
            EXPECT_FLOAT_EQ(slot.leftY, held[n] != 0 ? -1.0f : 0.0f) << n;
            EXPECT_EQ(slot.pressed[1] + slot.current[kWheelUpButton], n == 0 ? 2u : 1u);
            EXPECT_FLOAT_EQ(slot.cursorDeltaX, n == 1 ? 195.0f : 0.0f) << "moved from (5, -5)";
            EXPECT_EQ(slot.xinputAllowed, s < 4 ? 1u : 0u);
        }
    }
    Devices().keys[kZ] = 0x80;
    in.Update();
    Devices().foreground = false;
    in.Update();
    EXPECT_EQ(in.GetSlot(0).released[kFirstVirtualButton + 14], 1u) << "in the background";
    Devices().foreground = true;
    in.Update();
    EXPECT_EQ(in.IsKeyTriggered(kZ), 1);
}

// Slots 0 to 3 ask the XInput pads in turn, each taking the pad numbered by
// the answers before it, so pad 1 goes unread without pad 0. A slot without
// an answer reads its DirectInput controller; one whose set-up failed keeps
// its number. Sticks truncate toward zero to hundredths, and the angle runs
// clockwise from up. The motors get the speed before its decay.
TEST_F(InputUpdate, ControllersFeedTheirSlots)
{
    CInput& in = Start(2, 1);
    DIJOYSTATE2& joystick = Devices().joysticks[1].state;
    joystick.lX = -999;
    joystick.lY = 999;
    joystick.lRy = 700;
    joystick.lRx = -600; // as given: no option of slot 1 inverts it
    joystick.rgbButtons[0] = 0x80;
    joystick.rgdwPOV[0] = 4500;
    Devices().xinputConnected[1] = true;
    Devices().xinput[1].Gamepad = {XINPUT_GAMEPAD_B, 0, 0, 0, 0, 0, 0};
    in.GetSlot(1).xinputMap[3] = 0xFF; // a controller read by DirectInput uses its own map
    EXPECT_EQ(in.GetJoystickState(1)->rgdwPOV[0], 0xFFFFFFFFu) << "released before its first read";
    in.Update();
    EXPECT_EQ(in.GetJoystickCount(), 2);
    EXPECT_TRUE(in.GetJoystickInfo(0) == nullptr && in.GetJoystickState(0) == nullptr);
    EXPECT_STREQ(in.GetJoystickInfo(1)->tszInstanceName, "Pad");
    EXPECT_EQ(in.GetJoyButton(1, 0) + in.GetJoyButton(1, 32) + in.GetJoyButton(16, 0), 1);
    const InputSlot& slot0 = in.GetSlot(0);
    const InputSlot& slot1 = in.GetSlot(1);
    EXPECT_EQ(slot0.analogValid, 0u);
    EXPECT_FLOAT_EQ(slot1.leftX, -0.99f);
    EXPECT_FLOAT_EQ(slot1.leftY, 0.99f);
    EXPECT_NEAR(slot1.leftAngle, 225.0f, 1e-3);
    EXPECT_NEAR(slot1.rightAngle, 220.6f, 1e-2);
    for (int code : {0, 3, 5, 6, 10, 11, 14})
        EXPECT_EQ(slot1.current[kFirstVirtualButton + code], 1u) << "code " << code;
    EXPECT_EQ(slot1.current[kFirstVirtualButton + 15], 0u) << "pad 1 is not read";

    Devices().xinputConnected[0] = true;
    Devices().xinput[0].Gamepad = {XINPUT_GAMEPAD_A, 0, 0, 32767, 32767, 0, 0};
    in.SetFrameTime(1000);
    in.GetSlot(0).vibrationLeft = 30000;
    in.GetSlot(0).vibrationRight = 20000;
    in.Update();
    EXPECT_EQ(slot0.current[kFirstVirtualButton + 14], 1u);
    EXPECT_FLOAT_EQ(slot0.leftX, 1.0f);
    EXPECT_FLOAT_EQ(slot0.leftY, -1.0f);
    EXPECT_EQ(slot1.current[kFirstVirtualButton + 15], 1u);
    EXPECT_EQ(slot1.current[kFirstVirtualButton + 14], 0u);
    EXPECT_EQ(in.GetSlot(2).analogValid, 0u);
    EXPECT_EQ(Devices().vibration[0].wLeftMotorSpeed, 30000);
    EXPECT_EQ(slot0.vibrationLeft, 10000);
    EXPECT_EQ(slot0.vibrationRight, 0);
    for (const int sent : {10000, 0}) // the left motor alone, then both at 0 stop the motors
    {
        in.Update();
        EXPECT_EQ(Devices().vibration[0].wLeftMotorSpeed, sent);
    }
    Devices().xinputConnected[0] = false;
    in.Update();
    EXPECT_EQ(slot0.analogValid, 0u) << "unplugged, with no controller of its own";
    Devices().foreground = false;
    in.Update();
    EXPECT_EQ(in.GetJoyButton(1, 0) * 2 + (in.GetJoystickState(1)->rgdwPOV[0] != 0xFFFFFFFFu), 0)
        << "released in the background, the POV centred";
}

TEST_F(InputUpdate, CapturesReadTheLiveDevices)
{
    CInput& in = Start(1);
    config::ConfigKeys keys = {};
    keys.keyboardKeys[16] = 0x30;
    for (int action = 0; action < kActionCount; ++action)
        keys.padConfigs[0].buttons[action] = static_cast<std::uint32_t>(action);
    BindPlayerToSlot(keys.padConfigs[0].buttons, 0, in.GetSlot(0));
    Devices().keys[0x30] = 0x80;
    Devices().joysticks[0].state.rgbButtons[12] = 0x80;
    in.Update();
    EXPECT_EQ(DecideKeyCapture(keys.keyboardKeys, 14, in).changes[1].code, 0x30u);
    EXPECT_EQ(DecidePadCapture(keys.padConfigs[0].buttons, 14, in).changes[0].code, 24u);
}

} // namespace
