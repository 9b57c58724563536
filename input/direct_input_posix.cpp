#include "input/direct_input.h"
#include "input/virtual_devices_posix.h"

#include <cstring>

// The layer's own device objects, standing in for DirectInput's.
struct IDirectInput8A
{
};

struct IDirectInputDevice8A
{
    // The virtual controller read, or -1 for the keyboard and the mouse.
    int joystick;
};

namespace input
{

using virtual_devices::Devices;

bool CDirectInput::Init(const InputWindow* window)
{
    if (window == nullptr)
        return false;
    system = *window;
    directInput = new IDirectInput8A{};
    keyboard = new IDirectInputDevice8A{-1};
    mouse = new IDirectInputDevice8A{-1};
    const int attached = Devices().joystickCount;
    for (int i = 0; i < attached && i < kMaxJoysticks; ++i)
    {
        ++joystickCount;
        if (Devices().joysticks[i].setUpFails)
            continue;
        joysticks[i] = new IDirectInputDevice8A{i};
        joyInfo[i].dwSize = sizeof(DIDEVICEINSTANCEA);
        std::memcpy(joyInfo[i].tszInstanceName, Devices().joysticks[i].name,
                    sizeof joyInfo[i].tszInstanceName);
    }
    return true;
}

void CDirectInput::PollJoysticks()
{
    for (int i = 0; i < joystickCount; ++i)
    {
        if (joysticks[i] == nullptr)
            continue;
        joyPrevious[i] = joyCurrent[i];
        if (!Devices().foreground)
        {
            ReleaseJoystickState(joyCurrent[i]);
            continue;
        }
        joyCurrent[i] = Devices().joysticks[joysticks[i]->joystick].state;
        KeepPressedBits(joyCurrent[i].rgbButtons, 32);
    }
}

void CDirectInput::PollKeyboard()
{
    std::memcpy(keyPrevious, keyCurrent, sizeof keyCurrent);
    if (keyboard == nullptr || !Devices().foreground)
    {
        std::memset(keyCurrent, 0, sizeof keyCurrent);
        return;
    }
    std::memcpy(keyCurrent, Devices().keys, sizeof keyCurrent);
    KeepPressedBits(keyCurrent, sizeof keyCurrent);
}

void CDirectInput::PollMouse()
{
    if (mouse == nullptr || !Devices().foreground)
    {
        std::memset(&mouseState, 0, sizeof mouseState);
        return;
    }
    mouseState = Devices().mouse;
    KeepPressedBits(mouseState.rgbButtons, sizeof mouseState.rgbButtons);
}

void CDirectInput::GetCursorClientPos(float* x, float* y) const
{
    *x = Devices().cursorX;
    *y = Devices().cursorY;
}

void CDirectInput::Release()
{
    delete keyboard;
    keyboard = nullptr;
    delete mouse;
    mouse = nullptr;
    for (int i = 0; i < joystickCount; ++i)
    {
        delete joysticks[i];
        joysticks[i] = nullptr;
    }
    delete directInput;
    directInput = nullptr;
}

} // namespace input
