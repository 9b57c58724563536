// Complete decoding of Ogg Vorbis from memory through libvorbisfile.
#include "sound/ogg_decoder.h"
#include "tests/support/audio_fixtures.h"
#include "tests/support/ogg_pages.h"

#include <algorithm>
#include <cstring>
#include <gtest/gtest.h>

#define OV_EXCLUDE_STATIC_CALLBACKS
#include <vorbis/vorbisfile.h>

using sound::DecodedAudio;
using sound::DecodeOggVorbisFromMemory;
using testing_support::Bytes;
using testing_support::EncodeOggVorbis;
using testing_support::OggFixture;

namespace
{

// A decoder of our own for comparison: libvorbisfile over the same bytes,
// with every result of ov_read reported.
struct Reference
{
    Bytes pcm;
    int holes = 0;
    bool failed = false;
};

struct Cursor
{
    const Bytes* bytes;
    std::size_t position;
};

Reference DecodeDirectly(const Bytes& stream)
{
    Cursor cursor{&stream, 0};
    ov_callbacks callbacks{};
    callbacks.read_func = [](void* out, std::size_t size, std::size_t count, void* source)
    {
        auto* c = static_cast<Cursor*>(source);
        const std::size_t bytes = std::min(size * count, c->bytes->size() - c->position);
        std::memcpy(out, c->bytes->data() + c->position, bytes);
        c->position += bytes;
        return bytes / size;
    };
    callbacks.seek_func = [](void* source, ogg_int64_t offset, int whence)
    {
        auto* c = static_cast<Cursor*>(source);
        const ogg_int64_t origin = whence == SEEK_SET   ? 0
                                   : whence == SEEK_CUR ? ogg_int64_t(c->position)
                                                        : ogg_int64_t(c->bytes->size());
        c->position = std::size_t(std::clamp<ogg_int64_t>(origin + offset, 0, c->bytes->size()));
        return 0;
    };
    callbacks.tell_func = [](void* source) { return long(static_cast<Cursor*>(source)->position); };
    Reference reference;
    OggVorbis_File file;
    if (ov_open_callbacks(&cursor, &file, nullptr, 0, callbacks) != 0)
    {
        reference.failed = true;
        return reference;
    }
    char buffer[4096];
    int section = 0;
    for (;;)
    {
        const long got = ov_read(&file, buffer, sizeof buffer, 0, 2, 1, &section);
        if (got == 0)
            break;
        if (got == OV_HOLE)
        {
            ++reference.holes;
            continue;
        }
        if (got < 0)
        {
            reference.failed = true;
            break;
        }
        reference.pcm.insert(reference.pcm.end(), buffer, buffer + got);
    }
    ov_clear(&file);
    return reference;
}

} // namespace

TEST(OggDecoder, DecodesTheWholeStreamAsLittleEndianSigned16Bit)
{
    for (const int channels : {1, 2})
    {
        OggFixture fixture;
        fixture.channels = channels;
        fixture.sampleRate = 22050;
        fixture.samplesPerChannel = 30000;
        const Bytes stream = EncodeOggVorbis(fixture);
        DecodedAudio audio;
        ASSERT_TRUE(DecodeOggVorbisFromMemory(stream.data(), stream.size(), &audio)) << channels;
        EXPECT_EQ(audio.format->formatTag, 1);
        EXPECT_EQ(audio.format->channels, channels);
        EXPECT_EQ(audio.format->samplesPerSec, 22050u);
        EXPECT_EQ(audio.format->bitsPerSample, 16);
        EXPECT_EQ(audio.format->blockAlign, 2 * channels);
        EXPECT_EQ(audio.format->avgBytesPerSec, 2u * channels * 22050u);
        EXPECT_EQ(audio.format->extraSize, 0);
        ASSERT_EQ(audio.dataBytes, 30000u * channels * 2);
        const Reference reference = DecodeDirectly(stream);
        ASSERT_FALSE(reference.failed);
        ASSERT_EQ(reference.pcm.size(), audio.dataBytes);
        EXPECT_TRUE(std::equal(reference.pcm.begin(), reference.pcm.end(), audio.data));
        const bool silent = std::all_of(audio.data, audio.data + audio.dataBytes,
                                        [](std::uint8_t b) { return b == 0; });
        EXPECT_FALSE(silent);
    }
}

TEST(OggDecoder, RefusesCorruptStreams)
{
    OggFixture fixture;
    fixture.samplesPerChannel = 5000;
    const Bytes good = EncodeOggVorbis(fixture);
    Bytes headerCut(good.begin(), good.begin() + 60);
    Bytes headerDamaged = good;
    for (std::size_t i = 28; i < 60; ++i)
        headerDamaged[i] ^= 0x5A;
    Bytes notOgg = testing_support::MakeWave({});

    struct Case
    {
        const char* what;
        Bytes stream;
    };
    const Case cases[] = {
        {"no bytes", {}},
        {"bytes that are no Ogg stream", testing_support::PatternBytes(5000)},
        {"a wave file", notOgg},
        {"a stream cut inside its headers", headerCut},
        {"damaged headers", headerDamaged},
    };
    for (const Case& c : cases)
    {
        DecodedAudio audio;
        EXPECT_FALSE(DecodeOggVorbisFromMemory(c.stream.data(), c.stream.size(), &audio)) << c.what;
        EXPECT_EQ(audio.data, nullptr) << c.what;
        EXPECT_EQ(audio.format, nullptr) << c.what;
    }
}

// A missing page is a hole (OV_HOLE): our choice is to pass over it and go
// on decoding, never moving the write position backwards or past the block.
TEST(OggDecoder, PassesOverAHoleAndKeepsTheAnnouncedLength)
{
    OggFixture fixture;
    fixture.channels = 2;
    fixture.samplesPerChannel = 44100 * 12;
    std::vector<Bytes> pages = testing_support::SplitOggPages(EncodeOggVorbis(fixture));
    ASSERT_GT(pages.size(), 6u);
    pages.erase(pages.begin() + static_cast<long>(pages.size() / 2));
    const Bytes damaged = testing_support::JoinOggPages(pages);

    const Reference reference = DecodeDirectly(damaged);
    ASSERT_GE(reference.holes, 1) << "the fixture must make libvorbisfile report a hole";
    ASSERT_FALSE(reference.failed);

    DecodedAudio audio;
    ASSERT_TRUE(DecodeOggVorbisFromMemory(damaged.data(), damaged.size(), &audio));
    EXPECT_EQ(audio.dataBytes, 44100u * 12 * 2 * 2) << "ov_pcm_total sizes the block";
    ASSERT_LE(reference.pcm.size(), audio.dataBytes);
    EXPECT_TRUE(std::equal(reference.pcm.begin(), reference.pcm.end(), audio.data))
        << "the samples after the hole follow the ones before it";
    EXPECT_TRUE(std::all_of(audio.data + reference.pcm.size(), audio.data + audio.dataBytes,
                            [](std::uint8_t b) { return b == 0; }))
        << "what the stream does not deliver stays silent";
}

TEST(OggDecoder, ATruncatedStreamDecodesWhatItHolds)
{
    OggFixture fixture;
    fixture.samplesPerChannel = 44100 * 10;
    std::vector<Bytes> pages = testing_support::SplitOggPages(EncodeOggVorbis(fixture));
    ASSERT_GT(pages.size(), 4u);
    pages.resize(pages.size() - 2);
    const Bytes truncated = testing_support::JoinOggPages(pages);
    const Reference reference = DecodeDirectly(truncated);
    DecodedAudio audio;
    ASSERT_EQ(DecodeOggVorbisFromMemory(truncated.data(), truncated.size(), &audio),
              !reference.failed);
    if (!reference.failed)
    {
        EXPECT_EQ(audio.dataBytes, reference.pcm.size())
            << "the last page left sets the announced length";
    }
}

// A stream cut anywhere, at a page boundary or inside a page, decodes what
// its whole pages hold, exactly as libvorbisfile delivers it, or is refused
// as libvorbisfile refuses it; the block is never written past.
TEST(OggDecoder, ACutAtEveryPageBoundaryOrInsideAPageDecodesWhatIsLeft)
{
    OggFixture fixture;
    fixture.channels = 2;
    fixture.samplesPerChannel = 44100 * 3;
    const Bytes stream = EncodeOggVorbis(fixture);
    std::vector<std::size_t> cuts;
    std::size_t boundary = 0;
    for (const Bytes& page : testing_support::SplitOggPages(stream))
    {
        cuts.push_back(boundary + page.size() / 2);
        boundary += page.size();
        cuts.push_back(boundary);
    }
    ASSERT_GT(cuts.size(), 8u);
    for (const std::size_t cut : cuts)
    {
        const Bytes truncated(stream.begin(), stream.begin() + static_cast<long>(cut));
        const Reference reference = DecodeDirectly(truncated);
        DecodedAudio audio;
        const bool decoded = DecodeOggVorbisFromMemory(truncated.data(), truncated.size(), &audio);
        ASSERT_EQ(decoded, !reference.failed) << "cut at " << cut;
        if (decoded)
        {
            ASSERT_LE(reference.pcm.size(), audio.dataBytes) << "cut at " << cut;
            EXPECT_TRUE(std::equal(reference.pcm.begin(), reference.pcm.end(), audio.data))
                << "cut at " << cut;
        }
    }
}

namespace
{

// The stream with the granule position of its last page set to `samples`.
Bytes ClaimingSamples(const Bytes& stream, std::uint64_t samples)
{
    Bytes claimed = stream;
    const std::size_t granule =
        claimed.size() - testing_support::SplitOggPages(stream).back().size() + 6;
    for (int i = 0; i < 8; ++i)
        claimed[granule + i] = static_cast<std::uint8_t>(samples >> (8 * i));
    testing_support::RepairOggChecksums(claimed.data(), claimed.size());
    return claimed;
}

} // namespace

// The last page's granule position announces the stream's length, and the
// block is sized by it before a sample is decoded: more than a sound buffer
// can hold is refused at once; less is silence after what the pages hold.
// (The stream has several audio pages: with one, the claim would also move
// the stream's start and cancel out.)
TEST(OggDecoder, TheAnnouncedLengthSizesTheBlockUpToTheLargestSoundBuffer)
{
    OggFixture fixture;
    fixture.channels = 1;
    fixture.samplesPerChannel = 44100 * 3;
    const Bytes stream = EncodeOggVorbis(fixture);
    ASSERT_GE(testing_support::SplitOggPages(stream).size(), 4u) << "two of headers, two of audio";
    const std::uint64_t largest = sound::kMaxBufferBytes / 2;
    struct Case
    {
        const char* what;
        std::uint64_t samples;
        bool decodes;
    };
    const Case cases[] = {
        {"ten times the samples held", fixture.samplesPerChannel * 10, true},
        {"as many as the largest sound buffer holds", largest, true},
        {"one more than that", largest + 1, false},
        {"the largest granule position", 0x7FFFFFFFFFFFFFFFull, false},
    };
    for (const Case& c : cases)
    {
        const Bytes claimed = ClaimingSamples(stream, c.samples);
        DecodedAudio audio;
        ASSERT_EQ(DecodeOggVorbisFromMemory(claimed.data(), claimed.size(), &audio), c.decodes)
            << c.what;
        if (!c.decodes)
            continue;
        EXPECT_EQ(audio.dataBytes, c.samples * 2) << c.what;
        const std::size_t held = fixture.samplesPerChannel * 2 + 8192;
        EXPECT_TRUE(std::all_of(audio.data + held, audio.data + audio.dataBytes,
                                [](std::uint8_t b) { return b == 0; }))
            << c.what << ": what the pages do not hold is silence";
    }
}

// A page whose checksum does not match is dropped as if it were missing.
TEST(OggDecoder, APageWithABadChecksumIsPassedOverLikeAMissingOne)
{
    OggFixture fixture;
    fixture.channels = 1;
    fixture.samplesPerChannel = 44100 * 12;
    Bytes stream = EncodeOggVorbis(fixture);
    const std::vector<Bytes> pages = testing_support::SplitOggPages(stream);
    ASSERT_GT(pages.size(), 6u);
    std::size_t middle = 0;
    for (std::size_t i = 0; i < pages.size() / 2; ++i)
        middle += pages[i].size();
    stream[middle + 22] ^= 0xFF;
    const Reference reference = DecodeDirectly(stream);
    ASSERT_FALSE(reference.failed);
    DecodedAudio audio;
    ASSERT_TRUE(DecodeOggVorbisFromMemory(stream.data(), stream.size(), &audio));
    EXPECT_EQ(audio.dataBytes, 44100u * 12 * 2);
    ASSERT_LT(reference.pcm.size(), audio.dataBytes) << "the page's samples are missing";
    EXPECT_TRUE(std::equal(reference.pcm.begin(), reference.pcm.end(), audio.data));
}
