// What a slot makes of the devices: the controller frames of DirectInput and
// XInput, the sticks under the movement keys, and the names of keys and
// buttons.
#include "base/input_codes.h"
#include "input/input_slot.h"
#include "input/pad_frame.h"

#include <array>
#include <cstring>
#include <gtest/gtest.h>
#include <string>
#include <tuple>
#include <vector>

using namespace input;
using Entries = std::vector<int>;

namespace
{
Entries SetEntries(const PadFrame& frame)
{
    Entries entries;
    for (int i = 0; i < kPadFrameSize; ++i)
    {
        if (frame.flags[i] != 0)
            entries.push_back(i);
    }
    return entries;
}
} // namespace

// Axes are lX, lY, lZ, lRx, lRy, lRz, as given and as left behind: the dead
// zone, the choice of the right stick's pair, its swap and inversion.
TEST(JoystickFrame, DirectionsCountBeyond500AndAxesRestBelow100)
{
    constexpr std::uint32_t kCentred = 0xFFFFFFFF;
    using Axes = std::array<std::int32_t, 6>;
    const std::tuple<Axes, std::uint32_t, RightStickOptions, Entries, Axes> rows[] = {
        {{}, 0xFFFF, {}, {}, {}},
        {{}, 4500, {}, {kDpadUp, kDpadRight}, {}},
        {{}, 13500, {}, {kDpadDown, kDpadRight}, {}},
        {{}, 22500, {}, {kDpadDown, kDpadLeft}, {}},
        {{}, 31500, {}, {kDpadUp, kDpadLeft}, {}},
        {{0, -501}, kCentred, {}, {kLeftStickUp}, {0, -501}},
        {{-500, 500}, kCentred, {}, {}, {-500, 500}},
        {{501, 501}, kCentred, {}, {kLeftStickDown, kLeftStickRight}, {501, 501}},
        {{-501, 99}, kCentred, {}, {kLeftStickLeft}, {-501, 0}},
        {{100, -99}, kCentred, {}, {}, {100, 0}},
        {{0, 0, 0, 300, -700, 0}, kCentred, {}, {kRightStickUp}, {0, 0, 300, 300, -700, -700}},
        {{0, 0, 800, -300}, kCentred, {}, {kRightStickRight}, {0, 0, 800, -300}},
        {{0, 0, 0, 0, 99, 50}, kCentred, {}, {}, {0, 0, 0, 0, 99, 0}},
        {{0, 0, 600}, kCentred, {true, true, false}, {kRightStickUp}, {0, 0, 0, 0, 0, -600}},
        {{0, 0, 600}, kCentred, {false, false, true}, {kRightStickLeft}, {0, 0, -600}}};
    for (const auto& [a, pov, options, entries, after] : rows)
    {
        DIJOYSTATE2 state = {};
        std::memcpy(&state, a.data(), sizeof a); // lX to lRz lead the structure
        state.rgdwPOV[0] = pov;
        PadFrame frame = {};
        FillFrameFromJoystick(state, options, frame);
        EXPECT_EQ(SetEntries(frame), entries) << "POV " << pov << " lX " << a[0];
        EXPECT_EQ(std::memcmp(&state, after.data(), sizeof after), 0)
            << "POV " << pov << " lX " << a[0];
    }
}

// A button b feeds the entry named after it ("BUTTON" b + 1), except the
// stick pushes on buttons 10 and 11; those after the 36th feed nothing.
TEST(JoystickFrame, EachOfThe36ButtonsSetsTheEntryNamedAfterIt)
{
    for (int button = 0; button <= kJoyFrameButtons; ++button)
    {
        DIJOYSTATE2 state = {};
        state.rgdwPOV[0] = 0xFFFFFFFF;
        state.rgbButtons[button] = 0x80;
        PadFrame frame = {};
        FillFrameFromJoystick(state, {}, frame);
        std::string names;
        for (int entry : SetEntries(frame))
            names += PadButtonName(static_cast<std::uint8_t>(entry));
        const std::string name = button == 10   ? "LS_PUSH"
                                 : button == 11 ? "RS_PUSH"
                                                : "BUTTON" + std::to_string(button + 1);
        EXPECT_EQ(names, button < kJoyFrameButtons ? name : "") << button;
    }
}

// Triggers, then thumbs sThumbLX, sThumbLY, sThumbRX, sThumbRY as given and
// as left behind. XInput counts up as positive; the right stick keeps that.
TEST(XInputFrame, ThumbsRestUpTo6000AndPointFrom16383TriggersPressFrom128)
{
    using Thumbs = std::array<std::int16_t, 4>;
    using Row = std::tuple<std::uint8_t, std::uint8_t, Thumbs, RightStickOptions, Entries, Thumbs>;
    const Row rows[] = {
        {127, 128, {}, {}, {kButton6}, {}},
        {128, 127, {}, {}, {kButton5}, {}},
        {0, 0, {6000, -6000, 6001, -6001}, {}, {}, {0, 0, 6001, -6001}},
        {0, 0, {16382, -16382}, {}, {}, {16382, -16382}},
        {0, 0, {16383, 16383}, {}, {kLeftStickUp, kLeftStickRight}, {16383, 16383}},
        {0, 0, {-16383, -16383}, {}, {kLeftStickDown, kLeftStickLeft}, {-16383, -16383}},
        {0, 0, {0, 0, 0, 17000}, {}, {kRightStickDown}, {0, 0, 0, 17000}},
        {0, 0, {0, 0, 17000, 0}, {true, true, false}, {kRightStickUp}, {0, 0, 0, -17000}},
        {0, 0, {0, 0, 17000, 0}, {false, false, true}, {kRightStickLeft}, {0, 0, -17000, 0}},
        // Fully down, inverted, is fully up rather than wrapping around.
        {0, 0, {0, 0, -32768, 0}, {false, false, true}, {kRightStickRight}, {0, 0, 32767, 0}}};
    for (const auto& [left, right, t, options, entries, after] : rows)
    {
        XINPUT_GAMEPAD pad = {0, left, right, t[0], t[1], t[2], t[3]};
        PadFrame frame = {};
        FillFrameFromXInput(pad, options, frame);
        EXPECT_EQ(SetEntries(frame), entries) << t[0] << ", " << t[2];
        EXPECT_EQ((Thumbs{pad.sThumbLX, pad.sThumbLY, pad.sThumbRX, pad.sThumbRY}), after)
            << t[0] << ", " << t[2];
    }
}

TEST(SlotSticks, MovementKeysForceFullDeflection)
{
    using Axis = float InputSlot::*;
    const std::tuple<int, Axis, float> rows[] = {
        {4, &InputSlot::leftY, -1.0f},   {5, &InputSlot::leftY, 1.0f},
        {6, &InputSlot::leftX, -1.0f},   {7, &InputSlot::leftX, 1.0f},
        {9, &InputSlot::rightY, -1.0f},  {10, &InputSlot::rightY, 1.0f},
        {11, &InputSlot::rightX, -1.0f}, {12, &InputSlot::rightX, 1.0f},
        {13, &InputSlot::rightX, 0.5f}};
    for (const auto& [action, axis, value] : rows)
    {
        InputSlot slot = {};
        slot.analogValid = 1;
        slot.leftX = slot.leftY = slot.rightX = slot.rightY = 0.5f;
        slot.current[kFirstVirtualButton + action] = 1;
        ApplyDigitalOverrides(slot);
        EXPECT_EQ(slot.*axis, value) << action;
    }
}

// Where a key has several names the first is shown; codes without a key or
// beyond either table show nothing.
TEST(NameTables, KeysShowTheirPrimaryNamesAndPadCodesCountOnFromButton13)
{
    const std::pair<int, const char*> keys[] = {{0x00, ""},      {0x38, "LMENU"},       {0x54, ""},
                                                {0xC9, "PRIOR"}, {0xED, "MEDIASELECT"}, {0xEE, ""}};
    for (const auto& [code, name] : keys)
        EXPECT_STREQ(KeyName(static_cast<std::uint8_t>(code)), name) << code;
    EXPECT_STREQ(PadButtonName(63), "BUTTON52");
    EXPECT_STREQ(PadButtonName(64), "");
}
