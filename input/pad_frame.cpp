#include "input/pad_frame.h"

#include <algorithm>
#include <cstdlib>
#include <limits>
#include <utility>

namespace input
{
namespace
{

// DirectInput axes: a direction counts beyond half deflection, and small
// deflections around the centre are noise.
constexpr int kJoyNegativeLimit = -500;
constexpr int kJoyPositiveLimit = 501;
constexpr int kJoyDeadZone = 100;

// XInput thumbs and triggers.
constexpr int kThumbDeadZone = 6000;
constexpr int kThumbDirection = 16383;
constexpr int kTriggerPressed = 128;

// The POV hat in hundredths of a degree clockwise from up; each direction
// takes the diagonals on both of its sides.
constexpr std::uint32_t kPovCentred = 65535;
constexpr std::uint32_t kPovUpRight = 4500;
constexpr std::uint32_t kPovDownRight = 13500;
constexpr std::uint32_t kPovDownLeft = 22500;
constexpr std::uint32_t kPovUpLeft = 31500;

constexpr std::uint8_t kJoyButtonCodes[kJoyFrameButtons] = {
    kButton1,
    kButton2,
    kButton3,
    kButton4,
    kButton5,
    kButton6,
    kButton7,
    kButton8,
    kButton9,
    kButton10,
    kLeftStickPush,
    kRightStickPush,
    24,
    25,
    26,
    27,
    28,
    29,
    30,
    31,
    32,
    33,
    34,
    35,
    36,
    37,
    38,
    39,
    40,
    41,
    42,
    43,
    44,
    45,
    46,
    47,
};

struct XInputButton
{
    std::uint16_t mask;
    std::uint8_t code;
};

constexpr XInputButton kXInputButtons[] = {
    {XINPUT_GAMEPAD_DPAD_UP, kDpadUp},
    {XINPUT_GAMEPAD_DPAD_DOWN, kDpadDown},
    {XINPUT_GAMEPAD_DPAD_LEFT, kDpadLeft},
    {XINPUT_GAMEPAD_DPAD_RIGHT, kDpadRight},
    {XINPUT_GAMEPAD_LEFT_THUMB, kLeftStickPush},
    {XINPUT_GAMEPAD_RIGHT_THUMB, kRightStickPush},
    {XINPUT_GAMEPAD_A, kButton1},
    {XINPUT_GAMEPAD_B, kButton2},
    {XINPUT_GAMEPAD_X, kButton3},
    {XINPUT_GAMEPAD_Y, kButton4},
    {XINPUT_GAMEPAD_LEFT_SHOULDER, kButton7},
    {XINPUT_GAMEPAD_RIGHT_SHOULDER, kButton8},
    {XINPUT_GAMEPAD_START, kButton9},
    {XINPUT_GAMEPAD_BACK, kButton10},
};

// Inverting a fully deflected axis must give the full opposite deflection,
// not wrap around to the same side.
template <typename T> void Negate(T& value)
{
    const long long negated = -static_cast<long long>(value);
    value = static_cast<T>(std::min<long long>(negated, std::numeric_limits<T>::max()));
}

template <typename T> void ApplyThumbDeadZone(T& value)
{
    if (std::abs(static_cast<int>(value)) <= kThumbDeadZone)
        value = 0;
}

// Sets the direction entries of one DirectInput axis, then zeroes the axis
// when it rests in the dead zone.
template <typename T>
void JoyAxis(T& value, std::uint8_t negative, std::uint8_t positive, PadFrame& frame)
{
    if (value < kJoyNegativeLimit)
        frame.flags[negative] = 1;
    if (value >= kJoyPositiveLimit)
        frame.flags[positive] = 1;
    if (value > -kJoyDeadZone && value < kJoyDeadZone)
        value = 0;
}

template <typename T> long long Magnitude(T value)
{
    return std::llabs(static_cast<long long>(value));
}

} // namespace

std::uint8_t JoyButtonCode(int button)
{
    return kJoyButtonCodes[button];
}

void FillFrameFromXInput(XINPUT_GAMEPAD& pad, const RightStickOptions& options, PadFrame& frame)
{
    for (const XInputButton& button : kXInputButtons)
    {
        if ((pad.wButtons & button.mask) != 0)
            frame.flags[button.code] = 1;
    }
    if (pad.bLeftTrigger >= kTriggerPressed)
        frame.flags[kButton5] = 1;
    if (pad.bRightTrigger >= kTriggerPressed)
        frame.flags[kButton6] = 1;

    ApplyThumbDeadZone(pad.sThumbLX);
    ApplyThumbDeadZone(pad.sThumbLY);
    // XInput counts up as positive; the game counts down as positive.
    const int leftDown = -static_cast<int>(pad.sThumbLY);
    if (leftDown <= -kThumbDirection)
        frame.flags[kLeftStickUp] = 1;
    if (leftDown >= kThumbDirection)
        frame.flags[kLeftStickDown] = 1;
    if (pad.sThumbLX <= -kThumbDirection)
        frame.flags[kLeftStickLeft] = 1;
    if (pad.sThumbLX >= kThumbDirection)
        frame.flags[kLeftStickRight] = 1;

    if (options.swapAxes)
        std::swap(pad.sThumbRX, pad.sThumbRY);
    if (options.invertY)
        Negate(pad.sThumbRY);
    if (options.invertX)
        Negate(pad.sThumbRX);
    ApplyThumbDeadZone(pad.sThumbRX);
    ApplyThumbDeadZone(pad.sThumbRY);
    // The right stick's directions take XInput's sign as it is.
    if (pad.sThumbRY <= -kThumbDirection)
        frame.flags[kRightStickUp] = 1;
    if (pad.sThumbRY >= kThumbDirection)
        frame.flags[kRightStickDown] = 1;
    if (pad.sThumbRX <= -kThumbDirection)
        frame.flags[kRightStickLeft] = 1;
    if (pad.sThumbRX >= kThumbDirection)
        frame.flags[kRightStickRight] = 1;
}

void FillFrameFromJoystick(DIJOYSTATE2& state, const RightStickOptions& options, PadFrame& frame)
{
    for (int button = 0; button < kJoyFrameButtons; ++button)
    {
        if (state.rgbButtons[button] != 0)
            frame.flags[kJoyButtonCodes[button]] = 1;
    }

    const std::uint32_t pov = state.rgdwPOV[0];
    if (pov < kPovCentred)
    {
        if (pov <= kPovUpRight || pov >= kPovUpLeft)
            frame.flags[kDpadUp] = 1;
        if (pov >= kPovDownRight && pov <= kPovDownLeft)
            frame.flags[kDpadDown] = 1;
        if (pov >= kPovDownLeft && pov <= kPovUpLeft)
            frame.flags[kDpadLeft] = 1;
        if (pov >= kPovUpRight && pov <= kPovDownRight)
            frame.flags[kDpadRight] = 1;
    }

    JoyAxis(state.lY, kLeftStickUp, kLeftStickDown, frame);
    JoyAxis(state.lX, kLeftStickLeft, kLeftStickRight, frame);

    // Controllers put the right stick on Z/Rz or on Rx/Ry: whichever pair is
    // deflected further serves.
    if (Magnitude(state.lRz) < Magnitude(state.lRy))
        state.lRz = state.lRy;
    if (Magnitude(state.lZ) < Magnitude(state.lRx))
        state.lZ = state.lRx;
    if (options.swapAxes)
        std::swap(state.lZ, state.lRz);
    if (options.invertY)
        Negate(state.lRz);
    if (options.invertX)
        Negate(state.lZ);
    JoyAxis(state.lRz, kRightStickUp, kRightStickDown, frame);
    JoyAxis(state.lZ, kRightStickLeft, kRightStickRight, frame);
}

} // namespace input
