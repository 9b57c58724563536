// One player slot: button edges and times, sticks, cursor, wheel and
// vibration.
#include "input/input_slot.h"

#include <cmath>
#include <gtest/gtest.h>
#include <string>

using namespace input;

namespace
{

InputSlot FreshSlot()
{
    InputSlot slot;
    ResetSlot(slot, 0, false);
    return slot;
}

// One update of button `b` alone.
void Step(InputSlot& slot, int b, bool down, std::uint32_t dt)
{
    BeginSlotUpdate(slot);
    slot.current[b] = down ? 1 : 0;
    UpdateButtonEdges(slot, dt);
}

TEST(SlotEdges, PressAndReleaseLastOneUpdateAndTimesCountFromTheUpdateAfter)
{
    struct Expected
    {
        bool down;
        std::uint32_t pressed, released, held, heldTime, up, upTime;
    };
    const Expected updates[] = {
        {false, 0, 0, 0, 0, 1, 16}, {true, 1, 0, 1, 0, 0, 0},  {true, 0, 0, 1, 16, 0, 0},
        {true, 0, 0, 1, 32, 0, 0},  {false, 0, 1, 0, 0, 1, 0}, {false, 0, 0, 0, 0, 1, 16},
        {false, 0, 0, 0, 0, 1, 32},
    };
    InputSlot slot = FreshSlot();
    const int b = kFirstVirtualButton + 14;
    int n = 0;
    for (const Expected& e : updates)
    {
        Step(slot, b, e.down, 16);
        SCOPED_TRACE("update " + std::to_string(n++));
        EXPECT_EQ(slot.pressed[b], e.pressed);
        EXPECT_EQ(slot.released[b], e.released);
        EXPECT_EQ(slot.held[b], e.held);
        EXPECT_EQ(slot.heldTime[b], e.heldTime);
        EXPECT_EQ(slot.up[b], e.up);
        EXPECT_EQ(slot.upTime[b], e.upTime);
    }
}

TEST(SlotEdges, WithoutAFrameClockTimesStayZero)
{
    InputSlot slot = FreshSlot();
    for (bool down : {true, true, true, false, false})
    {
        Step(slot, 3, down, 0);
        EXPECT_EQ(slot.heldTime[3], 0u);
        EXPECT_EQ(slot.upTime[3], 0u);
    }
}

TEST(SlotSticks, AxesTruncateTowardZeroToHundredthsWithinOne)
{
    const std::pair<float, float> cases[] = {
        {0.999f, 0.99f}, {-0.005f, 0.0f},    {-0.256f, -0.25f}, {0.5f, 0.5f},
        {1.5f, 1.0f},    {-1.00003f, -1.0f}, {0.0f, 0.0f},
    };
    for (const auto& [value, expected] : cases)
    {
        InputSlot slot = FreshSlot();
        slot.leftX = value;
        slot.rightY = value;
        FinishSticks(slot);
        EXPECT_FLOAT_EQ(slot.leftX, expected) << value;
        EXPECT_FLOAT_EQ(slot.rightY, expected) << value;
        EXPECT_FALSE(std::signbit(slot.leftX) && expected == 0.0f) << value;
    }
}

TEST(SlotSticks, AngleRunsClockwiseFromUpAndACentredStickPointsAt90)
{
    struct Case
    {
        float x, y;
        float angle, magnitude;
    };
    const Case cases[] = {
        {0.0f, 0.0f, 90.0f, 0.0f},       {0.0f, -1.0f, 0.0f, 1.0f},
        {1.0f, 0.0f, 90.0f, 1.0f},       {0.0f, 1.0f, 180.0f, 1.0f},
        {-1.0f, 0.0f, 270.0f, 1.0f},     {-1.0f, -1.0f, 315.0f, std::sqrt(2.0f)},
        {-0.004f, -0.004f, 90.0f, 0.0f}, {1.2f, 1.2f, 135.0f, std::sqrt(2.0f)},
    };
    for (const Case& c : cases)
    {
        InputSlot slot = FreshSlot();
        slot.leftX = slot.rightX = c.x;
        slot.leftY = slot.rightY = c.y;
        FinishSticks(slot);
        EXPECT_NEAR(slot.leftAngle, c.angle, 1e-4) << c.x << ", " << c.y;
        EXPECT_NEAR(slot.leftMagnitude, c.magnitude, 1e-5) << c.x << ", " << c.y;
        EXPECT_NEAR(slot.rightAngle, c.angle, 1e-4) << c.x << ", " << c.y;
    }
}

TEST(SlotCursor, SmallDriftReportsNothingUntilTheCursorLeavesItsBox)
{
    InputSlot slot = FreshSlot();
    FilterCursor(slot, 100.0f, 100.0f);
    FilterCursor(slot, 100.0f, 100.0f);
    const float expectedDeltaX[] = {0.0f, 3.0f, 3.0f, 3.0f};
    float x = 100.0f;
    for (float expected : expectedDeltaX)
    {
        x += 3.0f;
        FilterCursor(slot, x, 100.0f);
        EXPECT_FLOAT_EQ(slot.cursorDeltaX, expected) << "x " << x;
        EXPECT_FLOAT_EQ(slot.cursorDeltaY, 0.0f);
    }
}

TEST(SlotCursor, FirstUpdateReportsTheWholePositionAsMovement)
{
    InputSlot slot = FreshSlot();
    FilterCursor(slot, 200.0f, 150.0f);
    EXPECT_FLOAT_EQ(slot.cursorDeltaX, 200.0f);
    EXPECT_FLOAT_EQ(slot.cursorDeltaY, 150.0f);

    InputSlot nearOrigin = FreshSlot();
    FilterCursor(nearOrigin, 5.0f, -5.0f);
    EXPECT_FLOAT_EQ(nearOrigin.cursorDeltaX, 0.0f);
    EXPECT_FLOAT_EQ(nearOrigin.cursorDeltaY, 0.0f);
}

TEST(SlotWheel, ANotchOf120Scores12AndPressesWheelUp)
{
    struct Case
    {
        std::int32_t lZ;
        float wheel;
        std::uint32_t up, down;
    };
    const Case cases[] = {
        {120, 12.0f, 1, 0}, {6, 0.6f, 1, 0},   {5, 0.5f, 0, 0},
        {-5, -0.5f, 0, 0},  {-6, -0.6f, 0, 1}, {-120, -12.0f, 0, 1},
    };
    for (const Case& c : cases)
    {
        InputSlot slot = FreshSlot();
        DIMOUSESTATE2 mouse = {};
        mouse.lZ = c.lZ;
        ReadMouse(slot, mouse);
        EXPECT_FLOAT_EQ(slot.wheel, c.wheel);
        EXPECT_EQ(slot.current[kWheelUpButton], c.up) << c.lZ;
        EXPECT_EQ(slot.current[kWheelDownButton], c.down) << c.lZ;
    }
}

TEST(SlotKeyboard, EachKeyFeedsOnlyItsOwnButton)
{
    const std::pair<int, int> fixed[] = {
        {0x3B, kFirstFunctionKeyButton},      {0x44, kFirstFunctionKeyButton + 9},
        {0x57, kFirstFunctionKeyButton + 10}, {0x58, kFirstFunctionKeyButton + 11},
        {0x02, kFirstDigitKeyButton},         {0x0B, kFirstDigitKeyButton + 9},
        {0x11, kFirstVirtualButton + 4},
    };
    for (const auto& [key, button] : fixed)
    {
        InputSlot slot = FreshSlot();
        std::uint8_t keys[kKeyCodeCount] = {};
        keys[key] = 1;
        ReadKeyboard(slot, keys);
        for (int b = 0; b < kSlotButtonCount; ++b)
            EXPECT_EQ(slot.current[b], b == button ? 1u : 0u) << "key " << key << " button " << b;
    }
}

TEST(SlotOverrides, MovementKeysForceFullDeflectionOtherwiseTheDeviceOrCentreHolds)
{
    struct Case
    {
        int button;
        float InputSlot::*axis;
        float expected;
    };
    const Case cases[] = {
        {kFirstVirtualButton + 4, &InputSlot::leftY, -1.0f},
        {kFirstVirtualButton + 5, &InputSlot::leftY, 1.0f},
        {kFirstVirtualButton + 6, &InputSlot::leftX, -1.0f},
        {kFirstVirtualButton + 7, &InputSlot::leftX, 1.0f},
        {kFirstVirtualButton + 9, &InputSlot::rightY, -1.0f},
        {kFirstVirtualButton + 10, &InputSlot::rightY, 1.0f},
        {kFirstVirtualButton + 11, &InputSlot::rightX, -1.0f},
        {kFirstVirtualButton + 12, &InputSlot::rightX, 1.0f},
    };
    for (const Case& c : cases)
    {
        for (std::uint32_t analogValid : {0u, 1u})
        {
            InputSlot slot = FreshSlot();
            slot.analogValid = analogValid;
            slot.leftX = slot.leftY = slot.rightX = slot.rightY = 0.3f;
            slot.current[c.button] = 1;
            ApplyDigitalOverrides(slot);
            EXPECT_FLOAT_EQ(slot.*c.axis, c.expected) << "button " << c.button;
        }
    }

    InputSlot both = FreshSlot();
    both.current[kFirstVirtualButton + 4] = 1;
    both.current[kFirstVirtualButton + 5] = 1;
    ApplyDigitalOverrides(both);
    EXPECT_FLOAT_EQ(both.leftY, -1.0f);

    // Without keys the sticks keep a device's values, or centre without one.
    for (std::uint32_t analogValid : {0u, 1u})
    {
        InputSlot slot = FreshSlot();
        slot.analogValid = analogValid;
        slot.leftX = 0.3f;
        slot.rightY = -0.7f;
        ApplyDigitalOverrides(slot);
        EXPECT_FLOAT_EQ(slot.leftX, analogValid != 0 ? 0.3f : 0.0f);
        EXPECT_FLOAT_EQ(slot.rightY, analogValid != 0 ? -0.7f : 0.0f);
    }
}

TEST(SlotPadFrame, ButtonsComeThroughTheMapOfTheDeviceThatDeliveredTheFrame)
{
    PadFrame frame = {};
    frame.flags[30] = 1;
    InputSlot slot = FreshSlot();
    slot.joyMap[14] = 30;
    slot.xinputMap[15] = 30;
    // A code from a damaged settings file lies beyond the frame.
    slot.joyMap[16] = 4000;

    ReadPadFrame(slot, frame, false);
    EXPECT_EQ(slot.current[kFirstVirtualButton + 14], 1u);
    EXPECT_EQ(slot.current[kFirstVirtualButton + 15], 0u);
    EXPECT_EQ(slot.current[kFirstVirtualButton + 16], 0u);

    BeginSlotUpdate(slot);
    ReadPadFrame(slot, frame, true);
    EXPECT_EQ(slot.current[kFirstVirtualButton + 14], 0u);
    EXPECT_EQ(slot.current[kFirstVirtualButton + 15], 1u);
}

TEST(SlotVibration, MotorsSlowDownByTheDecayTruncatedAndStopAtZero)
{
    struct Case
    {
        std::uint16_t decay;
        std::uint32_t dt;
        std::uint16_t speed;
        std::uint16_t expected;
    };
    const Case cases[] = {
        {20000, 16, 1000, 680}, {20000, 16, 320, 0}, {20000, 16, 321, 1},
        {20000, 0, 1000, 1000}, {1500, 1, 10, 9},    {1500, 1, 1, 0},
    };
    for (const Case& c : cases)
    {
        InputSlot slot = FreshSlot();
        slot.vibrationDecay = c.decay;
        slot.vibrationLeft = c.speed;
        slot.vibrationRight = c.speed;
        DecayVibration(slot, c.dt);
        EXPECT_EQ(slot.vibrationLeft, c.expected);
        EXPECT_EQ(slot.vibrationRight, c.expected);
    }
}

} // namespace
