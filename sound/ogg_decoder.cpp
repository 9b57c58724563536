#include "sound/ogg_decoder.h"

#include "base/memory.h"

#include <algorithm>
#include <cstdio>
#include <cstring>
#include <limits>

#define OV_EXCLUDE_STATIC_CALLBACKS
#include <vorbis/vorbisfile.h>

namespace sound
{
namespace
{

constexpr long kReadChunkBytes = 4096;

std::size_t ReadCallback(void* buffer, std::size_t size, std::size_t count, void* source)
{
    auto* file = static_cast<MemoryFile*>(source);
    if (size == 0)
        return 0;
    const std::size_t available = file->size - file->position;
    const std::size_t wanted =
        count > std::numeric_limits<std::size_t>::max() / size ? available : size * count;
    const std::size_t copied = std::min(wanted, available);
    if (copied != 0)
        std::memcpy(buffer, file->data + file->position, copied);
    file->position += static_cast<std::uint32_t>(copied);
    return copied / size;
}

int SeekCallback(void* source, ogg_int64_t offset, int whence)
{
    auto* file = static_cast<MemoryFile*>(source);
    ogg_int64_t origin = 0;
    if (whence == SEEK_CUR)
        origin = file->position;
    else if (whence == SEEK_END)
        origin = file->size;
    // Clamped to the file; offsets past the range of the sum clamp too.
    ogg_int64_t target;
    if (offset > 0 && origin > std::numeric_limits<ogg_int64_t>::max() - offset)
        target = file->size;
    else
        target = origin + offset;
    file->position = static_cast<std::uint32_t>(std::clamp<ogg_int64_t>(target, 0, file->size));
    return 0;
}

long TellCallback(void* source)
{
    return static_cast<MemoryFile*>(source)->position;
}

int CloseCallback(void* source)
{
    DestroyMemoryFile(static_cast<MemoryFile*>(source));
    return 0;
}

MemoryFile* NewMemoryFile(std::size_t size)
{
    // The tell callback answers a long: 2 GiB - 1 on Windows.
    constexpr std::size_t kLargest = std::min<std::uint64_t>(
        std::numeric_limits<std::uint32_t>::max(), std::numeric_limits<long>::max());
    if (size > kLargest)
        return nullptr;
    auto* file = static_cast<MemoryFile*>(base::AllocateZeroed(sizeof(MemoryFile)));
    if (file == nullptr)
        return nullptr;
    file->data = static_cast<std::uint8_t*>(base::AllocateZeroed(size));
    if (file->data == nullptr)
    {
        base::FreeBlock(file);
        return nullptr;
    }
    file->size = static_cast<std::uint32_t>(size);
    return file;
}

} // namespace

MemoryFile* ReadMemoryFile(const char* path)
{
    std::FILE* stream = std::fopen(path, "rb");
    if (stream == nullptr)
        return nullptr;
    MemoryFile* file = nullptr;
    long end = -1;
    if (std::fseek(stream, 0, SEEK_END) == 0)
        end = std::ftell(stream);
    if (end >= 0 && std::fseek(stream, 0, SEEK_SET) == 0)
        file = NewMemoryFile(static_cast<std::size_t>(end));
    if (file != nullptr && std::fread(file->data, 1, file->size, stream) != file->size)
    {
        DestroyMemoryFile(file);
        file = nullptr;
    }
    std::fclose(stream);
    return file;
}

MemoryFile* CopyMemoryFile(const void* data, std::size_t size)
{
    MemoryFile* file = NewMemoryFile(size);
    if (file != nullptr && size != 0)
        std::memcpy(file->data, data, size);
    return file;
}

void DestroyMemoryFile(MemoryFile* file)
{
    if (file == nullptr)
        return;
    base::FreeBlock(file->data);
    base::FreeBlock(file);
}

bool DecodeOggVorbis(MemoryFile* file, DecodedAudio* out, const DecodeProgress& progress)
{
    out->Reset();
    if (file == nullptr)
        return false;
    const ov_callbacks callbacks{ReadCallback, SeekCallback, CloseCallback, TellCallback};
    OggVorbis_File vorbis;
    if (ov_open_callbacks(file, &vorbis, nullptr, 0, callbacks) != 0)
    {
        // On failure the decoder leaves the source to its caller.
        DestroyMemoryFile(file);
        return false;
    }
    // From here on ov_clear closes the in-memory file.
    const vorbis_info* info = ov_info(&vorbis, -1);
    const ogg_int64_t samples = ov_pcm_total(&vorbis, -1);
    if (info == nullptr || info->channels <= 0 || info->channels > 0xFFFF || info->rate <= 0 ||
        samples < 0 ||
        static_cast<std::uint64_t>(samples) >
            kMaxBufferBytes / (2u * static_cast<std::uint64_t>(info->channels)))
    {
        ov_clear(&vorbis);
        return false;
    }
    WaveFormat* format = AllocateFormat(0);
    const auto bytes = static_cast<std::uint32_t>(samples * info->channels * 2);
    auto* pcm = static_cast<std::uint8_t*>(base::AllocateZeroed(bytes));
    out->format = format;
    out->data = pcm;
    if (format == nullptr || pcm == nullptr)
    {
        ov_clear(&vorbis);
        out->Reset();
        return false;
    }
    format->formatTag = kFormatTagPcm;
    format->channels = static_cast<std::uint16_t>(info->channels);
    format->samplesPerSec = static_cast<std::uint32_t>(info->rate);
    format->bitsPerSample = 16;
    format->blockAlign = static_cast<std::uint16_t>(2 * info->channels);
    format->avgBytesPerSec = format->blockAlign * format->samplesPerSec;

    std::uint32_t written = 0;
    int section = 0;
    while (written < bytes)
    {
        const int wanted =
            static_cast<int>(std::min<std::uint32_t>(kReadChunkBytes, bytes - written));
        const long got = ov_read(&vorbis, reinterpret_cast<char*>(pcm + written), wanted,
                                 /*bigendianp=*/0, /*word=*/2, /*sgned=*/1, &section);
        if (got == 0)
            break;
        if (got == OV_HOLE)
            continue;
        if (got < 0 || got > wanted)
        {
            ov_clear(&vorbis);
            if (progress)
                progress(*out, 0);
            out->Reset();
            return false;
        }
        written += static_cast<std::uint32_t>(got);
        if (progress)
            progress(*out, written);
    }
    ov_clear(&vorbis);
    out->dataBytes = bytes;
    return true;
}

bool DecodeOggVorbisFromMemory(const void* data, std::size_t size, DecodedAudio* out)
{
    MemoryFile* file = CopyMemoryFile(data, size);
    if (file == nullptr)
    {
        out->Reset();
        return false;
    }
    return DecodeOggVorbis(file, out);
}

} // namespace sound
