#include "sound/riff_reader.h"

#include "base/memory.h"

#include <algorithm>
#include <cstring>

namespace sound
{
namespace
{

constexpr std::size_t kChunkHeaderBytes = 8;
constexpr std::uint32_t kFormatFieldBytes = 16;

struct Chunk
{
    std::uint64_t dataOffset;
    std::uint32_t size;
};

std::uint32_t ReadU32(const std::uint8_t* bytes)
{
    return std::uint32_t(bytes[0]) | std::uint32_t(bytes[1]) << 8 | std::uint32_t(bytes[2]) << 16 |
           std::uint32_t(bytes[3]) << 24;
}

std::uint64_t NextChunkOffset(const Chunk& chunk)
{
    return chunk.dataOffset + chunk.size + (chunk.size & 1u);
}

// The next chunk whose header lies in [begin, end) and whose id is `id`
// (and, when `form` is given, whose first four data bytes are `form`).
bool FindChunk(ByteSource& source, std::uint64_t begin, std::uint64_t end, const char* id,
               const char* form, Chunk* found)
{
    std::uint64_t position = begin;
    while (position + kChunkHeaderBytes <= end)
    {
        std::uint8_t header[kChunkHeaderBytes];
        if (!source.ReadAt(position, header, sizeof header))
            return false;
        const Chunk chunk{position + kChunkHeaderBytes, ReadU32(header + 4)};
        if (std::memcmp(header, id, 4) == 0)
        {
            char type[4];
            if (form == nullptr || (chunk.size >= 4 && source.ReadAt(chunk.dataOffset, type, 4) &&
                                    std::memcmp(type, form, 4) == 0))
            {
                *found = chunk;
                return true;
            }
        }
        position = NextChunkOffset(chunk);
    }
    return false;
}

WaveFormat* ReadFormat(ByteSource& source, const Chunk& fmt)
{
    std::uint8_t fields[kFormatFieldBytes];
    if (!source.ReadAt(fmt.dataOffset, fields, sizeof fields))
        return nullptr;
    std::uint16_t extraSize = 0;
    const std::uint16_t tag = std::uint16_t(fields[0] | fields[1] << 8);
    if (tag != kFormatTagPcm && fmt.size >= kFormatFieldBytes + 2)
    {
        std::uint8_t count[2];
        if (!source.ReadAt(fmt.dataOffset + kFormatFieldBytes, count, sizeof count))
            return nullptr;
        extraSize = std::uint16_t(count[0] | count[1] << 8);
        if (kFormatFieldBytes + 2u + extraSize > fmt.size)
            return nullptr;
    }
    WaveFormat* format = AllocateFormat(extraSize);
    if (format == nullptr)
        return nullptr;
    std::memcpy(format, fields, sizeof fields);
    format->extraSize = extraSize;
    if (extraSize != 0 &&
        !source.ReadAt(fmt.dataOffset + kFormatFieldBytes + 2,
                       reinterpret_cast<std::uint8_t*>(format) + sizeof(WaveFormat), extraSize))
    {
        base::FreeBlock(format);
        return nullptr;
    }
    return format;
}

} // namespace

bool ReadWaveLayout(ByteSource& source, WaveLayout* layout)
{
    const std::uint64_t fileEnd = source.Size();
    Chunk riff;
    if (!FindChunk(source, 0, fileEnd, "RIFF", "WAVE", &riff))
        return false;
    const std::uint64_t riffEnd = std::min(riff.dataOffset + riff.size, fileEnd);
    Chunk fmt;
    if (!FindChunk(source, riff.dataOffset + 4, riffEnd, "fmt ", nullptr, &fmt) ||
        fmt.size < kFormatFieldBytes)
        return false;
    Chunk data;
    if (!FindChunk(source, NextChunkOffset(fmt), riffEnd, "data", nullptr, &data))
        return false;
    WaveFormat* format = ReadFormat(source, fmt);
    if (format == nullptr)
        return false;
    layout->format = format;
    layout->dataOffset = data.dataOffset;
    layout->dataBytes = data.size;
    return true;
}

bool ReadWave(ByteSource& source, DecodedAudio* out)
{
    out->Reset();
    WaveLayout layout;
    if (!ReadWaveLayout(source, &layout))
        return false;
    out->format = layout.format;
    const bool fits =
        layout.dataOffset <= source.Size() && layout.dataBytes <= source.Size() - layout.dataOffset;
    if (!fits || layout.dataBytes > kMaxBufferBytes || !IsOpenableFormat(*layout.format))
    {
        out->Reset();
        return false;
    }
    out->data = static_cast<std::uint8_t*>(base::AllocateZeroed(layout.dataBytes));
    if (out->data == nullptr || !source.ReadAt(layout.dataOffset, out->data, layout.dataBytes))
    {
        out->Reset();
        return false;
    }
    out->dataBytes = layout.dataBytes;
    return true;
}

bool ReadWaveFromMemory(const void* data, std::size_t size, DecodedAudio* out)
{
    MemorySource source(data, size);
    return ReadWave(source, out);
}

} // namespace sound
