#pragma once

#include "sound/sound_device.h"

namespace testing_support
{

// A window handle that CSound::Init accepts: a hidden top-level window of
// the test process on Windows (made once), a dummy non-null value on POSIX.
void* TestWindowHandle();

// A sound device made current for the scope of a test.
class ScopedSoundDevice
{
public:
    bool Ready() const { return ready_; }

private:
    sound::CSound device_;
    bool ready_ = device_.Init(TestWindowHandle());
};

} // namespace testing_support
