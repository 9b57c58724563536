#pragma once

#include "sound/resource_base.h"
#include "sound/sound_device.h"
#include "sound/wave_format.h"

#include <cstdint>

namespace sound
{

// The length and format of a buffer, shared with its play instances.
struct BufferInfo
{
    float length;            // seconds
    std::uint32_t dataBytes; // decoded PCM bytes
    std::uint16_t channels;
    std::uint16_t bytesPerSample; // bits per sample / 8
    std::uint32_t sampleRate;
    SourceKind sourceKind;
    std::uint32_t capsFlags; // as passed to Open
    WaveFormat* format;      // shared among clones
};

// One prepared playback voice: a duplicate of the master buffer. The tool
// never plays; the game's playback uses the two values.
struct PlayInstance
{
    DeviceBuffer* buffer;
    Device3DBuffer* buffer3D; // only with kCapsCtrl3D
    DeviceNotify* notify;     // only with kCapsCtrlPositionNotify
    const BufferInfo* owner;
    float playbackScale; // 1.0
    float playbackLimit; // 1.0e9
};

// One audio file decoded into a static sound buffer of the current device.
// Only whole-file mode (kCapsStatic) is implemented: the tool never streams.
class CSoundBuffer : public CResourceBase
{
public:
    static constexpr std::uint32_t kResourceType = 4;

    CSoundBuffer();
    // A clone: see Clone.
    CSoundBuffer(const CSoundBuffer& other);
    CSoundBuffer& operator=(const CSoundBuffer&) = delete;
    ~CSoundBuffer() override;

    // Opens the file at `path` through LoadFromFile's generic entry point:
    // Open(path, 1, kCapsStatic).
    bool LoadFromFile(const char* path) override;
    bool IsLoaded() const override;
    std::uint32_t GetResourceSize() const override;
    const char* GetClassName() const override;
    std::uint32_t GetClassSize() const override;
    CSoundBuffer* CreateAt(void* memory) const override;
    CSoundBuffer* Create() const override;
    // A clone duplicates the master buffer, copies the length to the format,
    // shares the format and the shared count (increasing it) and prepares the
    // same number of play instances. Null (CloneAt: the object destroyed)
    // when a duplicate cannot be made.
    CSoundBuffer* CloneAt(void* memory) const override;
    CSoundBuffer* Clone() const override;
    // Stops and releases every play instance, the master buffer, and, when
    // the shared count falls below 1, the format and the count; then the
    // name. May run twice.
    bool Release() override;

    // Decodes the whole file at `path` into a new master buffer and prepares
    // `instanceCount` play instances. A path containing ".ogg" or ".OGG" is
    // an Ogg Vorbis file, any other a RIFF wave file. Fails for a null path,
    // flags without kCapsStatic, a file that cannot be read or decoded, a
    // format with no channels, no sample rate or fewer than 8 bits per
    // sample, and any failure of the device. A buffer that was open before
    // is released first.
    bool Open(const char* path, std::uint32_t instanceCount, std::uint32_t capsFlags);
    // Seconds: data bytes / channels / sample rate / bytes per sample.
    float GetLength() const { return info_.length; }

    // Prepares `count` play instances, keeping the first ones that exist.
    bool SetInstanceCount(std::uint32_t count);

    const BufferInfo& GetInfo() const { return info_; }
    const WaveFormat* GetFormat() const { return info_.format; }
    std::uint32_t GetSharedCount() const { return sharedCount_ != nullptr ? *sharedCount_ : 0; }
    std::uint32_t GetInstanceCount() const { return instanceCount_; }
    const PlayInstance* GetInstance(std::uint32_t index) const;
    DeviceBuffer* GetMasterBuffer() const { return master_; }

private:
    // Release without the name.
    void ReleaseBuffers();
    bool PrepareInstance(PlayInstance& instance);
    static void ReleaseInstance(PlayInstance& instance);

    DeviceBuffer* master_ = nullptr;
    BufferInfo info_{};
    std::uint32_t* sharedCount_ = nullptr;
    PlayInstance* instances_ = nullptr;
    std::uint32_t instanceCount_ = 0;
};

} // namespace sound
