// Controller frames from DirectInput and XInput: d-pad, thresholds, dead
// zones and the right stick's options.
#include "input/pad_frame.h"

#include <gtest/gtest.h>
#include <vector>

using namespace input;

namespace
{

std::vector<int> SetEntries(const PadFrame& frame)
{
    std::vector<int> entries;
    for (int i = 0; i < kPadFrameSize; ++i)
    {
        if (frame.flags[i] != 0)
            entries.push_back(i);
    }
    return entries;
}

DIJOYSTATE2 CentredJoystick()
{
    DIJOYSTATE2 state = {};
    state.rgdwPOV[0] = 0xFFFFFFFF;
    return state;
}

std::vector<int> FrameOf(DIJOYSTATE2& state, RightStickOptions options = {})
{
    PadFrame frame = {};
    FillFrameFromJoystick(state, options, frame);
    return SetEntries(frame);
}

std::vector<int> FrameOf(XINPUT_GAMEPAD& pad, RightStickOptions options = {})
{
    PadFrame frame = {};
    FillFrameFromXInput(pad, options, frame);
    return SetEntries(frame);
}

using Entries = std::vector<int>;

TEST(JoystickFrame, PovDirectionsIncludeTheirDiagonalsAndCentredSetsNothing)
{
    struct Case
    {
        std::uint32_t pov;
        Entries expected;
    };
    const Case cases[] = {
        {0xFFFF, {}},
        {0xFFFFFFFF, {}},
        {0, {kDpadUp}},
        {4499, {kDpadUp}},
        {4500, {kDpadUp, kDpadRight}},
        {4501, {kDpadRight}},
        {13500, {kDpadDown, kDpadRight}},
        {18000, {kDpadDown}},
        {22500, {kDpadDown, kDpadLeft}},
        {27000, {kDpadLeft}},
        {31500, {kDpadUp, kDpadLeft}},
        {31501, {kDpadUp}},
        {35999, {kDpadUp}},
    };
    for (const Case& c : cases)
    {
        DIJOYSTATE2 state = CentredJoystick();
        state.rgdwPOV[0] = c.pov;
        EXPECT_EQ(FrameOf(state), c.expected) << "POV " << c.pov;
    }
}

TEST(JoystickFrame, LeftStickCountsBeyond500AndZeroesBelow100)
{
    struct Case
    {
        std::int32_t value;
        Entries fromY;
        Entries fromX;
        std::int32_t stored;
    };
    const Case cases[] = {
        {-501, {kLeftStickUp}, {kLeftStickLeft}, -501},
        {-500, {}, {}, -500},
        {500, {}, {}, 500},
        {501, {kLeftStickDown}, {kLeftStickRight}, 501},
        {-100, {}, {}, -100},
        {-99, {}, {}, 0},
        {99, {}, {}, 0},
        {100, {}, {}, 100},
    };
    for (const Case& c : cases)
    {
        DIJOYSTATE2 vertical = CentredJoystick();
        vertical.lY = c.value;
        EXPECT_EQ(FrameOf(vertical), c.fromY) << "lY " << c.value;
        EXPECT_EQ(vertical.lY, c.stored) << "lY " << c.value;

        DIJOYSTATE2 horizontal = CentredJoystick();
        horizontal.lX = c.value;
        EXPECT_EQ(FrameOf(horizontal), c.fromX) << "lX " << c.value;
        EXPECT_EQ(horizontal.lX, c.stored) << "lX " << c.value;
    }
}

TEST(JoystickFrame, RightStickTakesTheFurtherDeflectedAxisPair)
{
    struct Case
    {
        std::int32_t z, rz, rx, ry;
        std::int32_t storedZ, storedRz;
        Entries expected;
    };
    const Case cases[] = {
        {0, 0, 300, -700, 300, -700, {kRightStickUp}},
        {800, 0, -300, 0, 800, 0, {kRightStickRight}},
        {-600, 600, 600, -600, -600, 600, {kRightStickDown, kRightStickLeft}},
        {0, 50, 0, 99, 0, 0, {}},
    };
    for (const Case& c : cases)
    {
        DIJOYSTATE2 state = CentredJoystick();
        state.lZ = c.z;
        state.lRz = c.rz;
        state.lRx = c.rx;
        state.lRy = c.ry;
        EXPECT_EQ(FrameOf(state), c.expected);
        EXPECT_EQ(state.lZ, c.storedZ);
        EXPECT_EQ(state.lRz, c.storedRz);
    }
}

TEST(JoystickFrame, RightStickSwapsBeforeItInverts)
{
    struct Case
    {
        RightStickOptions options;
        std::int32_t storedZ, storedRz;
        Entries expected;
    };
    // The stick is pushed right: lZ 600.
    const Case cases[] = {
        {{false, false, false}, 600, 0, {kRightStickRight}},
        {{true, false, false}, 0, 600, {kRightStickDown}},
        {{false, false, true}, -600, 0, {kRightStickLeft}},
        {{true, true, false}, 0, -600, {kRightStickUp}},
        {{false, true, false}, 600, 0, {kRightStickRight}},
    };
    for (const Case& c : cases)
    {
        DIJOYSTATE2 state = CentredJoystick();
        state.lZ = 600;
        EXPECT_EQ(FrameOf(state, c.options), c.expected);
        EXPECT_EQ(state.lZ, c.storedZ);
        EXPECT_EQ(state.lRz, c.storedRz);
    }
}

TEST(JoystickFrame, EachOfThe36ButtonsSetsOnlyItsOwnEntry)
{
    for (int button = 0; button < kJoyFrameButtons; ++button)
    {
        DIJOYSTATE2 state = CentredJoystick();
        // Buttons past the 32 the layer keeps as 0 or 1 arrive as the
        // device reports them.
        state.rgbButtons[button] = button < 32 ? 1 : 0x80;
        EXPECT_EQ(FrameOf(state), Entries{JoyButtonCode(button)}) << "button " << button;
    }
    DIJOYSTATE2 state = CentredJoystick();
    state.rgbButtons[36] = 0x80;
    EXPECT_EQ(FrameOf(state), Entries{});
}

TEST(XInputFrame, ThumbsRestInside6000AndPointFrom16383)
{
    struct Case
    {
        std::int16_t value;
        std::int16_t stored;
        Entries fromX;
        Entries fromY;
    };
    const Case cases[] = {
        {6000, 0, {}, {}},
        {-6000, 0, {}, {}},
        {6001, 6001, {}, {}},
        {16382, 16382, {}, {}},
        {16383, 16383, {kLeftStickRight}, {kLeftStickUp}},
        {-16382, -16382, {}, {}},
        {-16383, -16383, {kLeftStickLeft}, {kLeftStickDown}},
    };
    for (const Case& c : cases)
    {
        XINPUT_GAMEPAD horizontal = {};
        horizontal.sThumbLX = c.value;
        EXPECT_EQ(FrameOf(horizontal), c.fromX) << "sThumbLX " << c.value;
        EXPECT_EQ(horizontal.sThumbLX, c.stored);

        XINPUT_GAMEPAD vertical = {};
        vertical.sThumbLY = c.value;
        EXPECT_EQ(FrameOf(vertical), c.fromY) << "sThumbLY " << c.value;
        EXPECT_EQ(vertical.sThumbLY, c.stored);
    }
}

TEST(XInputFrame, TriggersPressFrom128)
{
    const std::pair<std::uint8_t, Entries> cases[] = {
        {0, {}}, {127, {}}, {128, {kButton5}}, {255, {kButton5}}};
    for (const auto& [value, expected] : cases)
    {
        XINPUT_GAMEPAD left = {};
        left.bLeftTrigger = value;
        EXPECT_EQ(FrameOf(left), expected) << "left " << int(value);

        XINPUT_GAMEPAD right = {};
        right.bRightTrigger = value;
        Entries expectedRight = expected.empty() ? Entries{} : Entries{kButton6};
        EXPECT_EQ(FrameOf(right), expectedRight) << "right " << int(value);
    }
}

TEST(XInputFrame, RightStickDirectionsKeepXInputsSignAndFollowTheOptions)
{
    struct Case
    {
        std::int16_t rx, ry;
        RightStickOptions options;
        std::int16_t storedRx, storedRy;
        Entries expected;
    };
    const Case cases[] = {
        {0, 20000, {}, 0, 20000, {kRightStickDown}},
        {0, -20000, {}, 0, -20000, {kRightStickUp}},
        {-20000, 0, {}, -20000, 0, {kRightStickLeft}},
        {20000, 0, {true, false, false}, 0, 20000, {kRightStickDown}},
        {20000, 0, {true, true, false}, 0, -20000, {kRightStickUp}},
        {20000, 0, {false, false, true}, -20000, 0, {kRightStickLeft}},
        {0, 6000, {true, false, false}, 0, 0, {}},
        // Fully down, inverted, is fully up rather than wrapping around.
        {-32768, -32768, {false, true, true}, 32767, 32767, {kRightStickDown, kRightStickRight}},
    };
    for (const Case& c : cases)
    {
        XINPUT_GAMEPAD pad = {};
        pad.sThumbRX = c.rx;
        pad.sThumbRY = c.ry;
        EXPECT_EQ(FrameOf(pad, c.options), c.expected) << c.rx << ", " << c.ry;
        EXPECT_EQ(pad.sThumbRX, c.storedRx);
        EXPECT_EQ(pad.sThumbRY, c.storedRy);
    }
}

} // namespace
