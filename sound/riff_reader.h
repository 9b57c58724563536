#pragma once

#include "sound/byte_source.h"
#include "sound/wave_format.h"

#include <cstddef>
#include <cstdint>

namespace sound
{

// Where a wave file keeps its audio, as the RIFF rules find it.
struct WaveLayout
{
    WaveFormat* format = nullptr; // owned by the caller after a success
    std::uint64_t dataOffset = 0;
    std::uint32_t dataBytes = 0;
};

// The RIFF rules of a wave file, on any platform:
// - the first top-level "RIFF" chunk whose form type is "WAVE" (chunks are
//   padded to even sizes; a RIFF size beyond the end of the file is cut to it);
// - inside it, the first "fmt " chunk of at least 16 bytes: format tag,
//   channels, samples per second, average bytes per second, block align and
//   bits per sample. PCM (tag 1) has no extra bytes. Any other tag reads a
//   u16 count of extra bytes and the bytes themselves, which must lie inside
//   the chunk; a chunk of 16 or 17 bytes has no room for the count and then
//   has none;
// - after "fmt ", the first "data" chunk inside the RIFF chunk.
// False when any of them is missing or short; nothing is allocated then.
bool ReadWaveLayout(ByteSource& source, WaveLayout* layout);

// The whole wave file: its layout, then the data chunk's bytes into a new
// block. Refused before anything is allocated for the data: a data chunk
// that claims more bytes than the file has, one larger than any sound buffer
// (kMaxBufferBytes), and a format that is not openable (IsOpenableFormat).
bool ReadWave(ByteSource& source, DecodedAudio* out);

// The same over a block in memory (fuzz targets, tests).
bool ReadWaveFromMemory(const void* data, std::size_t size, DecodedAudio* out);

} // namespace sound
