#pragma once

#include "base/memory.h"
#include "input/device_types.h"

#include <cstdint>

namespace input
{

inline constexpr int kMaxJoysticks = 16;

// What the input layer needs of the application's window object: the module
// instance (HINSTANCE) and the main dialog (HWND), which DirectInput binds
// its devices to. Opaque here so that the portable code stays free of the
// Windows headers; the application fills it from CSystem::GetInstance and
// CSystem::GetHwnd after the main dialog exists.
struct InputWindow
{
    void* instance;
    void* window;
};

// The DirectInput 8 layer: the system keyboard and mouse and up to sixteen
// game controllers, read once per update.
class CDirectInput : public base::CAllocated
{
public:
    CDirectInput();
    ~CDirectInput();
    CDirectInput(const CDirectInput&) = delete;
    CDirectInput& operator=(const CDirectInput&) = delete;

    // Creates the devices and binds them to the window, showing a message
    // box for a failure of the keyboard or the mouse. A null window fails at
    // once. The window object is copied.
    bool Init(const InputWindow* window);

    void PollJoysticks();
    void PollKeyboard();
    void PollMouse();

    // Non-zero only at the poll at which the key went down.
    std::uint8_t IsKeyTriggered(std::uint8_t code) const;
    // Null for an index of 16 or more and for a controller whose set-up
    // failed. The state may be changed through it.
    DIJOYSTATE2* GetJoystickState(std::uint8_t index);
    const DIJOYSTATE2* GetJoystickState(std::uint8_t index) const;
    // One of the first 32 buttons as 0 or 1; 0 for anything out of reach.
    std::uint8_t GetJoyButton(std::uint8_t index, std::uint8_t button) const;
    // Controllers are numbered in enumeration order; one whose set-up failed
    // keeps its number and has neither state nor information.
    std::uint8_t GetJoystickCount() const { return joystickCount; }
    const DIDEVICEINSTANCEA* GetJoystickInfo(std::uint8_t index) const;
    const DIMOUSESTATE2* GetMouseState() const { return &mouseState; }
    // The cursor in client pixels of the main window.
    void GetCursorClientPos(float* x, float* y) const;

    static const char* GetKeyName(std::uint8_t code);
    static const char* GetPadButtonName(std::uint8_t code);

    // Releases every device; safe to run more than once.
    void Release();

protected:
    IDirectInput8A* directInput;
    IDirectInputDevice8A* keyboard;
    IDirectInputDevice8A* mouse;
    IDirectInputDevice8A* joysticks[kMaxJoysticks];
    std::uint8_t joystickCount;
    std::uint8_t keyPrevious[256];
    std::uint8_t keyCurrent[256];
    DIMOUSESTATE2 mouseState;
    DIJOYSTATE2 joyPrevious[kMaxJoysticks];
    DIJOYSTATE2 joyCurrent[kMaxJoysticks];
    DIDEVICEINSTANCEA joyInfo[kMaxJoysticks];
    InputWindow system;
};

// What a controller reads as while it cannot be read (before its first
// read, and while the window is in the background): nothing pressed, the
// axes at rest and every POV centred, so that no d-pad direction shows.
void ReleaseJoystickState(DIJOYSTATE2& state);

// The devices report bytes with bit 7 set for a pressed key or button; the
// layer keeps 0 or 1.
void KeepPressedBits(std::uint8_t* bytes, int count);

} // namespace input
