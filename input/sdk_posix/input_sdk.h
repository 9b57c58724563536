#pragma once

// The device structures of DirectInput 8 and XInput for builds without the
// Windows SDK, laid out byte for byte as the SDK lays them out, so that the
// portable input code reads the same fields on every platform.

#include <cstdint>

struct GUID
{
    std::uint32_t Data1;
    std::uint16_t Data2;
    std::uint16_t Data3;
    std::uint8_t Data4[8];
};

struct DIJOYSTATE2
{
    std::int32_t lX;
    std::int32_t lY;
    std::int32_t lZ;
    std::int32_t lRx;
    std::int32_t lRy;
    std::int32_t lRz;
    std::int32_t rglSlider[2];
    std::uint32_t rgdwPOV[4];
    std::uint8_t rgbButtons[128];
    std::int32_t lVX;
    std::int32_t lVY;
    std::int32_t lVZ;
    std::int32_t lVRx;
    std::int32_t lVRy;
    std::int32_t lVRz;
    std::int32_t rglVSlider[2];
    std::int32_t lAX;
    std::int32_t lAY;
    std::int32_t lAZ;
    std::int32_t lARx;
    std::int32_t lARy;
    std::int32_t lARz;
    std::int32_t rglASlider[2];
    std::int32_t lFX;
    std::int32_t lFY;
    std::int32_t lFZ;
    std::int32_t lFRx;
    std::int32_t lFRy;
    std::int32_t lFRz;
    std::int32_t rglFSlider[2];
};

struct DIMOUSESTATE2
{
    std::int32_t lX;
    std::int32_t lY;
    std::int32_t lZ;
    std::uint8_t rgbButtons[8];
};

struct DIDEVICEINSTANCEA
{
    std::uint32_t dwSize;
    GUID guidInstance;
    GUID guidProduct;
    std::uint32_t dwDevType;
    char tszInstanceName[260];
    char tszProductName[260];
    GUID guidFFDriver;
    std::uint16_t wUsagePage;
    std::uint16_t wUsage;
};

struct XINPUT_GAMEPAD
{
    std::uint16_t wButtons;
    std::uint8_t bLeftTrigger;
    std::uint8_t bRightTrigger;
    std::int16_t sThumbLX;
    std::int16_t sThumbLY;
    std::int16_t sThumbRX;
    std::int16_t sThumbRY;
};

struct XINPUT_STATE
{
    std::uint32_t dwPacketNumber;
    XINPUT_GAMEPAD Gamepad;
};

struct XINPUT_VIBRATION
{
    std::uint16_t wLeftMotorSpeed;
    std::uint16_t wRightMotorSpeed;
};

inline constexpr std::uint16_t XINPUT_GAMEPAD_DPAD_UP = 0x0001;
inline constexpr std::uint16_t XINPUT_GAMEPAD_DPAD_DOWN = 0x0002;
inline constexpr std::uint16_t XINPUT_GAMEPAD_DPAD_LEFT = 0x0004;
inline constexpr std::uint16_t XINPUT_GAMEPAD_DPAD_RIGHT = 0x0008;
inline constexpr std::uint16_t XINPUT_GAMEPAD_START = 0x0010;
inline constexpr std::uint16_t XINPUT_GAMEPAD_BACK = 0x0020;
inline constexpr std::uint16_t XINPUT_GAMEPAD_LEFT_THUMB = 0x0040;
inline constexpr std::uint16_t XINPUT_GAMEPAD_RIGHT_THUMB = 0x0080;
inline constexpr std::uint16_t XINPUT_GAMEPAD_LEFT_SHOULDER = 0x0100;
inline constexpr std::uint16_t XINPUT_GAMEPAD_RIGHT_SHOULDER = 0x0200;
inline constexpr std::uint16_t XINPUT_GAMEPAD_A = 0x1000;
inline constexpr std::uint16_t XINPUT_GAMEPAD_B = 0x2000;
inline constexpr std::uint16_t XINPUT_GAMEPAD_X = 0x4000;
inline constexpr std::uint16_t XINPUT_GAMEPAD_Y = 0x8000;

// The device objects. Without DirectInput the input layer's own stand-ins
// (input/virtual_devices_posix.cpp) complete these types.
struct IDirectInput8A;
struct IDirectInputDevice8A;
