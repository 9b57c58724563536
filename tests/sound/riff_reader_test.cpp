// The RIFF rules of wave files, read from memory.
#include "sound/riff_reader.h"
#include "tests/support/audio_fixtures.h"

#include <cstring>
#include <gtest/gtest.h>
#include <string>

using sound::DecodedAudio;
using sound::ReadWaveFromMemory;
using testing_support::Bytes;
using testing_support::FormatChunkBody;
using testing_support::MakeWave;
using testing_support::PatternBytes;
using testing_support::RiffWriter;
using testing_support::WaveSpec;

namespace
{

WaveSpec Pcm(std::uint32_t dataBytes)
{
    WaveSpec fixture;
    fixture.dataBytes = dataBytes;
    return fixture;
}

Bytes Body(std::size_t size)
{
    return PatternBytes(size);
}

} // namespace

TEST(RiffReader, ReadsThePcmFormatAndTheDataChunk)
{
    const Bytes file = MakeWave(Pcm(1000));
    DecodedAudio audio;
    ASSERT_TRUE(ReadWaveFromMemory(file.data(), file.size(), &audio));
    EXPECT_EQ(audio.format->formatTag, 1);
    EXPECT_EQ(audio.format->channels, 2);
    EXPECT_EQ(audio.format->samplesPerSec, 44100u);
    EXPECT_EQ(audio.format->avgBytesPerSec, 176400u);
    EXPECT_EQ(audio.format->blockAlign, 4);
    EXPECT_EQ(audio.format->bitsPerSample, 16);
    EXPECT_EQ(audio.format->extraSize, 0) << "PCM has no extra format bytes";
    ASSERT_EQ(audio.dataBytes, 1000u);
    EXPECT_EQ(Bytes(audio.data, audio.data + 1000), PatternBytes(1000));
}

TEST(RiffReader, PassesOverOtherChunksWithTheirPadding)
{
    const WaveSpec fixture = Pcm(7);
    const Bytes file = RiffWriter()
                           .Chunk("LIST", Body(5)) // odd: one pad byte follows
                           .Chunk("fmt ", FormatChunkBody(fixture))
                           .Chunk("fact", Body(4))
                           .Chunk("data", Body(7))
                           .Chunk("smpl", Body(3))
                           .Finish();
    DecodedAudio audio;
    ASSERT_TRUE(ReadWaveFromMemory(file.data(), file.size(), &audio));
    EXPECT_EQ(Bytes(audio.data, audio.data + audio.dataBytes), Body(7));
}

TEST(RiffReader, FindsTheWaveFormAfterAnotherTopLevelChunk)
{
    const Bytes other = RiffWriter().Chunk("avih", Body(8)).Finish("AVI ");
    Bytes file = other;
    const Bytes wave = MakeWave(Pcm(8));
    file.insert(file.end(), wave.begin(), wave.end());
    DecodedAudio audio;
    ASSERT_TRUE(ReadWaveFromMemory(file.data(), file.size(), &audio));
    EXPECT_EQ(audio.dataBytes, 8u);
}

TEST(RiffReader, ARiffSizeBeyondTheFileIsCutToIt)
{
    Bytes file = MakeWave(Pcm(100));
    std::memset(&file[4], 0xFF, 4);
    DecodedAudio audio;
    ASSERT_TRUE(ReadWaveFromMemory(file.data(), file.size(), &audio));
    EXPECT_EQ(audio.dataBytes, 100u);
}

TEST(RiffReader, ANonPcmFormatKeepsItsExtraBytes)
{
    struct Case
    {
        std::uint16_t tag;
        std::size_t extra;
    };
    for (const Case c : {Case{2, 32}, Case{0xFFFE, 22}, Case{3, 0}, Case{0x55, 1}})
    {
        WaveSpec fixture = Pcm(64);
        fixture.formatTag = c.tag;
        fixture.extra = PatternBytes(c.extra);
        const Bytes file = MakeWave(fixture);
        DecodedAudio audio;
        ASSERT_TRUE(ReadWaveFromMemory(file.data(), file.size(), &audio)) << c.tag;
        EXPECT_EQ(audio.format->formatTag, c.tag);
        ASSERT_EQ(audio.format->extraSize, c.extra) << c.tag;
        const std::uint8_t* extra = sound::ExtraFormatBytes(*audio.format);
        EXPECT_EQ(Bytes(extra, extra + c.extra), fixture.extra) << c.tag;
        EXPECT_EQ(sound::FormatBytes(*audio.format), 18 + c.extra);
    }
}

TEST(RiffReader, ANonPcmFormatChunkOfSixteenBytesHasNoExtraBytes)
{
    WaveSpec fixture = Pcm(16);
    fixture.formatTag = 3;
    Bytes fmt = FormatChunkBody(fixture);
    fmt.resize(16);
    const Bytes file = RiffWriter().Chunk("fmt ", fmt).Chunk("data", Body(16)).Finish();
    DecodedAudio audio;
    ASSERT_TRUE(ReadWaveFromMemory(file.data(), file.size(), &audio));
    EXPECT_EQ(audio.format->formatTag, 3);
    EXPECT_EQ(audio.format->extraSize, 0);
}

TEST(RiffReader, RefusesBrokenFiles)
{
    const WaveSpec pcm = Pcm(100);
    WaveSpec nonPcm = pcm;
    nonPcm.formatTag = 2;
    nonPcm.extra = Body(10);
    Bytes extraBeyondChunk = FormatChunkBody(nonPcm);
    extraBeyondChunk.resize(extraBeyondChunk.size() - 1);
    Bytes shortFormat = FormatChunkBody(pcm);
    shortFormat.resize(14);
    Bytes notRiff = MakeWave(pcm);
    std::memcpy(&notRiff[0], "RIFX", 4);
    Bytes wholeFileCut = MakeWave(pcm);
    wholeFileCut.resize(30);

    struct Case
    {
        const char* what;
        Bytes file;
    };
    const Case cases[] = {
        {"an empty file", {}},
        {"a file that is no RIFF file", notRiff},
        {"a RIFF form other than WAVE",
         RiffWriter().Chunk("fmt ", FormatChunkBody(pcm)).Chunk("data", Body(4)).Finish("AVI ")},
        {"no fmt chunk", RiffWriter().Chunk("data", Body(100)).Finish()},
        {"a fmt chunk of 14 bytes",
         RiffWriter().Chunk("fmt ", shortFormat).Chunk("data", Body(100)).Finish()},
        {"no data chunk", RiffWriter().Chunk("fmt ", FormatChunkBody(pcm)).Finish()},
        {"a data chunk only before fmt",
         RiffWriter().Chunk("data", Body(100)).Chunk("fmt ", FormatChunkBody(pcm)).Finish()},
        {"a truncated data chunk", RiffWriter()
                                       .Chunk("fmt ", FormatChunkBody(pcm))
                                       .ChunkClaiming("data", 2000, Body(1000))
                                       .Finish()},
        {"a data chunk claiming 4 GiB", RiffWriter()
                                            .Chunk("fmt ", FormatChunkBody(pcm))
                                            .ChunkClaiming("data", 0xFFFFFFF0u, Body(100))
                                            .Finish()},
        {"extra format bytes beyond the fmt chunk",
         RiffWriter().Chunk("fmt ", extraBeyondChunk).Chunk("data", Body(100)).Finish()},
        {"a file cut inside the fmt chunk", wholeFileCut},
    };
    for (const Case& c : cases)
    {
        DecodedAudio audio;
        EXPECT_FALSE(ReadWaveFromMemory(c.file.data(), c.file.size(), &audio)) << c.what;
        EXPECT_EQ(audio.format, nullptr) << c.what;
        EXPECT_EQ(audio.data, nullptr) << c.what;
    }
}

TEST(RiffReader, RefusesFormatsTheLengthCannotBeComputedFor)
{
    struct Case
    {
        const char* what;
        std::uint16_t channels;
        std::uint32_t rate;
        std::uint16_t bits;
        bool opens;
    };
    const Case cases[] = {
        {"no channels", 0, 44100, 16, false},     {"no sample rate", 2, 0, 16, false},
        {"4 bits per sample", 1, 8000, 4, false}, {"7 bits per sample", 1, 8000, 7, false},
        {"8 bits per sample", 1, 8000, 8, true},  {"12 bits per sample", 1, 8000, 12, true},
    };
    for (const Case& c : cases)
    {
        WaveSpec fixture = Pcm(64);
        fixture.channels = c.channels;
        fixture.sampleRate = c.rate;
        fixture.bitsPerSample = c.bits;
        const Bytes file = MakeWave(fixture);
        DecodedAudio audio;
        EXPECT_EQ(ReadWaveFromMemory(file.data(), file.size(), &audio), c.opens) << c.what;
    }
}

TEST(WaveLength, IsBytesOverChannelsRateAndBytesPerSample)
{
    sound::WaveFormat format{};
    format.channels = 2;
    format.samplesPerSec = 44100;
    format.bitsPerSample = 16;
    EXPECT_EQ(sound::ComputeLength(17640000, format), 100.0f);
    format.channels = 1;
    format.samplesPerSec = 8000;
    format.bitsPerSample = 12; // one byte per sample by integer division
    EXPECT_EQ(sound::ComputeLength(8000 * 90, format), 90.0f);
    format.bitsPerSample = 24;
    EXPECT_EQ(sound::ComputeLength(8000 * 3 * 5, format), 5.0f);
}

// Chunk sizes are the file's word against its length: a size that runs past
// the RIFF chunk or the file hides what follows it, and the file is refused
// unless what it needs lies before.
TEST(RiffReader, ChunksThatLieAboutTheirSizeAreReadNoFurtherThanTheFile)
{
    const WaveSpec pcm = Pcm(100);
    auto withRiffSize = [](Bytes file, std::uint32_t size)
    {
        std::memcpy(&file[4], &size, 4);
        return file;
    };
    struct Case
    {
        const char* what;
        Bytes file;
        bool opens;
    };
    const Case cases[] = {
        {"a chunk before fmt claiming 4 GiB",
         RiffWriter()
             .ChunkClaiming("LIST", 0xFFFFFFF0u, Body(8))
             .Chunk("fmt ", FormatChunkBody(pcm))
             .Chunk("data", Body(100))
             .Finish(),
         false},
        {"a fmt chunk claiming 4 GiB",
         RiffWriter()
             .ChunkClaiming("fmt ", 0xFFFFFFFFu, FormatChunkBody(pcm))
             .Chunk("data", Body(100))
             .Finish(),
         false},
        {"a fmt chunk claiming 17 bytes",
         RiffWriter()
             .ChunkClaiming("fmt ", 17, FormatChunkBody(pcm))
             .Chunk("data", Body(100))
             .Finish(),
         false},
        {"a RIFF size that ends before the data chunk", withRiffSize(MakeWave(pcm), 4 + 8 + 16),
         false},
        {"a RIFF size of zero", withRiffSize(MakeWave(pcm), 0), false},
        {"a RIFF size of 4 GiB - 1", withRiffSize(MakeWave(pcm), 0xFFFFFFFFu), true},
        {"a data chunk claiming one byte more than the file holds",
         RiffWriter()
             .Chunk("fmt ", FormatChunkBody(pcm))
             .ChunkClaiming("data", 101, Body(100))
             .Finish(),
         false},
        {"a data chunk claiming fewer bytes than it has",
         RiffWriter()
             .Chunk("fmt ", FormatChunkBody(pcm))
             .ChunkClaiming("data", 60, Body(100))
             .Finish(),
         true},
    };
    for (const Case& c : cases)
    {
        DecodedAudio audio;
        EXPECT_EQ(ReadWaveFromMemory(c.file.data(), c.file.size(), &audio), c.opens) << c.what;
        EXPECT_EQ(audio.data != nullptr, c.opens) << c.what;
    }
    DecodedAudio shorter;
    const Bytes claimsFewer = RiffWriter()
                                  .Chunk("fmt ", FormatChunkBody(pcm))
                                  .ChunkClaiming("data", 60, Body(100))
                                  .Finish();
    ASSERT_TRUE(ReadWaveFromMemory(claimsFewer.data(), claimsFewer.size(), &shorter));
    EXPECT_EQ(shorter.dataBytes, 60u) << "the data chunk's own size counts";
}

TEST(RiffReader, ACutAtEveryChunkBoundaryIsRefused)
{
    const Bytes file = MakeWave(Pcm(100)); // RIFF, WAVE, fmt (16), data (100)
    struct Cut
    {
        const char* where;
        std::size_t size;
    };
    const Cut cuts[] = {
        {"inside the RIFF id", 2},      {"before the RIFF size", 4},
        {"before the form type", 8},    {"before the fmt chunk", 12},
        {"inside the fmt header", 16},  {"before the fmt fields", 20},
        {"inside the fmt fields", 28},  {"before the data chunk", 36},
        {"inside the data header", 40}, {"before the data", 44},
        {"inside the data", 94},        {"before the last data byte", 143},
    };
    for (const Cut& cut : cuts)
    {
        DecodedAudio audio;
        EXPECT_FALSE(ReadWaveFromMemory(file.data(), cut.size, &audio)) << cut.where;
    }
    DecodedAudio whole;
    EXPECT_TRUE(ReadWaveFromMemory(file.data(), file.size(), &whole));
    ASSERT_EQ(file.size(), 144u);
}
