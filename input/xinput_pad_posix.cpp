#include "input/virtual_devices_posix.h"
#include "input/xinput_pad.h"

namespace input
{

using virtual_devices::Devices;
using virtual_devices::kXInputUsers;

bool CXInputPad::Poll()
{
    if (userIndex >= kXInputUsers || !Devices().xinputConnected[userIndex])
        return false;
    state = Devices().xinput[userIndex];
    return true;
}

void CXInputPad::SendVibration()
{
    if (userIndex < kXInputUsers)
        Devices().vibration[userIndex] = vibration;
}

} // namespace input
