#pragma once

// The devices of builds without DirectInput and XInput: they report nothing
// until a test gives them a state. The input layer reads them exactly where
// it would read the real devices, so the whole update can be exercised
// without hardware.

#include "input/device_types.h"
#include "input/direct_input.h"

#include <cstdint>

namespace input::virtual_devices
{

inline constexpr int kXInputUsers = 4;

struct VirtualJoystick
{
    char name[260];
    // Its set-up at Init fails: it keeps a number but no device.
    bool setUpFails;
    // As the device reports it: bit 7 marks a pressed button.
    DIJOYSTATE2 state;
};

struct VirtualDevices
{
    // In the background every DirectInput read fails, as with a foreground
    // cooperative level on Windows.
    bool foreground = true;
    // As the keyboard reports them: bit 7 marks a pressed key.
    std::uint8_t keys[256];
    DIMOUSESTATE2 mouse;
    float cursorX;
    float cursorY;
    // The controllers found by the next Init.
    int joystickCount;
    VirtualJoystick joysticks[kMaxJoysticks];
    bool xinputConnected[kXInputUsers];
    XINPUT_STATE xinput[kXInputUsers];
    // What was last sent to each pad's motors.
    XINPUT_VIBRATION vibration[kXInputUsers];
};

VirtualDevices& Devices();

// Nothing attached, nothing pressed, the window in the foreground.
void ResetDevices();

} // namespace input::virtual_devices
