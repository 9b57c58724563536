#include "sound/sound_buffer.h"

#include "base/memory.h"
#include "sound/audio_file.h"

#include <cstring>
#include <new>

namespace sound
{
namespace
{

std::uint32_t* NewSharedCount()
{
    auto* count = static_cast<std::uint32_t*>(base::AllocateZeroed(sizeof(std::uint32_t)));
    if (count != nullptr)
        *count = 1;
    return count;
}

} // namespace

CSoundBuffer::CSoundBuffer()
{
    SetType(kResourceType);
    sharedCount_ = NewSharedCount();
}

CSoundBuffer::CSoundBuffer(const CSoundBuffer& other) : CResourceBase(other)
{
    info_ = other.info_;
    sharedCount_ = other.sharedCount_;
    if (sharedCount_ != nullptr)
        ++*sharedCount_;
    if (other.master_ != nullptr)
        master_ = device::Duplicate(other.master_);
    if (other.master_ != nullptr && master_ == nullptr)
        return;
    SetInstanceCount(other.instanceCount_);
}

CSoundBuffer::~CSoundBuffer()
{
    Release();
}

bool CSoundBuffer::LoadFromFile(const char* path)
{
    return Open(path, 1, kCapsStatic);
}

bool CSoundBuffer::IsLoaded() const
{
    return master_ != nullptr;
}

std::uint32_t CSoundBuffer::GetResourceSize() const
{
    return info_.dataBytes;
}

const char* CSoundBuffer::GetClassName() const
{
    return "CSoundBuffer";
}

std::uint32_t CSoundBuffer::GetClassSize() const
{
    return sizeof(CSoundBuffer);
}

CSoundBuffer* CSoundBuffer::CreateAt(void* memory) const
{
    return new (memory) CSoundBuffer();
}

CSoundBuffer* CSoundBuffer::Create() const
{
    return new (std::nothrow) CSoundBuffer();
}

CSoundBuffer* CSoundBuffer::CloneAt(void* memory) const
{
    auto* clone = new (memory) CSoundBuffer(*this);
    const bool complete = (master_ == nullptr || clone->master_ != nullptr) &&
                          clone->instanceCount_ == instanceCount_;
    if (complete)
        return clone;
    clone->~CSoundBuffer();
    return nullptr;
}

CSoundBuffer* CSoundBuffer::Clone() const
{
    void* memory = base::AllocateZeroed(sizeof(CSoundBuffer));
    if (memory == nullptr)
        return nullptr;
    CSoundBuffer* clone = CloneAt(memory);
    if (clone == nullptr)
        base::FreeBlock(memory);
    return clone;
}

bool CSoundBuffer::Release()
{
    ReleaseBuffers();
    CResourceBase::Release();
    return true;
}

void CSoundBuffer::ReleaseBuffers()
{
    for (std::uint32_t i = 0; i < instanceCount_; ++i)
        ReleaseInstance(instances_[i]);
    base::FreeBlock(instances_);
    instances_ = nullptr;
    instanceCount_ = 0;
    if (master_ != nullptr)
    {
        device::Release(master_);
        master_ = nullptr;
    }
    if (sharedCount_ != nullptr && --*sharedCount_ < 1)
    {
        base::FreeBlock(info_.format);
        base::FreeBlock(sharedCount_);
    }
    sharedCount_ = nullptr;
    info_.format = nullptr;
}

bool CSoundBuffer::Open(const char* path, std::uint32_t instanceCount, std::uint32_t capsFlags)
{
    if (path == nullptr || (capsFlags & kCapsStatic) == 0)
        return false;
    // The name stays until the new one replaces it: `path` may be the name.
    if (master_ != nullptr || info_.format != nullptr || sharedCount_ == nullptr)
    {
        ReleaseBuffers();
        sharedCount_ = NewSharedCount();
        if (sharedCount_ == nullptr)
            return false;
    }
    info_ = BufferInfo{};

    DecodedAudio audio;
    SourceKind kind;
    if (!DecodeAudioFile(path, &audio, &kind))
        return false;
    const WaveFormat& format = *audio.format;
    BufferInfo info{};
    info.dataBytes = audio.dataBytes;
    info.channels = format.channels;
    info.sampleRate = format.samplesPerSec;
    info.bytesPerSample = static_cast<std::uint16_t>(format.bitsPerSample / 8);
    info.length = ComputeLength(audio.dataBytes, format);
    info.sourceKind = kind;
    info.capsFlags = capsFlags;

    master_ = device::CreateStaticBuffer(format, capsFlags, audio.data, audio.dataBytes);
    if (master_ == nullptr)
        return false;
    // The buffer holds the data now (audio frees what is left of it); the
    // format is the buffer's to keep.
    info.format = audio.format;
    audio.format = nullptr;
    info_ = info;

    return SetInstanceCount(instanceCount) && SetName(path);
}

bool CSoundBuffer::SetInstanceCount(std::uint32_t count)
{
    auto* instances =
        static_cast<PlayInstance*>(base::AllocateZeroed(count * sizeof(PlayInstance)));
    if (instances == nullptr)
        return false;
    for (std::uint32_t i = count; i < instanceCount_; ++i)
        ReleaseInstance(instances_[i]);
    const std::uint32_t kept = count < instanceCount_ ? count : instanceCount_;
    if (kept != 0)
        std::memcpy(instances, instances_, kept * sizeof(PlayInstance));
    base::FreeBlock(instances_);
    instances_ = instances;
    instanceCount_ = count;
    for (std::uint32_t i = 0; i < count; ++i)
    {
        if (instances_[i].buffer == nullptr && !PrepareInstance(instances_[i]))
            return false;
    }
    return true;
}

const PlayInstance* CSoundBuffer::GetInstance(std::uint32_t index) const
{
    return index < instanceCount_ ? &instances_[index] : nullptr;
}

bool CSoundBuffer::PrepareInstance(PlayInstance& instance)
{
    if (master_ == nullptr)
        return false;
    instance.buffer = device::Duplicate(master_);
    if (instance.buffer == nullptr)
        return false;
    instance.owner = &info_;
    instance.playbackScale = 1.0f;
    instance.playbackLimit = 1.0e9f;
    if ((info_.capsFlags & kCapsCtrl3D) != 0)
        instance.buffer3D = device::Query3DBuffer(instance.buffer);
    if ((info_.capsFlags & kCapsCtrlPositionNotify) != 0)
        instance.notify = device::QueryNotify(instance.buffer);
    return true;
}

void CSoundBuffer::ReleaseInstance(PlayInstance& instance)
{
    if (instance.buffer != nullptr)
        device::StopAndRewind(instance.buffer);
    if (instance.notify != nullptr)
        device::Release(instance.notify);
    if (instance.buffer3D != nullptr)
        device::Release(instance.buffer3D);
    if (instance.buffer != nullptr)
        device::Release(instance.buffer);
    instance = PlayInstance{};
}

} // namespace sound
