#pragma once

#include "sound/wave_format.h"

#include <cstddef>
#include <cstdint>

namespace sound
{

// A whole file in memory, served to the decoder through its read, seek,
// tell and close callbacks. The block and the object come from the in-house
// allocator.
struct MemoryFile
{
    std::uint8_t* data;
    std::uint32_t size;
    std::uint32_t position;
};

// Reads the whole file at `path` (mode "rb"); null when it cannot be opened
// or read, or is larger than the callbacks can address (4 GiB - 1, and
// 2 GiB - 1 on Windows, where the tell callback's long has 32 bits).
MemoryFile* ReadMemoryFile(const char* path);
// A copy of a block; null when it cannot be had.
MemoryFile* CopyMemoryFile(const void* data, std::size_t size);
void DestroyMemoryFile(MemoryFile* file);

// Decodes a whole Ogg Vorbis stream into 16-bit signed little-endian PCM in
// `out`, whose format becomes PCM with the stream's channels and rate. Takes
// `file` and destroys it in every case.
//
// The PCM block holds ov_pcm_total x channels x 2 bytes (refused before
// allocating when above kMaxBufferBytes). ov_read is asked for at most 4096
// bytes per call and never for more than the space left, so the write
// position only moves forwards and stays inside the block. Its results:
// 0 ends the stream (bytes not reached stay zero, that is silence); OV_HOLE,
// a gap in the pages, is skipped and decoding goes on after it; every other
// negative result (-1, a bad link, an invalid stream) fails the decode.
// Decoding stops when the block is full: samples beyond the count that
// ov_pcm_total announced are not kept. `progress`, when given, is told of
// every step of the write position, and of 0 before a failed decode frees
// the block.
bool DecodeOggVorbis(MemoryFile* file, DecodedAudio* out, const DecodeProgress& progress = {});

// The same over a copy of a block in memory (fuzz targets, tests).
bool DecodeOggVorbisFromMemory(const void* data, std::size_t size, DecodedAudio* out);

} // namespace sound
