#pragma once

#include "base/win32.h"

namespace sound
{

// Lists the audio output devices on a worker thread while the caller goes on.
//
// The first DirectSound call of a process loads the audio drivers and lets
// them find their endpoints. Under Wine that is nearly all of the sound
// device's creation: the driver connects to the sound server and registers
// every endpoint, tens of milliseconds between the main dialog and its pages.
// Started before the dialog and waited for just before the device is
// created, that work overlaps the dialog's creation; the device is still
// created in its place and still reports its own failure there.
class AudioWarmUp
{
public:
    // Starts the worker. When no thread can be started nothing is done, and
    // creating the device does the work itself.
    AudioWarmUp();
    // Waits for the worker: no thread of ours is left inside the audio
    // drivers when the caller gives up and the process ends.
    ~AudioWarmUp();
    AudioWarmUp(const AudioWarmUp&) = delete;
    AudioWarmUp& operator=(const AudioWarmUp&) = delete;

    // Returns once the worker has finished; at once on later calls.
    void Wait();

private:
    HANDLE thread_;
};

} // namespace sound
