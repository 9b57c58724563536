#include "sound/wave_format.h"

#include "base/memory.h"

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
