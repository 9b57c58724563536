// Complete decoding of Ogg Vorbis from memory through libvorbisfile.
#include "sound/ogg_decoder.h"
#include "tests/support/audio_fixtures.h"
#include "tests/support/ogg_pages.h"

#include <algorithm>
#include <gtest/gtest.h>
#include <tuple>

using sound::DecodedAudio;
using testing_support::Bytes;
using testing_support::OggFixture;

// What the last page announces sizes the block before a sample is decoded:
// what the pages do not hold, a lost page or a claim beyond them, stays
// silent; more than the largest sound buffer is refused at once.
TEST(OggDecoder, TheAnnouncedLengthSizesTheBlockUpToTheLargestSoundBuffer)
{
    const OggFixture fixture{.channels = 1, .samplesPerChannel = 44100 * 12};
    std::vector<Bytes> pages =
        testing_support::SplitOggPages(testing_support::EncodeOggVorbis(fixture));
    ASSERT_GT(pages.size(), 6u) << "pages of audio to lose and to claim more in";
    const auto claiming = [&pages](std::uint64_t samples)
    {
        Bytes claimed = testing_support::JoinOggPages(pages);
        for (int i = 0; i < 8; ++i)
            claimed[claimed.size() - pages.back().size() + 6 + i] = std::uint8_t(samples >> 8 * i);
        testing_support::RepairOggChecksums(claimed.data(), claimed.size());
        return claimed;
    };
    pages.erase(pages.begin() + 4);
    // The stream and the samples decoded, 0 when refused.
    const std::tuple<const char*, Bytes, std::uint64_t> cases[] = {
        {"a page lost", testing_support::JoinOggPages(pages), fixture.samplesPerChannel},
        {"ten times the samples held", claiming(fixture.samplesPerChannel * 10),
         fixture.samplesPerChannel * 10},
        {"more than the largest sound buffer holds", claiming(sound::kMaxBufferBytes / 2 + 1), 0},
    };
    const auto silent = [](const std::uint8_t* begin, const std::uint8_t* end)
    { return std::all_of(begin, end, [](std::uint8_t b) { return b == 0; }); };
    for (const auto& [what, stream, samples] : cases)
    {
        DecodedAudio audio;
        ASSERT_EQ(sound::DecodeOggVorbisFromMemory(stream.data(), stream.size(), &audio),
                  samples != 0)
            << what;
        if (samples == 0)
            continue;
        ASSERT_EQ(audio.dataBytes, samples * 2) << what;
        EXPECT_FALSE(silent(audio.data, audio.data + 4000)) << what;
        EXPECT_TRUE(silent(audio.data + audio.dataBytes - 8192, audio.data + audio.dataBytes))
            << what;
    }
}
