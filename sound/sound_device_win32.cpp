// The sound device on DirectSound 8.
#include "base/window_text_win32.h"
#include "sound/direct_sound_win32.h"

#include <cstring>
#include <new>

namespace sound
{
namespace
{

CSound* currentSound = nullptr;

constexpr DWORD kPrimaryBufferFlags = DSBCAPS_PRIMARYBUFFER | DSBCAPS_CTRL3D | DSBCAPS_CTRLVOLUME;
static_assert(kPrimaryBufferFlags == 0x91);
static_assert(kMasterBufferCaps ==
              (DSBCAPS_CTRLVOLUME | DSBCAPS_GLOBALFOCUS | DSBCAPS_GETCURRENTPOSITION2));
static_assert(kCapsStatic == DSBCAPS_STATIC && kCapsCtrl3D == DSBCAPS_CTRL3D &&
              kCapsCtrlPositionNotify == DSBCAPS_CTRLPOSITIONNOTIFY);
static_assert(kMinBufferBytes == DSBSIZE_MIN && kMaxBufferBytes == DSBSIZE_MAX);
static_assert(sizeof(WaveFormat) == sizeof(WAVEFORMATEX));
static_assert(kFormatTagPcm == WAVE_FORMAT_PCM && kFormatTagIeeeFloat == WAVE_FORMAT_IEEE_FLOAT &&
              kFormatTagExtensible == WAVE_FORMAT_EXTENSIBLE);
static_assert(kExtensibleStructBytes == sizeof(WAVEFORMATEXTENSIBLE) &&
              kExtensibleExtraBytes == sizeof(WAVEFORMATEXTENSIBLE) - sizeof(WAVEFORMATEX));
static_assert(sizeof(DSCAPS) == 96);

IDirectSoundBuffer8* Native(DeviceBuffer* buffer)
{
    return reinterpret_cast<IDirectSoundBuffer8*>(buffer);
}

template <typename Interface> void ReleaseHeld(Interface*& held)
{
    if (held != nullptr)
    {
        held->Release();
        held = nullptr;
    }
}

// Asks `unknown` for another interface and releases `unknown` in any case.
template <typename Interface> Interface* Requery(IUnknown* unknown, REFIID iid)
{
    void* asked = nullptr;
    const HRESULT result = unknown->QueryInterface(iid, &asked);
    unknown->Release();
    return SUCCEEDED(result) ? static_cast<Interface*>(asked) : nullptr;
}

} // namespace

const DeviceApi& SystemDeviceApi()
{
    static const DeviceApi api{DirectSoundCreate8, base::ShowMessage};
    return api;
}

CSound::CSound() = default;

CSound::~CSound()
{
    if (platform_ != nullptr)
    {
        if (platform_->lockCreated)
            DeleteCriticalSection(&platform_->lock);
        ReleaseHeld(platform_->listener);
        ReleaseHeld(platform_->primary);
        ReleaseHeld(platform_->device);
        delete platform_;
    }
    if (currentSound == this)
        currentSound = nullptr;
}

const char* CSound::GetClassName() const
{
    return "CSound";
}

bool CSound::Init(void* windowHandle)
{
    return InitWith(windowHandle, SystemDeviceApi());
}

bool CSound::InitWith(void* windowHandle, const DeviceApi& api)
{
    if (windowHandle == nullptr)
        return false;
    window_ = windowHandle;
    if (platform_ == nullptr)
        platform_ = new (std::nothrow) Platform{};
    if (platform_ == nullptr || platform_->device != nullptr)
        return false;
    Platform& p = *platform_;
    const auto fail = [&api](const char* message)
    {
        api.messageBox(nullptr, message, "Error", MB_OK);
        return false;
    };

    if (FAILED(api.createDevice(nullptr, &p.device, nullptr)))
        return fail("DirectSound8オブジェクトの生成に失敗しました");
    if (FAILED(p.device->SetCooperativeLevel(static_cast<HWND>(windowHandle), DSSCL_PRIORITY)))
        return fail("DirectSoumd8\n協調設定に失敗しました");

    DSBUFFERDESC description{};
    description.dwSize = sizeof description;
    description.dwFlags = kPrimaryBufferFlags;
    if (FAILED(p.device->CreateSoundBuffer(&description, &p.primary, nullptr)))
        return fail("DirectSound8\nプライマリバッファの作成に失敗しました");

    WAVEFORMATEX format{};
    format.wFormatTag = WAVE_FORMAT_PCM;
    format.nChannels = 2;
    format.nSamplesPerSec = 44100;
    format.wBitsPerSample = 16;
    format.nBlockAlign = 4;
    format.nAvgBytesPerSec = 176400;
    if (FAILED(p.primary->SetFormat(&format)))
        return fail("DirectSound8\nプライマリバッファの設定に失敗しました");

    void* listener = nullptr;
    if (FAILED(p.primary->QueryInterface(IID_IDirectSound3DListener, &listener)))
        return fail("DirectSound8\nサウンドリスナーの作成に失敗しました");
    p.listener = static_cast<IDirectSound3DListener*>(listener);

    DSCAPS caps{};
    caps.dwSize = sizeof caps;
    if (FAILED(p.device->GetCaps(&caps)))
        return false;
    maxSecondaryRate_ = caps.dwMaxSecondarySampleRate;
    minSecondaryRate_ = caps.dwMinSecondarySampleRate;
    totalHardwareMemory_ = caps.dwTotalHwMemBytes;
    freeHardwareMemory_ = caps.dwFreeHwMemBytes;
    capsFlags_ = caps.dwFlags;

    InitializeCriticalSection(&p.lock);
    p.lockCreated = true;
    currentSound = this;
    return true;
}

CSound* CurrentSound()
{
    return currentSound;
}

namespace device
{
namespace
{

// Holds the current device's lock for its scope, when there is one: buffers
// are made and duplicated under it, so that checks running on several
// threads share the one device safely.
class DeviceLock
{
public:
    explicit DeviceLock(CSound* sound)
        : platform_(sound != nullptr ? sound->GetPlatform() : nullptr)
    {
        if (platform_ != nullptr && !platform_->lockCreated)
            platform_ = nullptr;
        if (platform_ != nullptr)
            EnterCriticalSection(&platform_->lock);
    }
    ~DeviceLock()
    {
        if (platform_ != nullptr)
            LeaveCriticalSection(&platform_->lock);
    }
    DeviceLock(const DeviceLock&) = delete;
    DeviceLock& operator=(const DeviceLock&) = delete;

private:
    CSound::Platform* platform_;
};

} // namespace

bool FillStaticBuffer(IDirectSoundBuffer8* buffer, const void* pcm, DWORD bytes)
{
    void* first = nullptr;
    void* second = nullptr;
    DWORD firstBytes = 0;
    DWORD secondBytes = 0;
    const auto lock = [&] {
        return buffer->Lock(0, 0, &first, &firstBytes, &second, &secondBytes, DSBLOCK_ENTIREBUFFER);
    };
    HRESULT result = lock();
    if (result == DSERR_BUFFERLOST)
    {
        buffer->Restore();
        result = lock();
    }
    if (FAILED(result))
        return false;
    const DWORD intoFirst = bytes < firstBytes ? bytes : firstBytes;
    std::memcpy(first, pcm, intoFirst);
    if (second != nullptr && bytes > intoFirst)
    {
        const DWORD rest = bytes - intoFirst;
        std::memcpy(second, static_cast<const BYTE*>(pcm) + intoFirst,
                    rest < secondBytes ? rest : secondBytes);
    }
    buffer->Unlock(first, firstBytes, second, secondBytes);
    return true;
}

DeviceBuffer* CreateStaticBuffer(const WaveFormat& format, std::uint32_t capsFlags,
                                 std::uint8_t*& pcm, std::uint32_t bytes)
{
    CSound* sound = CurrentSound();
    if (sound == nullptr || pcm == nullptr)
        return nullptr;
    DSBUFFERDESC description{};
    description.dwSize = sizeof description;
    description.dwFlags = capsFlags | kMasterBufferCaps;
    description.dwBufferBytes = bytes;
    description.lpwfxFormat = reinterpret_cast<WAVEFORMATEX*>(const_cast<WaveFormat*>(&format));
    description.guid3DAlgorithm = GUID_NULL;
    const DeviceLock locked(sound);
    IDirectSoundBuffer* created = nullptr;
    if (FAILED(sound->GetPlatform()->device->CreateSoundBuffer(&description, &created, nullptr)))
        return nullptr;
    IDirectSoundBuffer8* buffer = Requery<IDirectSoundBuffer8>(created, IID_IDirectSoundBuffer8);
    if (buffer == nullptr)
        return nullptr;
    if ((capsFlags & kCapsStatic) != 0 && !FillStaticBuffer(buffer, pcm, bytes))
    {
        buffer->Release();
        return nullptr;
    }
    return reinterpret_cast<DeviceBuffer*>(buffer);
}

DeviceBuffer* Duplicate(DeviceBuffer* master)
{
    CSound* sound = CurrentSound();
    if (sound == nullptr)
        return nullptr;
    const DeviceLock locked(sound);
    IDirectSoundBuffer* duplicate = nullptr;
    if (FAILED(sound->GetPlatform()->device->DuplicateSoundBuffer(
            reinterpret_cast<IDirectSoundBuffer*>(Native(master)), &duplicate)))
        return nullptr;
    return reinterpret_cast<DeviceBuffer*>(
        Requery<IDirectSoundBuffer8>(duplicate, IID_IDirectSoundBuffer8));
}

Device3DBuffer* Query3DBuffer(DeviceBuffer* buffer)
{
    void* asked = nullptr;
    if (FAILED(Native(buffer)->QueryInterface(IID_IDirectSound3DBuffer, &asked)))
        return nullptr;
    return static_cast<Device3DBuffer*>(asked);
}

DeviceNotify* QueryNotify(DeviceBuffer* buffer)
{
    void* asked = nullptr;
    if (FAILED(Native(buffer)->QueryInterface(IID_IDirectSoundNotify, &asked)))
        return nullptr;
    return static_cast<DeviceNotify*>(asked);
}

void StopAndRewind(DeviceBuffer* buffer)
{
    CSound* sound = CurrentSound();
    CSound::Platform* platform = sound != nullptr ? sound->GetPlatform() : nullptr;
    const bool locked = platform != nullptr && platform->lockCreated;
    if (locked)
        EnterCriticalSection(&platform->lock);
    Native(buffer)->Stop();
    if (locked)
        LeaveCriticalSection(&platform->lock);
    Native(buffer)->SetCurrentPosition(0);
}

bool ReadBack(DeviceBuffer* buffer, std::uint8_t* destination, std::uint32_t size)
{
    void* first = nullptr;
    DWORD firstBytes = 0;
    if (FAILED(Native(buffer)->Lock(0, 0, &first, &firstBytes, nullptr, nullptr,
                                    DSBLOCK_ENTIREBUFFER)))
        return false;
    std::memcpy(destination, first, size < firstBytes ? size : firstBytes);
    Native(buffer)->Unlock(first, firstBytes, nullptr, 0);
    return true;
}

void Release(DeviceBuffer* buffer)
{
    Native(buffer)->Release();
}

void Release(Device3DBuffer* buffer)
{
    reinterpret_cast<IUnknown*>(buffer)->Release();
}

void Release(DeviceNotify* notify)
{
    reinterpret_cast<IUnknown*>(notify)->Release();
}

} // namespace device

} // namespace sound
