// Complete decoding of Ogg Vorbis from memory through libvorbisfile.
#include "sound/ogg_decoder.h"
#include "tests/support/audio_fixtures.h"
#include "tests/support/ogg_pages.h"

#include <algorithm>
#include <gtest/gtest.h>

using sound::DecodedAudio;
using testing_support::Bytes;
using testing_support::OggFixture;

namespace
{

bool Silent(const std::uint8_t* begin, const std::uint8_t* end)
{
    return std::all_of(begin, end, [](std::uint8_t b) { return b == 0; });
}

} // namespace

// What the last page announces sizes the block before a sample is decoded:
// what the pages do not hold, a lost page or a claim beyond them, stays
// silent; more than the largest sound buffer is refused at once.
TEST(OggDecoder, TheAnnouncedLengthSizesTheBlockUpToTheLargestSoundBuffer)
{
    OggFixture fixture;
    fixture.channels = 1;
    fixture.samplesPerChannel = 44100 * 12;
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
    const struct
    {
        const char* what;
        Bytes stream;
        std::uint64_t samples; // 0: refused
    } cases[] = {
        {"a page lost", testing_support::JoinOggPages(pages), fixture.samplesPerChannel},
        {"ten times the samples held", claiming(fixture.samplesPerChannel * 10),
         fixture.samplesPerChannel * 10},
        {"more than the largest sound buffer holds", claiming(sound::kMaxBufferBytes / 2 + 1), 0},
    };
    for (const auto& c : cases)
    {
        DecodedAudio audio;
        ASSERT_EQ(sound::DecodeOggVorbisFromMemory(c.stream.data(), c.stream.size(), &audio),
                  c.samples != 0)
            << c.what;
        if (c.samples == 0)
            continue;
        ASSERT_EQ(audio.dataBytes, c.samples * 2) << c.what;
        EXPECT_FALSE(Silent(audio.data, audio.data + 4000)) << c.what;
        EXPECT_TRUE(Silent(audio.data + audio.dataBytes - 8192, audio.data + audio.dataBytes))
            << c.what;
    }
}
