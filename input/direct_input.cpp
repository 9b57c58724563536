#include "input/direct_input.h"

#include "base/input_codes.h"

namespace input
{
namespace
{
constexpr int kNormalizedJoyButtons = 32;
} // namespace

CDirectInput::CDirectInput()
    : directInput(nullptr), keyboard(nullptr), mouse(nullptr), joysticks{}, joystickCount(0),
      keyPrevious{}, keyCurrent{}, mouseState{}, joyPrevious{}, joyCurrent{}, joyInfo{}, system{}
{
    for (int i = 0; i < kMaxJoysticks; ++i)
    {
        ReleaseJoystickState(joyPrevious[i]);
        ReleaseJoystickState(joyCurrent[i]);
    }
}

CDirectInput::~CDirectInput()
{
    Release();
}

std::uint8_t CDirectInput::IsKeyTriggered(std::uint8_t code) const
{
    return keyPrevious[code] != 0 ? 0 : keyCurrent[code];
}

DIJOYSTATE2* CDirectInput::GetJoystickState(std::uint8_t index)
{
    if (index >= kMaxJoysticks || joysticks[index] == nullptr)
        return nullptr;
    return &joyCurrent[index];
}

const DIJOYSTATE2* CDirectInput::GetJoystickState(std::uint8_t index) const
{
    if (index >= kMaxJoysticks || joysticks[index] == nullptr)
        return nullptr;
    return &joyCurrent[index];
}

std::uint8_t CDirectInput::GetJoyButton(std::uint8_t index, std::uint8_t button) const
{
    const DIJOYSTATE2* state = GetJoystickState(index);
    if (state == nullptr || button >= kNormalizedJoyButtons)
        return 0;
    return state->rgbButtons[button];
}

const DIDEVICEINSTANCEA* CDirectInput::GetJoystickInfo(std::uint8_t index) const
{
    if (index >= kMaxJoysticks || joysticks[index] == nullptr)
        return nullptr;
    return &joyInfo[index];
}

const char* CDirectInput::GetKeyName(std::uint8_t code)
{
    return KeyName(code);
}

const char* CDirectInput::GetPadButtonName(std::uint8_t code)
{
    return PadButtonName(code);
}

void ReleaseJoystickState(DIJOYSTATE2& state)
{
    state = DIJOYSTATE2{};
    for (auto& pov : state.rgdwPOV)
        pov = 0xFFFFFFFF;
}

void KeepPressedBits(std::uint8_t* bytes, int count)
{
    for (int i = 0; i < count; ++i)
        bytes[i] = (bytes[i] & 0x80) != 0 ? 1 : 0;
}

} // namespace input
