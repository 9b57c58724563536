#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>

namespace sound
{

inline constexpr std::uint16_t kFormatTagPcm = 1;
inline constexpr std::uint16_t kFormatTagIeeeFloat = 3;
inline constexpr std::uint16_t kFormatTagExtensible = 0xFFFE;
// WAVEFORMATEXTENSIBLE: the 18 bytes of the format, then 22 extra bytes
// (valid bits per sample, channel mask, sub-format GUID); 40 in all.
inline constexpr std::uint16_t kExtensibleExtraBytes = 22;
inline constexpr std::uint16_t kExtensibleStructBytes = 40;

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

// Whether DirectSound makes a secondary buffer of the format (followed by
// its `extraSize` extra bytes), as measured under Wine: format tag PCM or
// IEEE float, or WAVE_FORMAT_EXTENSIBLE with 22 extra bytes (40 pass too),
// a PCM or float sub-format and no more valid bits than bits; whole bytes
// per sample; channels, rate and bytes per second above zero; block align
// exactly channels x bytes per sample. Neither a range of rates nor bytes
// per second = rate x block align is required. The POSIX stand-in refuses
// what this refuses, so that both builds turn away the same files.
bool IsPlayableFormat(const WaveFormat& format);

// Whether a static buffer takes `bytes` bytes of the format: a playable
// format and a size from kMinBufferBytes to kMaxBufferBytes.
bool FitsStaticBuffer(const WaveFormat& format, std::uint32_t bytes);

// The tag that says how samples are stored: the format tag, or for
// WAVE_FORMAT_EXTENSIBLE the tag at the head of its sub-format GUID. Only
// for a playable format.
std::uint16_t SampleFormatTag(const WaveFormat& format);

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

// Told while a decoder fills `audio.data`: the first `decodedBytes` bytes
// are final. Called on the decoding thread, with counts that only grow,
// except a last count of 0 before a decoder that fails frees the block:
// from then on the block must not be read.
using DecodeProgress = std::function<void(const DecodedAudio& audio, std::uint32_t decodedBytes)>;

} // namespace sound
