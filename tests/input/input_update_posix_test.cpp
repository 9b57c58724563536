// The whole input update, driven through the stand-in devices: what each
// slot sees of the keyboard, the mouse and the controllers, and captures
// on live input.
#include "input/input.h"
#include "input/key_assignment.h"
#include "input/virtual_devices_posix.h"

#include <cstring>
#include <gtest/gtest.h>
#include <memory>

using namespace input;
using virtual_devices::Devices;

namespace
{

constexpr std::uint8_t kW = 0x11;
constexpr std::uint8_t kZ = 0x2C;
constexpr int kLeftUpButton = kFirstVirtualButton + 4;

class InputUpdate : public testing::Test
{
protected:
    InputUpdate() { virtual_devices::ResetDevices(); }
    ~InputUpdate() override { virtual_devices::ResetDevices(); }

    CInput& Start()
    {
        input = std::make_unique<CInput>();
        EXPECT_TRUE(input->Init(&window));
        return *input;
    }

    static int AttachJoystick(const char* name, bool setUpFails = false)
    {
        const int index = Devices().joystickCount++;
        std::strcpy(Devices().joysticks[index].name, name);
        Devices().joysticks[index].setUpFails = setUpFails;
        Devices().joysticks[index].state.rgdwPOV[0] = 0xFFFFFFFF;
        return index;
    }

    static void ConnectPad(int user, XINPUT_GAMEPAD pad = {})
    {
        Devices().xinputConnected[user] = true;
        Devices().xinput[user].Gamepad = pad;
    }

    InputWindow window = {reinterpret_cast<void*>(0x400000), reinterpret_cast<void*>(0x1234)};
    std::unique_ptr<CInput> input;
};

TEST_F(InputUpdate, InitNeedsAWindow)
{
    CInput bare;
    EXPECT_FALSE(bare.Init(nullptr));
}

TEST_F(InputUpdate, WithoutControllersSlotsReadOnlyKeyboardAndMouse)
{
    CInput& in = Start();
    Devices().mouse.rgbButtons[1] = 0x80;
    Devices().mouse.lZ = 120;
    in.Update();
    EXPECT_EQ(in.GetJoystickCount(), 0);
    EXPECT_EQ(in.GetJoystickInfo(0), nullptr);
    for (std::uint8_t s = 0; s < kSlotCount; ++s)
    {
        EXPECT_EQ(in.GetSlot(s).analogValid, 0u) << "slot " << int(s);
        EXPECT_FLOAT_EQ(in.GetSlot(s).leftAngle, 90.0f);
        EXPECT_EQ(in.GetSlot(s).xinputAllowed, s < 4 ? 1u : 0u);
        EXPECT_EQ(in.GetSlot(s).pressed[1], 1u);
        EXPECT_EQ(in.GetSlot(s).pressed[kWheelUpButton], 1u);
    }
}

TEST_F(InputUpdate, AHeldKeyPressesOnceOnEverySlotAndReleasesOnce)
{
    CInput& in = Start();
    const bool down[] = {true, true, true, false, false};
    int n = 0;
    for (bool isDown : down)
    {
        Devices().keys[kW] = isDown ? 0x80 : 0;
        in.Update();
        SCOPED_TRACE("update " + std::to_string(n));
        for (std::uint8_t s : {0, 7, 15})
        {
            const InputSlot& slot = in.GetSlot(s);
            EXPECT_EQ(slot.pressed[kLeftUpButton], n == 0 ? 1u : 0u);
            EXPECT_EQ(slot.held[kLeftUpButton], isDown ? 1u : 0u);
            EXPECT_EQ(slot.released[kLeftUpButton], n == 3 ? 1u : 0u);
            EXPECT_FLOAT_EQ(slot.leftY, isDown ? -1.0f : 0.0f);
            EXPECT_EQ(in.IsTriggered(s, kLeftUpButton), n == 0 ? 1u : 0u);
        }
        EXPECT_EQ(in.IsKeyTriggered(kW), n == 0 ? 1 : 0);
        ++n;
    }
}

TEST_F(InputUpdate, InTheBackgroundKeysReadAsReleasedUntilTheWindowIsActiveAgain)
{
    CInput& in = Start();
    Devices().keys[kZ] = 0x80;
    in.Update();
    Devices().foreground = false;
    in.Update();
    EXPECT_EQ(in.GetSlot(0).released[kFirstVirtualButton + 14], 1u);
    EXPECT_EQ(in.IsKeyTriggered(kZ), 0);
    Devices().foreground = true;
    in.Update();
    EXPECT_EQ(in.GetSlot(0).pressed[kFirstVirtualButton + 14], 1u);
    EXPECT_EQ(in.IsKeyTriggered(kZ), 1);
}

TEST_F(InputUpdate, ADirectInputControllerFeedsItsSlotsSticksAndButtons)
{
    AttachJoystick("Pad A");
    CInput& in = Start();
    DIJOYSTATE2& state = Devices().joysticks[0].state;
    state.lX = 1000;
    state.lY = -999;
    state.lRx = 50;
    state.lRy = 700;
    state.rgbButtons[0] = 0x80;
    state.rgdwPOV[0] = 4500;
    in.Update();

    const InputSlot& slot = in.GetSlot(0);
    EXPECT_EQ(slot.analogValid, 1u);
    EXPECT_FLOAT_EQ(slot.leftX, 1.0f);
    EXPECT_FLOAT_EQ(slot.leftY, -0.99f);
    EXPECT_FLOAT_EQ(slot.rightX, 0.0f);
    EXPECT_FLOAT_EQ(slot.rightY, 0.7f);
    for (int code : {0, 3, 4, 7, 10, 14})
        EXPECT_EQ(slot.current[kFirstVirtualButton + code], 1u) << "code " << code;
    EXPECT_EQ(in.GetJoyButton(0, 0), 1);
    EXPECT_STREQ(in.GetJoystickInfo(0)->tszInstanceName, "Pad A");
    EXPECT_EQ(in.GetSlot(1).analogValid, 0u);
}

TEST_F(InputUpdate, AControllerWhoseSetUpFailedKeepsItsNumber)
{
    AttachJoystick("Broken", true);
    AttachJoystick("Pad B");
    CInput& in = Start();
    in.Update();
    EXPECT_EQ(in.GetJoystickCount(), 2);
    EXPECT_EQ(in.GetJoystickInfo(0), nullptr);
    EXPECT_EQ(in.GetJoystickState(0), nullptr);
    EXPECT_STREQ(in.GetJoystickInfo(1)->tszInstanceName, "Pad B");
    EXPECT_EQ(in.GetSlot(0).analogValid, 0u);
    EXPECT_EQ(in.GetSlot(1).analogValid, 1u);
}

TEST_F(InputUpdate, AnXInputPadServesTheFirstSlotAndGivesAnalogValues)
{
    XINPUT_GAMEPAD pad = {};
    pad.sThumbLX = 32767;
    pad.sThumbLY = 32767;
    pad.sThumbRX = 5000;
    pad.wButtons = XINPUT_GAMEPAD_A;
    ConnectPad(0, pad);
    CInput& in = Start();
    in.Update();
    const InputSlot& slot = in.GetSlot(0);
    EXPECT_EQ(slot.analogValid, 1u);
    EXPECT_FLOAT_EQ(slot.leftX, 1.0f);
    EXPECT_FLOAT_EQ(slot.leftY, -1.0f);
    EXPECT_FLOAT_EQ(slot.rightX, 0.0f);
    EXPECT_EQ(slot.current[kFirstVirtualButton + 14], 1u);
    EXPECT_EQ(slot.current[kLeftUpButton], 1u);
    EXPECT_EQ(in.GetSlot(1).current[kFirstVirtualButton + 14], 0u);
}

// A slot reads the pad numbered by the answers before it, so without pad 0
// every slot asks pad 0 and pad 1 goes unread.
TEST_F(InputUpdate, SlotsTakeTheAnsweringPadsInTurnFromPadZero)
{
    XINPUT_GAMEPAD a = {};
    a.wButtons = XINPUT_GAMEPAD_A;
    XINPUT_GAMEPAD b = {};
    b.wButtons = XINPUT_GAMEPAD_B;
    ConnectPad(1, b);
    CInput& in = Start();
    in.Update();
    for (std::uint8_t s = 0; s < kSlotCount; ++s)
        EXPECT_EQ(in.GetSlot(s).current[kFirstVirtualButton + 15], 0u) << "slot " << int(s);

    ConnectPad(0, a);
    in.Update();
    EXPECT_EQ(in.GetSlot(0).current[kFirstVirtualButton + 14], 1u);
    EXPECT_EQ(in.GetSlot(1).current[kFirstVirtualButton + 15], 1u);
    EXPECT_EQ(in.GetSlot(2).analogValid, 0u);
}

TEST_F(InputUpdate, VibrationIsSentBeforeItDecays)
{
    ConnectPad(0);
    CInput& in = Start();
    in.SetFrameTime(16);
    InputSlot& slot = in.GetSlot(0);
    slot.vibrationLeft = 1000;
    slot.vibrationRight = 2000;
    in.Update();
    EXPECT_EQ(Devices().vibration[0].wLeftMotorSpeed, 1000);
    EXPECT_EQ(Devices().vibration[0].wRightMotorSpeed, 2000);
    EXPECT_EQ(slot.vibrationLeft, 680);
    EXPECT_EQ(slot.vibrationRight, 1680);

    slot.vibrationLeft = 0;
    slot.vibrationRight = 0;
    in.Update();
    EXPECT_EQ(Devices().vibration[0].wLeftMotorSpeed, 0);
    EXPECT_EQ(Devices().vibration[0].wRightMotorSpeed, 0);
}

TEST_F(InputUpdate, OnTheKeyboardPageALiveKeyPressIsCaptured)
{
    CInput& in = Start();
    config::ConfigKeys keys = {};
    keys.keyboardKeys[16] = 0x2D;
    keys.keyboardKeys[14] = kZ;
    Devices().keys[0x2D] = 0x80;
    in.Update();
    std::int8_t focused = 14;
    ApplyKeyCapture(DecideKeyCapture(keys, focused, in), keys, focused);
    EXPECT_EQ(keys.keyboardKeys[14], 0x2Du);
    EXPECT_EQ(keys.keyboardKeys[16], kZ);
    EXPECT_EQ(focused, 15);

    // Still held at the next poll: not a new press.
    in.Update();
    ApplyKeyCapture(DecideKeyCapture(keys, focused, in), keys, focused);
    EXPECT_EQ(focused, 15);
}

TEST_F(InputUpdate, OnTheControllerPageKeyZStandsInForTheButtonOfAction14)
{
    CInput& in = Start();
    config::PadConfig player = {};
    for (int action = 0; action < kActionCount; ++action)
        player.buttons[action] = static_cast<std::uint32_t>(action);
    BindPlayerToSlot(player, in.GetSlot(0));
    Devices().keys[kZ] = 0x80;
    in.Update();
    std::int8_t focused = 16;
    ApplyPadCapture(DecidePadCapture(player, focused, in), player, in.GetSlot(0), focused);
    EXPECT_EQ(player.buttons[16], 14u);
    EXPECT_EQ(player.buttons[14], 16u);
    EXPECT_EQ(focused, 17);
}

TEST_F(InputUpdate, AButtonHeldAfterItsCaptureDoesNotPressTheNextAction)
{
    AttachJoystick("Pad A");
    CInput& in = Start();
    config::PadConfig player = {};
    for (int action = 0; action < kActionCount; ++action)
        player.buttons[action] = static_cast<std::uint32_t>(action);
    BindPlayerToSlot(player, in.GetSlot(0));

    Devices().joysticks[0].state.rgbButtons[12] = 0x80;
    in.Update();
    std::int8_t focused = 14;
    ApplyPadCapture(DecidePadCapture(player, focused, in), player, in.GetSlot(0), focused);
    EXPECT_EQ(player.buttons[14], 24u);
    EXPECT_EQ(focused, 15);

    for (int n = 0; n < 3; ++n)
    {
        in.Update();
        EXPECT_EQ(in.GetSlot(0).pressed[kFirstVirtualButton + 14], 0u);
        const Capture again = DecidePadCapture(player, focused, in);
        EXPECT_FALSE(again.happened);
    }
}

} // namespace
