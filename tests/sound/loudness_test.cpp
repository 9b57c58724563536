// The music's loudness, a value for each whole second, on one decode.
#include "sound/audio_file.h"
#include "sound/loudness.h"
#include "tests/support/audio_fixtures.h"
#include "tests/support/temp_folder.h"

#include <cmath>
#include <gtest/gtest.h>
#include <tuple>

namespace
{

// Seconds 0 to 4 at -23 dBFS, then -33 dBFS.
double Step(double seconds)
{
    return seconds < 5.0 ? -23.0 : -33.0;
}

std::vector<double> Measured(const testing_support::Bytes& wave)
{
    const testing_support::TempFolder folder;
    const std::string path = folder.File("tone.wav");
    testing_support::WriteBytes(path, wave);
    sound::DecodedAudio audio;
    sound::SourceKind kind;
    if (!sound::DecodeAudioFile(path.c_str(), &audio, &kind))
        return {};
    return sound::MeasureLoudness(*audio.format, audio.data, audio.dataBytes);
}

// The reference tone of the measure: a stereo sine at -23 dBFS measures
// -23 LUFS. Each value is that of the three seconds centred on its second,
// in hundredths.
TEST(Loudness, EachWholeSecondHasTheShortTermLoudnessOfTheWindowAroundIt)
{
    const std::vector<double> values =
        Measured(testing_support::MakeToneWave({1, 2, 48000, 16, {}, 0}, 10.5, Step));
    ASSERT_EQ(values.size(), 10u);
    // From 2 to 5 s and from 5 to 8 s one level each; the last, clipped at
    // the end, from 8 s on.
    EXPECT_NEAR(values[3], -23.0, 0.1);
    EXPECT_NEAR(values[6], -33.0, 0.1);
    EXPECT_NEAR(values[9], -33.0, 0.1);
    for (const double value : values)
        EXPECT_EQ(value, std::round(value * 100.0) / 100.0);
}

// The same tone in every sample format the measure reads gives the same
// values (8 bits: a top of 127 of 128, and louder, above its noise); other
// formats, and rates too low for the weighting, give none.
TEST(Loudness, EveryMeasuredFormatAgreesAndTheRestGiveNone)
{
    const auto loud = [](double seconds) { return Step(seconds) + 13.0; };
    const std::vector<double> reference =
        Measured(testing_support::MakeToneWave({1, 1, 8000, 16, {}, 0}, 10.0, loud));
    ASSERT_EQ(reference.size(), 10u);
    const std::tuple<std::uint16_t, std::uint32_t, std::uint16_t, bool> rows[] = {
        {1, 8000, 8, true},  {1, 8000, 24, true},  {1, 8000, 32, true},  {3, 8000, 32, true},
        {3, 8000, 64, true}, {1, 8000, 40, false}, {3, 8000, 16, false}, {1, 7999, 16, false}};
    for (const auto& [tag, rate, bits, measured] : rows)
    {
        const std::vector<double> values =
            Measured(testing_support::MakeToneWave({tag, 1, rate, bits, {}, 0}, 10.0, loud));
        ASSERT_EQ(values.size(), measured ? reference.size() : 0u) << tag << " " << bits;
        for (std::size_t i = 0; i < values.size(); ++i)
            EXPECT_NEAR(values[i], reference[i], 0.1) << tag << " " << bits << " second " << i;
    }
}

// Measured while it decodes, on a second thread: the same values as a
// measure of the whole block, and the check's length; nothing for music
// the check cannot open.
TEST(Loudness, MusicIsMeasuredWhileItDecodesAsTheCheckWouldOpenIt)
{
    const testing_support::TempFolder folder;
    const std::string ogg = folder.File("rising.ogg"), adpcm = folder.File("adpcm.wav");
    testing_support::OggFixture fixture;
    fixture.samplesPerChannel = 44100 * 12 + 100;
    const auto rising = [](float** channels, int count, int frames, std::uint64_t first)
    {
        for (int i = 0; i < frames * count; ++i)
        {
            const double t = double(first + std::uint64_t(i / count)) / 44100.0;
            channels[i % count][i / count] =
                float(std::pow(10.0, (t * 3.0 - 50.0) / 20.0) * std::sin(6283.0 * t));
        }
    };
    testing_support::WriteBytes(ogg, testing_support::EncodeOggVorbis(fixture, rising));
    testing_support::WriteBytes(adpcm, testing_support::MakeWave({2, 1, 8000, 16, {}, 16000}));

    sound::MusicMeasure music;
    ASSERT_TRUE(sound::MeasureMusic(ogg.c_str(), &music));
    EXPECT_FLOAT_EQ(music.length, (44100.0f * 12 + 100) / 44100.0f);
    sound::DecodedAudio audio;
    sound::SourceKind kind;
    ASSERT_TRUE(sound::DecodeAudioFile(ogg.c_str(), &audio, &kind));
    EXPECT_EQ(music.loudness, sound::MeasureLoudness(*audio.format, audio.data, audio.dataBytes));
    ASSERT_EQ(music.loudness.size(), 12u);
    EXPECT_GT(music.loudness[10], music.loudness[2] + 20.0);

    for (const std::string& refused : {adpcm, folder.File("missing.ogg")})
    {
        EXPECT_FALSE(sound::MeasureMusic(refused.c_str(), &music)) << refused;
        EXPECT_TRUE(music.loudness.empty()) << refused;
    }
}

} // namespace
