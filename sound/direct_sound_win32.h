#pragma once

// The DirectSound side of the sound device, for the Windows tests.
#include "sound/sound_device.h"

// In this order: <dsound.h> needs the wave formats of <mmsystem.h>, which
// the lean <windows.h> leaves out; <mmreg.h> adds the extensible format.
// clang-format off
#include <windows.h>
#include <mmsystem.h>
#include <mmreg.h>
#include <dsound.h>
// clang-format on

// <windows.h> would rename the class-name operation of every class.
#undef GetClassName

namespace sound
{

// The platform functions CSound::Init calls.
struct DeviceApi
{
    HRESULT(WINAPI* createDevice)(LPCGUID, LPDIRECTSOUND8*, LPUNKNOWN);
    // A message box of code page 932 texts.
    int (*messageBox)(HWND, const char*, const char*, UINT);
};

// DirectSoundCreate8 and the tool's message box.
const DeviceApi& SystemDeviceApi();

struct CSound::Platform
{
    IDirectSound8* device;
    IDirectSoundBuffer* primary;
    IDirectSound3DListener* listener;
    CRITICAL_SECTION lock;
    bool lockCreated;
};

namespace device
{

// Locks the whole buffer, copies `bytes` of `pcm` in and unlocks it. A lock
// that reports DSERR_BUFFERLOST restores the buffer and locks once more;
// false when the lock still fails.
bool FillStaticBuffer(IDirectSoundBuffer8* buffer, const void* pcm, DWORD bytes);

} // namespace device

} // namespace sound
