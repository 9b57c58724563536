#include "sound/wave_format.h"

#include "base/memory.h"

#include <cstring>

namespace sound
{

WaveFormat* AllocateFormat(std::uint16_t extraSize)
{
    auto* format = static_cast<WaveFormat*>(base::AllocateZeroed(sizeof(WaveFormat) + extraSize));
    if (format != nullptr)
        format->extraSize = extraSize;
    return format;
}

std::size_t FormatBytes(const WaveFormat& format)
{
    return sizeof(WaveFormat) + format.extraSize;
}

const std::uint8_t* ExtraFormatBytes(const WaveFormat& format)
{
    return reinterpret_cast<const std::uint8_t*>(&format) + sizeof(WaveFormat);
}

bool IsOpenableFormat(const WaveFormat& format)
{
    return format.channels != 0 && format.samplesPerSec != 0 && format.bitsPerSample >= 8;
}

namespace
{

// KSDATAFORMAT_SUBTYPE_PCM and _IEEE_FLOAT as stored: the format tag in the
// GUID's first two bytes, then the bytes these sub-formats share.
constexpr std::uint8_t kSubFormatTail[14] = {0x00, 0x00, 0x00, 0x00, 0x10, 0x00, 0x80,
                                             0x00, 0x00, 0xAA, 0x00, 0x38, 0x9B, 0x71};
constexpr std::size_t kSubFormatOffset = 6;

bool IsMixableTag(std::uint16_t tag)
{
    return tag == kFormatTagPcm || tag == kFormatTagIeeeFloat;
}

std::uint16_t SubFormatTag(const WaveFormat& format)
{
    const std::uint8_t* subFormat = ExtraFormatBytes(format) + kSubFormatOffset;
    return std::uint16_t(subFormat[0] | subFormat[1] << 8);
}

bool IsPlayableExtensible(const WaveFormat& format)
{
    if (format.extraSize < kExtensibleExtraBytes)
        return false;
    const std::uint8_t* extra = ExtraFormatBytes(format);
    const std::uint8_t* subFormat = extra + kSubFormatOffset;
    const bool mixable = IsMixableTag(SubFormatTag(format)) &&
                         std::memcmp(subFormat + 2, kSubFormatTail, sizeof kSubFormatTail) == 0;
    // More extra bytes than the structure's own are refused, except a count
    // that is the whole structure's size.
    const bool sized =
        format.extraSize == kExtensibleExtraBytes || format.extraSize == kExtensibleStructBytes;
    const std::uint16_t validBits = std::uint16_t(extra[0] | extra[1] << 8);
    return mixable && sized && validBits <= format.bitsPerSample;
}

} // namespace

bool IsPlayableFormat(const WaveFormat& format)
{
    if (!IsMixableTag(format.formatTag) && format.formatTag != kFormatTagExtensible)
        return false;
    const std::uint32_t frameBytes = std::uint32_t(format.channels) * format.bitsPerSample / 8u;
    const bool consistent = format.bitsPerSample >= 8 && format.bitsPerSample % 8 == 0 &&
                            format.channels != 0 && format.samplesPerSec != 0 &&
                            format.avgBytesPerSec != 0 && format.blockAlign == frameBytes;
    if (!consistent)
        return false;
    return format.formatTag != kFormatTagExtensible || IsPlayableExtensible(format);
}

bool FitsStaticBuffer(const WaveFormat& format, std::uint32_t bytes)
{
    return bytes >= kMinBufferBytes && bytes <= kMaxBufferBytes && IsPlayableFormat(format);
}

std::uint16_t SampleFormatTag(const WaveFormat& format)
{
    return format.formatTag == kFormatTagExtensible ? SubFormatTag(format) : format.formatTag;
}

float ComputeLength(std::uint32_t dataBytes, const WaveFormat& format)
{
    const unsigned bytesPerSample = format.bitsPerSample / 8u;
    return static_cast<float>(static_cast<double>(dataBytes) / format.channels /
                              format.samplesPerSec / bytesPerSample);
}

void DecodedAudio::Reset()
{
    base::FreeBlock(format);
    base::FreeBlock(data);
    format = nullptr;
    data = nullptr;
    dataBytes = 0;
}

} // namespace sound
