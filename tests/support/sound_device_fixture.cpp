#include "tests/support/sound_device_fixture.h"

namespace testing_support
{

ScopedSoundDevice::ScopedSoundDevice() : ready_(device_.Init(TestWindowHandle())) {}

} // namespace testing_support
