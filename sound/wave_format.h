#pragma once

#include <cstddef>
#include <cstdint>

namespace sound
{

inline constexpr std::uint16_t kFormatTagPcm = 1;

// Sizes a static DirectSound buffer can have (DSBSIZE_MIN, DSBSIZE_MAX). The
// decoders refuse more data than that before allocating it, since no buffer
// could take it; the POSIX stand-in applies the same limits.
inline constexpr std::uint32_t kMinBufferBytes = 4;
inline constexpr std::uint32_t kMaxBufferBytes = 0x0FFFFFFF;

#pragma pack(push, 1)
// The layout of WAVEFORMATEX: 18 bytes, then `extraSize` extra format bytes.
struct WaveFormat
{
    std::uint16_t formatTag;
    std::uint16_t channels;
    std::uint32_t samplesPerSec;
    std::uint32_t avgBytesPerSec;
    std::uint16_t blockAlign;
    std::uint16_t bitsPerSample;
    std::uint16_t extraSize;
};
#pragma pack(pop)
static_assert(sizeof(WaveFormat) == 18);

// A zero-filled format block from the in-house allocator with room for
// `extraSize` extra bytes (its extraSize is set); null when it cannot be had.
WaveFormat* AllocateFormat(std::uint16_t extraSize);
std::size_t FormatBytes(const WaveFormat& format);
// The extra bytes that follow the 18 bytes of a format block.
const std::uint8_t* ExtraFormatBytes(const WaveFormat& format);

// A format that the length formula can divide by: at least one channel, a
// sample rate above zero and at least 8 bits per sample.
bool IsOpenableFormat(const WaveFormat& format);

// Seconds of `dataBytes` bytes of the format: bytes / channels / rate /
// (bits per sample / 8), in double precision, stored as a 32-bit float.
// Only for an openable format.
float ComputeLength(std::uint32_t dataBytes, const WaveFormat& format);

// Where a file's audio came from.
enum class SourceKind : std::uint32_t
{
    Wave = 0,
    OggVorbis = 1,
};

// One completely decoded file: its format and its PCM bytes, both owned
// blocks of the in-house allocator, freed with the object.
class DecodedAudio
{
public:
    DecodedAudio() = default;
    DecodedAudio(const DecodedAudio&) = delete;
    DecodedAudio& operator=(const DecodedAudio&) = delete;
    ~DecodedAudio() { Reset(); }

    void Reset();

    WaveFormat* format = nullptr;
    std::uint8_t* data = nullptr;
    std::uint32_t dataBytes = 0;
};

} // namespace sound
