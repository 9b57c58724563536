#include "base/window_text_win32.h"
#include "input/direct_input.h"

#include <cstring>

namespace input
{
namespace
{

constexpr DWORD kCooperation = DISCL_NONEXCLUSIVE | DISCL_FOREGROUND;
constexpr LONG kAxisMin = -1000;
constexpr LONG kAxisMax = 1000;

void ShowError(const char* text)
{
    base::ShowMessage(nullptr, text, "Error", MB_OK);
}

// The texts of a system device's set-up steps.
struct DeviceMessages
{
    const char* create;
    const char* format;
    const char* cooperation;
};

constexpr DeviceMessages kKeyboardMessages = {
    "DirectInput8\nキーボードオブジェクトの生成に失敗しました",
    "DirectInput8\nキーボードのデータ設定に失敗しました",
    "DirectInput8\nキーボードの協調設定に失敗しました",
};

constexpr DeviceMessages kMouseMessages = {
    "DirectInput8\nマウスオブジェクトの生成に失敗しました",
    "DirectInput8\nマウスのデータ設定に失敗しました",
    "DirectInput8\nマウスの協調設定に失敗しました",
};

bool CreateSystemDevice(IDirectInput8A* directInput, REFGUID guid, LPCDIDATAFORMAT format,
                        HWND window, const DeviceMessages& messages, IDirectInputDevice8A** device)
{
    if (FAILED(directInput->CreateDevice(guid, device, nullptr)))
    {
        ShowError(messages.create);
        return false;
    }
    if (FAILED((*device)->SetDataFormat(format)))
    {
        ShowError(messages.format);
        return false;
    }
    if (FAILED((*device)->SetCooperativeLevel(window, kCooperation)))
    {
        ShowError(messages.cooperation);
        return false;
    }
    // Not acquired here: the first poll finds the device unacquired and
    // acquires it, as every poll does after the window was in the background.
    // Under Wine an acquired foreground device hooks every message sent on
    // this thread, which makes creating and filling the pages that follow
    // far slower, for no read before the first poll.
    return true;
}

struct Enumeration
{
    IDirectInput8A* directInput;
    IDirectInputDevice8A** joysticks;
    std::uint8_t* count;
};

BOOL CALLBACK AddJoystick(LPCDIDEVICEINSTANCEA instance, LPVOID context)
{
    const Enumeration& enumeration = *static_cast<Enumeration*>(context);
    if (FAILED(enumeration.directInput->CreateDevice(
            instance->guidInstance, &enumeration.joysticks[*enumeration.count], nullptr)))
        return DIENUM_STOP;
    ++*enumeration.count;
    return *enumeration.count < kMaxJoysticks ? DIENUM_CONTINUE : DIENUM_STOP;
}

BOOL CALLBACK SetAxisRange(LPCDIDEVICEOBJECTINSTANCEA object, LPVOID context)
{
    auto* device = static_cast<IDirectInputDevice8A*>(context);
    DIPROPRANGE range;
    std::memset(&range, 0, sizeof range);
    range.diph.dwSize = sizeof(DIPROPRANGE);
    range.diph.dwHeaderSize = sizeof(DIPROPHEADER);
    range.diph.dwHow = DIPH_BYID;
    range.diph.dwObj = object->dwType;
    range.lMin = kAxisMin;
    range.lMax = kAxisMax;
    if (FAILED(device->SetProperty(DIPROP_RANGE, &range.diph)))
        return DIENUM_STOP;
    return DIENUM_CONTINUE;
}

void ReleaseDevice(IDirectInputDevice8A*& device)
{
    if (device == nullptr)
        return;
    device->Unacquire();
    device->Release();
    device = nullptr;
}

} // namespace

bool CDirectInput::Init(const InputWindow* window)
{
    if (window == nullptr)
        return false;
    system = *window;
    const auto instance = static_cast<HINSTANCE>(system.instance);
    const auto hwnd = static_cast<HWND>(system.window);

    void* created = nullptr;
    if (FAILED(::DirectInput8Create(instance, DIRECTINPUT_VERSION, IID_IDirectInput8A, &created,
                                    nullptr)))
    {
        ShowError("DirectInput8オブジェクトの生成に失敗しました");
        return false;
    }
    directInput = static_cast<IDirectInput8A*>(created);

    if (!CreateSystemDevice(directInput, GUID_SysKeyboard, &c_dfDIKeyboard, hwnd, kKeyboardMessages,
                            &keyboard))
        return false;
    if (!CreateSystemDevice(directInput, GUID_SysMouse, &c_dfDIMouse2, hwnd, kMouseMessages,
                            &mouse))
        return false;

    Enumeration enumeration = {directInput, joysticks, &joystickCount};
    if (FAILED(directInput->EnumDevices(DI8DEVCLASS_GAMECTRL, AddJoystick, &enumeration,
                                        DIEDFL_ATTACHEDONLY)))
    {
        for (IDirectInputDevice8A*& joystick : joysticks)
        {
            if (joystick != nullptr)
            {
                joystick->Release();
                joystick = nullptr;
            }
        }
        joystickCount = 0;
        return false;
    }

    for (int i = 0; i < joystickCount; ++i)
    {
        IDirectInputDevice8A*& joystick = joysticks[i];
        if (FAILED(joystick->SetDataFormat(&c_dfDIJoystick2)) ||
            FAILED(joystick->SetCooperativeLevel(hwnd, kCooperation)) ||
            FAILED(joystick->EnumObjects(SetAxisRange, joystick, DIDFT_AXIS)))
        {
            // The controller keeps its number, so later ones keep theirs.
            joystick->Release();
            joystick = nullptr;
            continue;
        }
        // Acquired by the first poll, as the keyboard and the mouse are.
        joyInfo[i].dwSize = sizeof(DIDEVICEINSTANCEA);
        joystick->GetDeviceInfo(&joyInfo[i]);
    }
    return true;
}

void CDirectInput::PollJoysticks()
{
    for (int i = 0; i < joystickCount; ++i)
    {
        IDirectInputDevice8A* joystick = joysticks[i];
        if (joystick == nullptr)
            continue;
        joystick->Poll();
        joyPrevious[i] = joyCurrent[i];
        if (SUCCEEDED(joystick->GetDeviceState(sizeof(DIJOYSTATE2), &joyCurrent[i])))
        {
            KeepPressedBits(joyCurrent[i].rgbButtons, 32);
            continue;
        }
        // Not acquired yet, or the window is in the background: released,
        // as the keyboard and the mouse read then.
        joystick->Acquire();
        ReleaseJoystickState(joyCurrent[i]);
    }
}

void CDirectInput::PollKeyboard()
{
    std::memcpy(keyPrevious, keyCurrent, sizeof keyCurrent);
    if (keyboard != nullptr && SUCCEEDED(keyboard->GetDeviceState(sizeof keyCurrent, keyCurrent)))
    {
        KeepPressedBits(keyCurrent, sizeof keyCurrent);
        return;
    }
    if (keyboard != nullptr)
        keyboard->Acquire();
    std::memset(keyCurrent, 0, sizeof keyCurrent);
}

void CDirectInput::PollMouse()
{
    if (mouse != nullptr && SUCCEEDED(mouse->GetDeviceState(sizeof(DIMOUSESTATE2), &mouseState)))
    {
        KeepPressedBits(mouseState.rgbButtons, sizeof mouseState.rgbButtons);
        return;
    }
    if (mouse != nullptr)
        mouse->Acquire();
    std::memset(&mouseState, 0, sizeof mouseState);
}

void CDirectInput::GetCursorClientPos(float* x, float* y) const
{
    POINT point = {0, 0};
    ::GetCursorPos(&point);
    ::ScreenToClient(static_cast<HWND>(system.window), &point);
    *x = static_cast<float>(point.x);
    *y = static_cast<float>(point.y);
}

void CDirectInput::Release()
{
    ReleaseDevice(keyboard);
    ReleaseDevice(mouse);
    for (int i = 0; i < joystickCount; ++i)
        ReleaseDevice(joysticks[i]);
    if (directInput != nullptr)
    {
        directInput->Release();
        directInput = nullptr;
    }
}

} // namespace input
