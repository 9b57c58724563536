// The RIFF reader over any bytes. Besides never crashing or reading past
// the file: an accepted file has a format the length formula can divide by,
// its data lies inside the file, and its length is a finite number.
#include "fuzz/fuzz_support.h"
#include "sound/riff_reader.h"

#include <cmath>
#include <cstddef>
#include <cstdint>

using fuzzing::Require;

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    sound::DecodedAudio audio;
    if (!sound::ReadWaveFromMemory(data, size, &audio))
    {
        Require(audio.format == nullptr && audio.data == nullptr, "a refused file keeps nothing");
        return 0;
    }
    Require(audio.format != nullptr && sound::IsOpenableFormat(*audio.format),
            "an accepted format can be opened");
    Require(audio.dataBytes <= size && (audio.dataBytes == 0 || audio.data != nullptr),
            "the data lies inside the file");
    Require(sound::FormatBytes(*audio.format) <= size, "the format lies inside the file");
    Require(std::isfinite(sound::ComputeLength(audio.dataBytes, *audio.format)),
            "the length is a number");
    return 0;
}
