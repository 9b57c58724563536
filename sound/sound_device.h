#pragma once

#include "base/memory.h"
#include "sound/wave_format.h"

#include <cstdint>

namespace sound
{

// DirectSound buffer capability flags (DSBCAPS_*) that this layer names.
inline constexpr std::uint32_t kCapsStatic = 0x2;
inline constexpr std::uint32_t kCapsCtrl3D = 0x10;
inline constexpr std::uint32_t kCapsCtrlVolume = 0x80;
inline constexpr std::uint32_t kCapsCtrlPositionNotify = 0x100;
inline constexpr std::uint32_t kCapsGlobalFocus = 0x8000;
inline constexpr std::uint32_t kCapsGetCurrentPosition2 = 0x10000;
// Added to the caller's flags for every master buffer (0x18080).
inline constexpr std::uint32_t kMasterBufferCaps =
    kCapsCtrlVolume | kCapsGlobalFocus | kCapsGetCurrentPosition2;

// The platform functions that CSound::Init calls (defined per platform:
// DirectSoundCreate8 and the tool's message box on Windows; nothing on POSIX). Tests on
// Windows pass their own to reach each failure of Init.
struct DeviceApi;

// The sound device. The application creates one after its main dialog and
// binds it to the dialog's window; every sound buffer is created through the
// current device, which a successful Init sets.
//
// On Windows this is DirectSound 8 (sound_device_win32.cpp). On POSIX it is a
// small stand-in of our own (sound_device_posix.cpp) whose buffers keep their
// PCM in memory; its buffers need no device, so that the decoding API works
// from a plain path without any window (command-line companion, fuzzing).
class CSound : public base::CAllocated
{
public:
    CSound();
    CSound(const CSound&) = delete;
    CSound& operator=(const CSound&) = delete;
    // Deletes the lock, then releases the listener, the primary buffer and
    // the device, each only when held; stops being the current device.
    // Destroy every sound buffer before the device: DirectSound releases a
    // device's buffers with it.
    virtual ~CSound();
    virtual const char* GetClassName() const;

    // `windowHandle` is the window the cooperative level is set on: on
    // Windows the HWND of the main dialog (CSystem::GetHwnd(); a console
    // program may pass GetDesktopWindow()); on POSIX any non-null value.
    // A null handle fails at once. On Windows each failing step shows its
    // message box (caption "Error") and returns false; interfaces obtained
    // before a failure stay held until destruction.
    bool Init(void* windowHandle);
    bool InitWith(void* windowHandle, const DeviceApi& api);

    // The DSCAPS values stored by Init.
    std::uint32_t GetMaxSecondaryRate() const { return maxSecondaryRate_; }
    std::uint32_t GetMinSecondaryRate() const { return minSecondaryRate_; }
    std::uint32_t GetTotalHardwareMemory() const { return totalHardwareMemory_; }
    std::uint32_t GetFreeHardwareMemory() const { return freeHardwareMemory_; }
    std::uint32_t GetCapsFlags() const { return capsFlags_; }
    void* GetWindow() const { return window_; }

    // The platform's own objects: the DirectSound interfaces and the lock on
    // Windows, the lock on POSIX. Defined by sound_device_<platform>.cpp.
    struct Platform;
    Platform* GetPlatform() const { return platform_; }

private:
    Platform* platform_ = nullptr;
    std::uint32_t maxSecondaryRate_ = 0;
    std::uint32_t minSecondaryRate_ = 0;
    std::uint32_t totalHardwareMemory_ = 0;
    std::uint32_t freeHardwareMemory_ = 0;
    std::uint32_t capsFlags_ = 0;
    void* window_ = nullptr;
};

// The device that the last successful Init made current; null before.
CSound* CurrentSound();

// A buffer of the platform: an IDirectSoundBuffer8 on Windows, a block of
// PCM on POSIX. The two optional interfaces of a play instance likewise.
struct DeviceBuffer;
struct Device3DBuffer;
struct DeviceNotify;

namespace device
{

// The master buffer of a whole decoded file, made through the current
// device with the flags capsFlags | kMasterBufferCaps and a size of `bytes`,
// holding `pcm`. On Windows the data is copied in (a lock that reports
// DSERR_BUFFERLOST restores the buffer and locks once more) and `pcm` stays
// the caller's; on POSIX the buffer takes the block and sets `pcm` to null.
// Null on failure (no current device on Windows, a size outside
// kMinBufferBytes..kMaxBufferBytes, a format DirectSound does not mix, see
// IsPlayableFormat; any DirectSound failure).
DeviceBuffer* CreateStaticBuffer(const WaveFormat& format, std::uint32_t capsFlags,
                                 std::uint8_t*& pcm, std::uint32_t bytes);
// A duplicate sharing the master's data; null on failure.
DeviceBuffer* Duplicate(DeviceBuffer* master);
// Present only for buffers made with kCapsCtrl3D / kCapsCtrlPositionNotify;
// the POSIX stand-in has neither.
Device3DBuffer* Query3DBuffer(DeviceBuffer* buffer);
DeviceNotify* QueryNotify(DeviceBuffer* buffer);
// Stops the buffer under the current device's lock and rewinds it.
void StopAndRewind(DeviceBuffer* buffer);
// Copies up to `size` bytes of the buffer's data from its start; false when
// it cannot be read.
bool ReadBack(DeviceBuffer* buffer, std::uint8_t* destination, std::uint32_t size);
void Release(DeviceBuffer* buffer);
void Release(Device3DBuffer* buffer);
void Release(DeviceNotify* notify);

} // namespace device

} // namespace sound
