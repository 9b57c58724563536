// The Ogg Vorbis decoder over any bytes, decoding from memory as the tool
// does. Besides never crashing or writing outside the PCM block: an accepted
// stream is 16-bit PCM with at least one channel and a sample rate, whose
// block holds whole sample frames and fits a sound buffer.
//
// The mutator repairs page checksums after most mutations (see ogg_pages.h);
// one in four keeps them as they come, so that bad checksums are tried too.
#include "fuzz/fuzz_support.h"
#include "sound/ogg_decoder.h"
#include "tests/support/ogg_pages.h"

#include <cstddef>
#include <cstdint>

using fuzzing::Require;

extern "C" std::size_t LLVMFuzzerMutate(std::uint8_t* data, std::size_t size, std::size_t maxSize);

extern "C" std::size_t LLVMFuzzerCustomMutator(std::uint8_t* data, std::size_t size,
                                               std::size_t maxSize, unsigned int seed)
{
    size = LLVMFuzzerMutate(data, size, maxSize);
    if (seed % 4 != 0)
        testing_support::RepairOggChecksums(data, size);
    return size;
}

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    sound::DecodedAudio audio;
    if (!sound::DecodeOggVorbisFromMemory(data, size, &audio))
    {
        Require(audio.format == nullptr && audio.data == nullptr, "a refused stream keeps nothing");
        return 0;
    }
    const sound::WaveFormat* format = audio.format;
    Require(format != nullptr && format->formatTag == sound::kFormatTagPcm &&
                format->bitsPerSample == 16 && sound::IsOpenableFormat(*format),
            "an accepted stream is 16-bit PCM that can be opened");
    Require(format->blockAlign == 2 * format->channels && audio.dataBytes % format->blockAlign == 0,
            "the block holds whole sample frames");
    Require(audio.dataBytes <= sound::kMaxBufferBytes, "the block fits a sound buffer");
    Require(audio.dataBytes == 0 || audio.data != nullptr, "the block exists");
    return 0;
}
