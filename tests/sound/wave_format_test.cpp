// The static buffer's format rule as every build applies it, at the edges
// the real device's table (direct_sound_win32_test.cpp) proves on Windows.
#include "sound/wave_format.h"
#include "tests/support/audio_fixtures.h"

#include <gtest/gtest.h>
#include <tuple>

using testing_support::Bytes;
using testing_support::WaveSpec;

TEST(WaveFormatRule, EachTermHoldsAtItsEdge)
{
    // Extensible PCM: valid bits, the channel mask, then the sub-format GUID.
    const auto extensible = [](std::uint16_t bits, std::uint16_t validBits)
    {
        const Bytes pcmGuid = {1, 0, 0, 0, 0, 0, 0x10, 0, 0x80, 0, 0, 0xAA, 0, 0x38, 0x9B, 0x71};
        Bytes extra = {std::uint8_t(validBits), std::uint8_t(validBits >> 8), 3, 0, 0, 0};
        extra.insert(extra.end(), pcmGuid.begin(), pcmGuid.end());
        return testing_support::FormatChunkBody({.formatTag = 0xFFFE, .bitsPerSample = bits,
                                                 .extra = extra});
    };
    Bytes noChannels = testing_support::FormatChunkBody({.channels = 0});
    noChannels.resize(18);
    noChannels[8] = 1; // bytes per second given, so that only the channels refuse it
    const std::tuple<const char*, Bytes, bool> rows[] = {
        {"as many valid bits as bits", extensible(32, 32), true},
        {"a valid-bit count above 255", extensible(256, 256), true},
        {"one valid bit more than bits", extensible(16, 17), false},
        {"no channels", noChannels, false},
    };
    for (const auto& [what, body, playable] : rows)
        EXPECT_EQ(sound::IsPlayableFormat(*reinterpret_cast<const sound::WaveFormat*>(body.data())),
                  playable)
            << what;
}
