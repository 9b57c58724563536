// The POSIX stand-in for DirectSound: no audio output, the same operations.
// A buffer keeps its PCM in memory; duplicates share it. Buffers need no
// device, so that decoding works without a window.
#include "base/memory.h"
#include "sound/sound_device.h"

#include <cstring>
#include <mutex>
#include <new>

namespace sound
{

struct DeviceApi
{
};

struct CSound::Platform
{
    std::mutex lock;
};

// The block of PCM that a master buffer and its duplicates share.
struct PcmStore
{
    std::uint8_t* data;
    std::uint32_t bytes;
    std::uint32_t references;
};

struct DeviceBuffer : base::CAllocated
{
    PcmStore* store;
    std::uint32_t playPosition;
};

namespace
{

CSound* currentSound = nullptr;

// What DirectSound reports for rates (DSBFREQUENCY_MIN, DSBFREQUENCY_MAX).
constexpr std::uint32_t kMinRate = 100;
constexpr std::uint32_t kMaxRate = 200000;

} // namespace

CSound::CSound() = default;

CSound::~CSound()
{
    delete platform_;
    if (currentSound == this)
        currentSound = nullptr;
}

const char* CSound::GetClassName() const
{
    return "CSound";
}

bool CSound::Init(void* windowHandle)
{
    return InitWith(windowHandle, DeviceApi{});
}

bool CSound::InitWith(void* windowHandle, const DeviceApi&)
{
    if (windowHandle == nullptr)
        return false;
    window_ = windowHandle;
    if (platform_ == nullptr)
        platform_ = new (std::nothrow) Platform();
    if (platform_ == nullptr)
        return false;
    maxSecondaryRate_ = kMaxRate;
    minSecondaryRate_ = kMinRate;
    currentSound = this;
    return true;
}

CSound* CurrentSound()
{
    return currentSound;
}

namespace device
{

DeviceBuffer* CreateStaticBuffer(const WaveFormat& format, std::uint32_t, std::uint8_t*& pcm,
                                 std::uint32_t bytes)
{
    if (pcm == nullptr || !FitsStaticBuffer(format, bytes))
        return nullptr;
    auto* store = static_cast<PcmStore*>(base::AllocateZeroed(sizeof(PcmStore)));
    auto* buffer = new (std::nothrow) DeviceBuffer();
    if (store == nullptr || buffer == nullptr)
    {
        base::FreeBlock(store);
        delete buffer;
        return nullptr;
    }
    *store = PcmStore{pcm, bytes, 1};
    buffer->store = store;
    pcm = nullptr;
    return buffer;
}

DeviceBuffer* Duplicate(DeviceBuffer* master)
{
    auto* duplicate = new (std::nothrow) DeviceBuffer();
    if (duplicate == nullptr)
        return nullptr;
    duplicate->store = master->store;
    ++master->store->references;
    return duplicate;
}

Device3DBuffer* Query3DBuffer(DeviceBuffer*)
{
    return nullptr;
}

DeviceNotify* QueryNotify(DeviceBuffer*)
{
    return nullptr;
}

void StopAndRewind(DeviceBuffer* buffer)
{
    CSound* sound = CurrentSound();
    if (sound != nullptr && sound->GetPlatform() != nullptr)
    {
        std::lock_guard<std::mutex> guard(sound->GetPlatform()->lock);
        buffer->playPosition = 0;
        return;
    }
    buffer->playPosition = 0;
}

bool ReadBack(DeviceBuffer* buffer, std::uint8_t* destination, std::uint32_t size)
{
    const std::uint32_t bytes = size < buffer->store->bytes ? size : buffer->store->bytes;
    std::memcpy(destination, buffer->store->data, bytes);
    return true;
}

void Release(DeviceBuffer* buffer)
{
    if (--buffer->store->references == 0)
    {
        base::FreeBlock(buffer->store->data);
        base::FreeBlock(buffer->store);
    }
    delete buffer;
}

void Release(Device3DBuffer*) {}

void Release(DeviceNotify*) {}

} // namespace device

} // namespace sound
