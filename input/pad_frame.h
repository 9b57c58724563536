#pragma once

#include "base/input_codes.h"
#include "input/device_types.h"

#include <cstdint>

namespace input
{

// One controller's buttons, directions and d-pad as flags (0 or 1), rebuilt
// for every slot at every update.
struct PadFrame
{
    std::uint32_t flags[kPadFrameSize];
};

// The right stick's options of a player slot.
struct RightStickOptions
{
    bool swapAxes;
    bool invertY;
    bool invertX;
};

// DirectInput controllers report 36 buttons that reach the frame.
inline constexpr int kJoyFrameButtons = 36;

// The frame entry a DirectInput button (0..35) feeds.
std::uint8_t JoyButtonCode(int button);

// Fills entries 0..23 from an XInput pad. Thumb values inside the dead zone
// are zeroed in `pad`, and the right stick there is swapped and inverted as
// asked, so that the caller reads the stick values the frame was made from.
void FillFrameFromXInput(XINPUT_GAMEPAD& pad, const RightStickOptions& options, PadFrame& frame);

// Fills the frame from a DirectInput controller whose axes run -1000..+1000.
// The axis changes (dead zone, choice of the right stick's axes, swap and
// inversion) are written back into `state` for the same reason.
void FillFrameFromJoystick(DIJOYSTATE2& state, const RightStickOptions& options, PadFrame& frame);

} // namespace input
