// The static buffer's format rule as every build applies it, at edges of its
// terms; DirectSound under Wine answers the same for each of these formats
// (its table against the rule: direct_sound_win32_test.cpp).
#include "sound/wave_format.h"
#include "tests/support/audio_fixtures.h"

#include <gtest/gtest.h>
#include <tuple>

using testing_support::Bytes;

TEST(WaveFormatRule, EachTermHoldsAtItsEdge)
{
    // Extensible: valid bits, the channel mask, then the PCM sub-format's GUID.
    const auto extensible = [](std::uint16_t bits, std::uint16_t validBits)
    {
        Bytes extra = {0, 0,    3, 0,    0, 0, 1,    0, 0,    0,    0,
                       0, 0x10, 0, 0x80, 0, 0, 0xAA, 0, 0x38, 0x9B, 0x71};
        extra[0] = std::uint8_t(validBits);
        extra[1] = std::uint8_t(validBits >> 8);
        return testing_support::FormatChunkBody(
            {.formatTag = 0xFFFE, .bitsPerSample = bits, .extra = extra});
    };
    Bytes noChannels = testing_support::FormatChunkBody({.channels = 0});
    noChannels.resize(18);
    noChannels[8] = 1; // bytes per second given, so that only the channels refuse it
    const std::tuple<Bytes, bool> rows[] = {{extensible(32, 32), true},
                                            {extensible(256, 256), true},
                                            {extensible(16, 17), false},
                                            {noChannels, false}};
    for (const auto& [body, playable] : rows)
        EXPECT_EQ(sound::IsPlayableFormat(*reinterpret_cast<const sound::WaveFormat*>(body.data())),
                  playable)
            << "bits " << (body[14] | body[15] << 8) << ", channels " << int(body[2]);
}
