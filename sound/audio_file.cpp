#include "sound/audio_file.h"

#include "sound/byte_source.h"
#include "sound/ogg_decoder.h"
#include "sound/riff_reader.h"

#include <cstring>

namespace sound
{

SourceKind SourceKindOfPath(const char* path)
{
    const bool ogg = std::strstr(path, ".ogg") != nullptr || std::strstr(path, ".OGG") != nullptr;
    return ogg ? SourceKind::OggVorbis : SourceKind::Wave;
}

bool DecodeAudioFile(const char* path, DecodedAudio* out, SourceKind* kind,
                     const DecodeProgress& progress)
{
    out->Reset();
    if (path == nullptr)
        return false;
    *kind = SourceKindOfPath(path);
    bool decoded;
    if (*kind == SourceKind::OggVorbis)
    {
        decoded = DecodeOggVorbis(ReadMemoryFile(path), out, progress);
    }
    else
    {
        FileSource file;
        decoded = file.Open(path) && ReadWave(file, out);
    }
    if (decoded && IsOpenableFormat(*out->format))
    {
        if (progress)
            progress(*out, out->dataBytes);
        return true;
    }
    if (decoded && progress)
        progress(*out, 0);
    out->Reset();
    return false;
}

} // namespace sound
