#include "input/xinput_pad.h"

namespace input
{

bool CXInputPad::Init(std::uint32_t user)
{
    userIndex = user;
    vibrationEnabled = 1;
    state = {};
    vibration = {};
    return true;
}

bool CXInputPad::SetVibration(std::uint16_t left, std::uint16_t right)
{
    if (vibrationEnabled == 0)
        return false;
    vibration.wLeftMotorSpeed = left;
    vibration.wRightMotorSpeed = right;
    SendVibration();
    return true;
}

void CXInputPad::StopVibration()
{
    vibration.wLeftMotorSpeed = 0;
    vibration.wRightMotorSpeed = 0;
    SendVibration();
}

void CXInputPad::ToFrame(PadFrame& frame, bool swapRightAxes, bool invertRightY, bool invertRightX)
{
    FillFrameFromXInput(state.Gamepad, {swapRightAxes, invertRightY, invertRightX}, frame);
}

} // namespace input
