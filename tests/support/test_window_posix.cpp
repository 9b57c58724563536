#include "tests/support/sound_device_fixture.h"

namespace testing_support
{

void* TestWindowHandle()
{
    static int window;
    return &window;
}

} // namespace testing_support
