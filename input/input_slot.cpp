#include "input/input_slot.h"

#include <cmath>
#include <cstring>
#include <numbers>

namespace input
{
namespace
{

constexpr float kWheelScale = 0.1f;
constexpr float kWheelNotch = 0.6f;
constexpr float kDefaultCursorThreshold = 5.0f;
constexpr std::uint16_t kDefaultVibrationDecay = 20000;

constexpr std::uint8_t kFunctionKeys[] = {0x3B, 0x3C, 0x3D, 0x3E, 0x3F, 0x40,
                                          0x41, 0x42, 0x43, 0x44, 0x57, 0x58};
constexpr std::uint8_t kFirstDigitKey = 0x02;
constexpr int kDigitKeyCount = 10;

// Slot buttons of the virtual buttons that steer the sticks from the keys.
constexpr int kLeftUp = kFirstVirtualButton + 4;
constexpr int kLeftDown = kFirstVirtualButton + 5;
constexpr int kLeftLeft = kFirstVirtualButton + 6;
constexpr int kLeftRight = kFirstVirtualButton + 7;
constexpr int kRightUp = kFirstVirtualButton + 9;
constexpr int kRightDown = kFirstVirtualButton + 10;
constexpr int kRightLeft = kFirstVirtualButton + 11;
constexpr int kRightRight = kFirstVirtualButton + 12;

void Override(const InputSlot& slot, float& value, int negative, int positive)
{
    if (slot.current[negative] != 0)
        value = -1.0f;
    else if (slot.current[positive] != 0)
        value = 1.0f;
    else if (slot.analogValid == 0)
        value = 0.0f;
}

float TruncateAxis(float value)
{
    float hundredths = std::trunc(value * 100.0f);
    // A stick a hair left of or above the centre truncates to -0, whose
    // angle would be 270 instead of the centre's 90.
    if (hundredths == 0.0f)
        hundredths = 0.0f;
    const float truncated = hundredths * 0.01f;
    return truncated < -1.0f ? -1.0f : (truncated > 1.0f ? 1.0f : truncated);
}

void FinishStick(float& x, float& y, float& magnitude, float& angle)
{
    x = TruncateAxis(x);
    y = TruncateAxis(y);
    magnitude = std::sqrt(x * x + y * y);
    angle = std::atan2(y, x) * 180.0f / std::numbers::pi_v<float> + 90.0f;
    if (angle < 0.0f)
        angle += 360.0f;
}

void DecayMotor(std::uint16_t& speed, float step)
{
    if (speed == 0)
        return;
    if (speed <= step)
        speed = 0;
    else
        speed = static_cast<std::uint16_t>(speed - static_cast<std::uint16_t>(step));
}

} // namespace

const std::uint8_t kDefaultKeyMap[kVirtualButtonCount] = {
    0xC8, 0xD0, 0xCB, 0xCD, // UP, DOWN, LEFT, RIGHT
    0x11, 0x1F, 0x1E, 0x20, // W, S, A, D
    0x14,                   // T
    0x50, 0x48, 0x4B, 0x4D, // NUMPAD2, NUMPAD8, NUMPAD4, NUMPAD6
    0x1D,                   // LCONTROL
    0x2C, 0x2D, 0x2E, 0x2F, // Z, X, C, V
    0x10, 0x12,             // Q, E
    0x2A,                   // LSHIFT
    0x13,                   // R
    0x0F, 0x1C,             // TAB, RETURN
};

void ResetSlot(InputSlot& slot, std::uint8_t index, bool controllerPresent)
{
    slot = InputSlot{};
    slot.analogValid = controllerPresent ? 1 : 0;
    for (int j = 0; j < kMouseButtonCount; ++j)
        slot.mouseMap[j] = static_cast<std::uint32_t>(j);
    for (int v = 0; v < kVirtualButtonCount; ++v)
    {
        slot.joyMap[v] = static_cast<std::uint32_t>(v);
        slot.xinputMap[v] = static_cast<std::uint32_t>(v);
        slot.keyMap[v] = kDefaultKeyMap[v];
    }
    slot.cursorThreshold = kDefaultCursorThreshold;
    slot.vibrationDecay = kDefaultVibrationDecay;
    slot.joystickIndex = index;
}

void BeginSlotUpdate(InputSlot& slot)
{
    std::memcpy(slot.previous, slot.current, sizeof slot.current);
    std::memset(slot.current, 0, sizeof slot.current);
}

void ReadMouse(InputSlot& slot, const DIMOUSESTATE2& mouse)
{
    for (int j = 0; j < kMouseButtonCount; ++j)
    {
        const std::uint32_t button = slot.mouseMap[j];
        slot.current[j] = button < kMouseButtonCount ? mouse.rgbButtons[button] : 0;
    }
    slot.wheel = static_cast<float>(mouse.lZ) * kWheelScale;
    slot.current[kWheelUpButton] = slot.wheel >= kWheelNotch ? 1 : 0;
    slot.current[kWheelDownButton] = slot.wheel <= -kWheelNotch ? 1 : 0;
}

void FilterCursor(InputSlot& slot, float x, float y)
{
    if (std::fabs(x - slot.cursorRefX) > slot.cursorThreshold ||
        std::fabs(y - slot.cursorRefY) > slot.cursorThreshold)
    {
        slot.cursorRefX = slot.cursorLastX;
        slot.cursorRefY = slot.cursorLastY;
        slot.cursorDeltaX = x - slot.cursorRefX;
        slot.cursorDeltaY = y - slot.cursorRefY;
    }
    else
    {
        slot.cursorDeltaX = 0.0f;
        slot.cursorDeltaY = 0.0f;
    }
    slot.cursorLastX = x;
    slot.cursorLastY = y;
}

void ReadKeyboard(InputSlot& slot, const std::uint8_t (&keys)[kKeyCodeCount])
{
    for (int v = 0; v < kVirtualButtonCount; ++v)
    {
        const std::uint32_t key = slot.keyMap[v];
        slot.current[kFirstVirtualButton + v] = key < kKeyCodeCount ? keys[key] : 0;
    }
    for (int i = 0; i < static_cast<int>(sizeof kFunctionKeys); ++i)
        slot.current[kFirstFunctionKeyButton + i] = keys[kFunctionKeys[i]];
    for (int i = 0; i < kDigitKeyCount; ++i)
        slot.current[kFirstDigitKeyButton + i] = keys[kFirstDigitKey + i];
}

void ApplyDigitalOverrides(InputSlot& slot)
{
    Override(slot, slot.leftX, kLeftLeft, kLeftRight);
    Override(slot, slot.leftY, kLeftUp, kLeftDown);
    Override(slot, slot.rightX, kRightLeft, kRightRight);
    Override(slot, slot.rightY, kRightUp, kRightDown);
}

void ReadPadFrame(InputSlot& slot, const PadFrame& frame, bool fromXInput)
{
    const std::uint32_t* map = fromXInput ? slot.xinputMap : slot.joyMap;
    for (int v = 0; v < kVirtualButtonCount; ++v)
    {
        // A settings file may hold any code; one past the frame never fires.
        if (map[v] < kPadFrameSize)
            slot.current[kFirstVirtualButton + v] |= frame.flags[map[v]];
    }
}

void FinishSticks(InputSlot& slot)
{
    FinishStick(slot.leftX, slot.leftY, slot.leftMagnitude, slot.leftAngle);
    FinishStick(slot.rightX, slot.rightY, slot.rightMagnitude, slot.rightAngle);
}

void DecayVibration(InputSlot& slot, std::uint32_t dt)
{
    const float step = static_cast<float>(slot.vibrationDecay) * static_cast<float>(dt) * 0.001f;
    DecayMotor(slot.vibrationRight, step);
    DecayMotor(slot.vibrationLeft, step);
}

void UpdateButtonEdges(InputSlot& slot, std::uint32_t dt)
{
    for (int b = 0; b < kSlotButtonCount; ++b)
    {
        slot.pressed[b] = 0;
        slot.released[b] = 0;
        if (slot.current[b] != 0)
        {
            slot.held[b] = 1;
            slot.up[b] = 0;
            slot.upTime[b] = 0;
            if (slot.previous[b] != 0)
                slot.heldTime[b] += dt;
            else
                slot.pressed[b] = 1;
        }
        else
        {
            slot.held[b] = 0;
            slot.up[b] = 1;
            slot.heldTime[b] = 0;
            if (slot.previous[b] != 0)
                slot.released[b] = 1;
            else
                slot.upTime[b] += dt;
        }
    }
}

} // namespace input
