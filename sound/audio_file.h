#pragma once

#include "sound/wave_format.h"

namespace sound
{

// A path that contains ".ogg" or ".OGG" anywhere is an Ogg Vorbis file; any
// other path, ".Ogg" included, is a wave file.
SourceKind SourceKindOfPath(const char* path);

// Decodes the whole file at `path` by the path rule: a wave file through the
// RIFF reader, an Ogg Vorbis file read into memory and decoded completely.
// Needs no sound device and no window: the command-line companion and the
// tests call it directly. False for a null path, a missing or unreadable
// file, a file of neither form, and a format that cannot be opened.
// `progress`, when given, follows the decode and is told of the whole data
// last, when the decode succeeds (see DecodeProgress).
bool DecodeAudioFile(const char* path, DecodedAudio* out, SourceKind* kind,
                     const DecodeProgress& progress = {});

} // namespace sound
