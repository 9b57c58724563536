#pragma once

// How loud music sounds from second to second: its short-term loudness
// (EBU R128: K-weighted, a window of three seconds) through libebur128, one
// value for each whole second. Tension drafts follow it, and authors see how
// well a tension file does.

#include "sound/wave_format.h"

#include <cstddef>
#include <cstdint>
#include <memory>
#include <vector>

namespace sound
{

// No value lies below this: the measure's own gate, under which nothing
// counts as heard (silence included).
inline constexpr double kQuietestLoudness = -70.0;

// Rates below this are not measured: the K-weighting's shelf at 1.7 kHz
// comes too close to the highest frequency such audio holds.
inline constexpr std::uint32_t kLowestMeasuredRate = 8000;

// Measures PCM of one format that arrives in order. Value i (LUFS) is the
// short-term loudness of the three seconds from i - 1 to i + 2, centred on
// whole second i (the window clipped at the music's ends); there is one
// value for each whole second. Values are rounded to hundredths and never
// lie below kQuietestLoudness, so that both builds give the same values:
// their math libraries may differ in the last bit of the filter's
// coefficients.
class CLoudnessMeter
{
public:
    explicit CLoudnessMeter(const WaveFormat& format);
    ~CLoudnessMeter();
    CLoudnessMeter(const CLoudnessMeter&) = delete;
    CLoudnessMeter& operator=(const CLoudnessMeter&) = delete;

    // False for what is not measured: rates below kLowestMeasuredRate or
    // above libebur128's limit, more channels than it takes, and samples
    // other than 8, 16, 24 and 32-bit integers and 32 and 64-bit floats.
    bool CanMeasure() const { return filter_ != nullptr; }

    // Measures the whole frames of `block` up to `availableBytes` that it
    // has not measured yet: `block` is the PCM from its start, and grows.
    void MeasureUpTo(const std::uint8_t* block, std::size_t availableBytes);

    // The values; empty when nothing could be measured.
    std::vector<double> Finish();

private:
    void Feed(const std::uint8_t* frames, std::size_t count);
    void TakeValue();

    // libebur128's state; null when nothing can be measured.
    struct Filter;
    std::unique_ptr<Filter> filter_;
    std::uint16_t sampleTag_ = 0;
    std::uint16_t bytesPerSample_ = 0;
    std::uint32_t frameBytes_ = 0;
    std::uint32_t rate_ = 0;
    std::uint64_t measuredFrames_ = 0;
    // The loudness of the window that ends at each second mark, and at the
    // end of the music.
    std::vector<double> windowEnds_;
    std::vector<double> scratch_;
};

// The values of a whole decoded block.
std::vector<double> MeasureLoudness(const WaveFormat& format, const std::uint8_t* pcm,
                                    std::size_t bytes);

struct MusicMeasure
{
    // Seconds, as the check computes them.
    float length = 0.0f;
    // Empty when the music's format is not measured.
    std::vector<double> loudness;
};

// Decodes the music at `path` as the check decodes it and measures its
// loudness on a second thread while it is decoded, so that the measure
// costs little more than the decode. False for music the check cannot
// open: a file that does not decode, or whose format or size no static
// sound buffer takes.
bool MeasureMusic(const char* path, MusicMeasure* out);

} // namespace sound
