#include "tests/support/sound_device_fixture.h"

#include <windows.h>

namespace testing_support
{

void* TestWindowHandle()
{
    static const HWND window =
        CreateWindowExA(0, "STATIC", "vek-sound-test", WS_OVERLAPPED, 0, 0, 16, 16, nullptr,
                        nullptr, GetModuleHandleA(nullptr), nullptr);
    return window;
}

} // namespace testing_support
