#pragma once

// Audio files made by the tests themselves: a RIFF writer and Ogg Vorbis
// through libvorbisenc. Shared by the tests, the benchmark and fuzzing.
#include "tests/support/ogg_pages.h"

#include <functional>

namespace testing_support
{

// A RIFF file built chunk by chunk; every chunk is padded to an even size.
class RiffWriter
{
public:
    RiffWriter& Chunk(const char* id, const Bytes& body);
    // A chunk whose size field claims `claimedSize` whatever the body holds.
    RiffWriter& ChunkClaiming(const char* id, std::uint32_t claimedSize, const Bytes& body);
    // "RIFF", the size of what follows, the form type and the chunks.
    Bytes Finish(const char* form = "WAVE") const;

private:
    Bytes chunks_;
};

struct WaveSpec
{
    std::uint16_t formatTag = 1;
    std::uint16_t channels = 2;
    std::uint32_t sampleRate = 44100;
    std::uint16_t bitsPerSample = 16;
    // Written after a u16 count for a tag other than 1.
    Bytes extra = {};
    std::uint32_t dataBytes = 0;
};

// The body of a "fmt " chunk: 16 bytes for PCM, else 18 plus the extra bytes.
Bytes FormatChunkBody(const WaveSpec& fixture);
// `size` bytes of a repeating pattern, so that misplaced data shows.
Bytes PatternBytes(std::size_t size);
// A whole wave file: "fmt " and a "data" chunk of fixture.dataBytes pattern bytes.
Bytes MakeWave(const WaveSpec& fixture);
// A wave of `seconds` of 8-bit mono at 1000 Hz, for music of a given length.
Bytes MakeWaveOfLength(double seconds);

// A tone in every channel whose level at each time is `dbfs(seconds)` (dB
// below full scale), in the given PCM or float (tag 3) format; the wave
// holds whole frames of `seconds`.
using LevelAt = std::function<double(double seconds)>;
Bytes MakeToneWave(const WaveSpec& format, double seconds, const LevelAt& dbfs);

struct OggFixture
{
    int channels = 2;
    long sampleRate = 44100;
    std::uint64_t samplesPerChannel = 44100;
    float quality = 0.1f;
};

// Fills `count` samples of each channel (`channels[c][i]`, in -1..1), the
// first of them being sample number `first` of the stream.
using SampleSource =
    std::function<void(float** channels, int channelCount, int count, std::uint64_t first)>;

// Encodes exactly fixture.samplesPerChannel samples per channel of
// `source`, or by default of a rising tone.
Bytes EncodeOggVorbis(const OggFixture& fixture, const SampleSource& source = nullptr);

} // namespace testing_support
