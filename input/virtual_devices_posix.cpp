#include "input/virtual_devices_posix.h"

namespace input::virtual_devices
{
namespace
{
VirtualDevices devices;
} // namespace

VirtualDevices& Devices()
{
    return devices;
}

void ResetDevices()
{
    devices = VirtualDevices{};
}

} // namespace input::virtual_devices
