#include "sound/audio_warm_up_win32.h"

#include "sound/direct_sound_win32.h"

namespace sound
{
namespace
{

BOOL CALLBACK KeepListing(LPGUID, LPCSTR, LPCSTR, LPVOID)
{
    return TRUE;
}

DWORD WINAPI ListOutputDevices(LPVOID)
{
    DirectSoundEnumerateA(KeepListing, nullptr);
    return 0;
}

} // namespace

AudioWarmUp::AudioWarmUp() : thread_(CreateThread(nullptr, 0, ListOutputDevices, nullptr, 0, nullptr))
{
}

AudioWarmUp::~AudioWarmUp()
{
    Wait();
}

void AudioWarmUp::Wait()
{
    if (thread_ == nullptr)
        return;
    WaitForSingleObject(thread_, INFINITE);
    CloseHandle(thread_);
    thread_ = nullptr;
}

} // namespace sound
