#pragma once

#include "input/device_types.h"
#include "input/pad_frame.h"

#include <cstdint>

namespace input
{

inline constexpr int kSlotCount = 16;
inline constexpr int kSlotButtonCount = 56;
inline constexpr int kVirtualButtonCount = 24;
inline constexpr int kMouseButtonCount = 8;

// The logical buttons of a slot.
inline constexpr int kFirstVirtualButton = 8;      // 8..31: keyboard or controller
inline constexpr int kFirstFunctionKeyButton = 32; // 32..43: F1..F12
inline constexpr int kWheelUpButton = 44;
inline constexpr int kWheelDownButton = 45;
inline constexpr int kFirstDigitKeyButton = 46; // 46..55: keys 1..9, 0

// One player's view of the devices: buttons with their edges and times,
// sticks, wheel, cursor movement and vibration.
struct InputSlot
{
    float leftAngle;
    float leftMagnitude;
    float leftX;
    float leftY;
    float rightAngle;
    float rightMagnitude;
    float rightX;
    float rightY;
    float wheel;
    float cursorDeltaX;
    float cursorDeltaY;
    float cursorRefX;
    float cursorRefY;
    float cursorLastX;
    float cursorLastY;
    std::uint16_t vibrationLeft;
    std::uint16_t vibrationRight;
    std::uint32_t xinputAllowed;
    std::uint32_t analogValid;
    std::uint32_t previous[kSlotButtonCount];
    std::uint32_t current[kSlotButtonCount];
    std::uint32_t pressed[kSlotButtonCount];
    std::uint32_t released[kSlotButtonCount];
    std::uint32_t held[kSlotButtonCount];
    std::uint32_t heldTime[kSlotButtonCount];
    std::uint32_t up[kSlotButtonCount];
    std::uint32_t upTime[kSlotButtonCount];
    std::uint32_t keyMap[kVirtualButtonCount];
    std::uint32_t mouseMap[kMouseButtonCount];
    std::uint32_t joyMap[kVirtualButtonCount];
    std::uint32_t xinputMap[kVirtualButtonCount];
    float cursorThreshold;
    std::uint16_t vibrationDecay;
    std::uint32_t swapRightAxes;
    std::uint32_t invertRightY;
    std::uint32_t invertRightX;
    std::uint8_t joystickIndex;
};

// The key feeding each virtual button of a fresh slot.
extern const std::uint8_t kDefaultKeyMap[kVirtualButtonCount];

// A fresh slot reading DirectInput controller `index`; `controllerPresent`
// says whether that controller exists, so that its sticks count from the
// first update.
void ResetSlot(InputSlot& slot, std::uint8_t index, bool controllerPresent);

// Moves this update's button states to `previous` and clears `current`.
void BeginSlotUpdate(InputSlot& slot);

// Buttons 0..7 and the wheel, from the mouse of this poll.
void ReadMouse(InputSlot& slot, const DIMOUSESTATE2& mouse);

// Reports cursor movement only once the cursor has left a small box around
// where it rested, so that a hand resting on the mouse reports nothing.
// (x, y) is the cursor in client pixels of the main window.
void FilterCursor(InputSlot& slot, float x, float y);

// Keyboard part of the virtual buttons, and the function and digit keys.
// `keys` holds 0 or 1 per key code.
void ReadKeyboard(InputSlot& slot, const std::uint8_t (&keys)[kKeyCodeCount]);

// The movement keys force the sticks to full deflection; without them the
// sticks keep the device's values, or centre when no device gives any.
void ApplyDigitalOverrides(InputSlot& slot);

// Controller part of the virtual buttons, through the map of the device
// that delivered the frame.
void ReadPadFrame(InputSlot& slot, const PadFrame& frame, bool fromXInput);

// Rounds the sticks toward zero to hundredths, limits them to -1..+1 and
// derives their angle (0 up, 90 right) and magnitude.
void FinishSticks(InputSlot& slot);

// Lowers the motor speeds by `vibrationDecay` per second over `dt`
// milliseconds.
void DecayVibration(InputSlot& slot, std::uint32_t dt);

// Derives pressed, released, held and up, and the times, from `previous`
// and `current`; `dt` is the frame time in milliseconds.
void UpdateButtonEdges(InputSlot& slot, std::uint32_t dt);

} // namespace input
