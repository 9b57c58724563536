// CSoundBuffer: opening wave and Ogg Vorbis files into a static buffer of the
// current sound device, the length, clones and destruction.
#include "base/memory.h"
#include "sound/audio_file.h"
#include "sound/sound_buffer.h"
#include "tests/support/audio_fixtures.h"
#include "tests/support/sound_device_fixture.h"
#include "tests/support/temp_folder.h"

#include <filesystem>
#include <gtest/gtest.h>
#include <string>

using sound::CSoundBuffer;
using sound::kCapsStatic;
using sound::SourceKind;
using testing_support::Bytes;
using testing_support::EncodeOggVorbis;
using testing_support::MakeWave;
using testing_support::OggFixture;
using testing_support::PatternBytes;
using testing_support::ScopedSoundDevice;
using testing_support::TempFolder;
using testing_support::WaveSpec;
using testing_support::WriteBytes;

namespace
{

class SoundBufferTest : public ::testing::Test
{
protected:
    void SetUp() override { ASSERT_TRUE(device_.Ready()); }

    std::string Write(const std::string& name, const Bytes& bytes)
    {
        const std::string path = folder_.File(name);
        WriteBytes(path, bytes);
        return path;
    }

    std::string WriteWave(const std::string& name, std::uint32_t dataBytes)
    {
        WaveSpec fixture;
        fixture.dataBytes = dataBytes;
        return Write(name, MakeWave(fixture));
    }

    ScopedSoundDevice device_;
    TempFolder folder_;
};

Bytes ReadBack(const CSoundBuffer& buffer)
{
    Bytes bytes(buffer.GetInfo().dataBytes);
    if (!sound::device::ReadBack(buffer.GetMasterBuffer(), bytes.data(),
                                 static_cast<std::uint32_t>(bytes.size())))
        bytes.clear();
    return bytes;
}

} // namespace

TEST_F(SoundBufferTest, AHundredSecondsOfStereoWaveIs17640000Bytes)
{
    const std::string path = WriteWave("long.wav", 17640000);
    CSoundBuffer buffer;
    ASSERT_TRUE(buffer.Open(path.c_str(), 1, kCapsStatic));
    EXPECT_EQ(buffer.GetLength(), 100.0f);
    EXPECT_EQ(buffer.GetInfo().dataBytes, 17640000u);
    EXPECT_EQ(buffer.GetInfo().channels, 2);
    EXPECT_EQ(buffer.GetInfo().bytesPerSample, 2);
    EXPECT_EQ(buffer.GetInfo().sampleRate, 44100u);
    EXPECT_EQ(buffer.GetInfo().sourceKind, SourceKind::Wave);
    EXPECT_EQ(buffer.GetInfo().capsFlags, kCapsStatic);
}

TEST_F(SoundBufferTest, AnOggOf4410000SamplesIsAHundredSecondsWhateverItsChannels)
{
    for (const int channels : {1, 2})
    {
        OggFixture fixture;
        fixture.channels = channels;
        fixture.samplesPerChannel = 4410000;
        fixture.quality = -0.1f;
        const std::string path =
            Write("tune" + std::to_string(channels) + ".ogg", EncodeOggVorbis(fixture));
        CSoundBuffer buffer;
        ASSERT_TRUE(buffer.Open(path.c_str(), 1, kCapsStatic)) << channels;
        EXPECT_EQ(buffer.GetLength(), 100.0f) << channels;
        EXPECT_EQ(buffer.GetInfo().dataBytes, 4410000u * channels * 2);
        EXPECT_EQ(buffer.GetInfo().bytesPerSample, 2);
        EXPECT_EQ(buffer.GetInfo().sourceKind, SourceKind::OggVorbis);
    }
}

TEST(SoundPathRule, OggIsTheLowerOrUpperCaseExtensionAnywhereInThePath)
{
    struct Case
    {
        const char* path;
        SourceKind kind;
    };
    const Case cases[] = {
        {"C:\\music\\track.ogg", SourceKind::OggVorbis},
        {"C:\\music\\TRACK.OGG", SourceKind::OggVorbis},
        {"C:\\music\\track.ogg.bak", SourceKind::OggVorbis},
        {"C:\\music.ogg\\track.wav", SourceKind::OggVorbis},
        {"C:\\music\\track.Ogg", SourceKind::Wave},
        {"C:\\music\\track.oGG", SourceKind::Wave},
        {"C:\\music\\track.wav", SourceKind::Wave},
        {"C:\\music\\trackogg", SourceKind::Wave},
    };
    for (const Case& c : cases)
        EXPECT_EQ(sound::SourceKindOfPath(c.path), c.kind) << c.path;
}

TEST_F(SoundBufferTest, TheExtensionDecidesHowTheFileIsRead)
{
    OggFixture fixture;
    fixture.samplesPerChannel = 4410;
    const Bytes ogg = EncodeOggVorbis(fixture);
    const Bytes wave = MakeWave(WaveSpec{});

    CSoundBuffer backup;
    ASSERT_TRUE(backup.Open(Write("track.ogg.bak", ogg).c_str(), 1, kCapsStatic));
    EXPECT_EQ(backup.GetInfo().sourceKind, SourceKind::OggVorbis);
    EXPECT_EQ(backup.GetLength(), 0.1f);

    CSoundBuffer mixedCase;
    EXPECT_FALSE(mixedCase.Open(Write("track.Ogg", ogg).c_str(), 1, kCapsStatic))
        << ".Ogg is opened as a wave file";
    CSoundBuffer waveNamedOgg;
    EXPECT_FALSE(waveNamedOgg.Open(Write("wave.ogg", wave).c_str(), 1, kCapsStatic));
}

TEST_F(SoundBufferTest, BrokenWaveFilesDoNotOpen)
{
    const WaveSpec pcm = []
    {
        WaveSpec fixture;
        fixture.dataBytes = 4000;
        return fixture;
    }();
    Bytes shortFormat = testing_support::FormatChunkBody(pcm);
    shortFormat.resize(12);
    struct Case
    {
        const char* what;
        Bytes file;
    };
    const Case cases[] = {
        {"a short fmt chunk", testing_support::RiffWriter()
                                  .Chunk("fmt ", shortFormat)
                                  .Chunk("data", PatternBytes(4000))
                                  .Finish()},
        {"no data chunk", testing_support::RiffWriter()
                              .Chunk("fmt ", testing_support::FormatChunkBody(pcm))
                              .Finish()},
        {"a truncated data chunk", testing_support::RiffWriter()
                                       .Chunk("fmt ", testing_support::FormatChunkBody(pcm))
                                       .ChunkClaiming("data", 8000, PatternBytes(4000))
                                       .Finish()},
        {"no RIFF at all", PatternBytes(4000)},
    };
    for (const Case& c : cases)
    {
        CSoundBuffer buffer;
        EXPECT_FALSE(buffer.Open(Write("broken.wav", c.file).c_str(), 1, kCapsStatic)) << c.what;
        EXPECT_EQ(buffer.GetMasterBuffer(), nullptr) << c.what;
        EXPECT_EQ(buffer.GetLength(), 0.0f) << c.what;
    }
}

TEST_F(SoundBufferTest, FormatsWithoutChannelsRateOrBytesPerSampleDoNotOpen)
{
    WaveSpec noChannels;
    noChannels.channels = 0;
    noChannels.dataBytes = 400;
    WaveSpec noRate;
    noRate.sampleRate = 0;
    noRate.dataBytes = 400;
    WaveSpec fourBits;
    fourBits.bitsPerSample = 4;
    fourBits.dataBytes = 400;
    for (const WaveSpec& fixture : {noChannels, noRate, fourBits})
    {
        CSoundBuffer buffer;
        EXPECT_FALSE(buffer.Open(Write("odd.wav", MakeWave(fixture)).c_str(), 1, kCapsStatic));
    }
}

TEST_F(SoundBufferTest, ANonPcmWaveKeepsItsExtraFormatBytes)
{
    // WAVE_FORMAT_EXTENSIBLE, which DirectSound accepts: 22 extra bytes.
    WaveSpec fixture;
    fixture.formatTag = 0xFFFE;
    fixture.extra = {16, 0,    3, 0,    0, 0, 1,    0, 0,    0,    0,
                     0,  0x10, 0, 0x80, 0, 0, 0xAA, 0, 0x38, 0x9B, 0x71};
    fixture.dataBytes = 4000;
    CSoundBuffer buffer;
    ASSERT_TRUE(buffer.Open(Write("extensible.wav", MakeWave(fixture)).c_str(), 1, kCapsStatic));
    const sound::WaveFormat* format = buffer.GetFormat();
    ASSERT_NE(format, nullptr);
    EXPECT_EQ(format->formatTag, 0xFFFE);
    ASSERT_EQ(format->extraSize, 22);
    const std::uint8_t* extra = sound::ExtraFormatBytes(*format);
    EXPECT_EQ(Bytes(extra, extra + 22), fixture.extra);
}

TEST_F(SoundBufferTest, RefusesANullPathAMissingFileAndStreamingMode)
{
    const std::string path = WriteWave("ok.wav", 4000);
    CSoundBuffer buffer;
    EXPECT_FALSE(buffer.Open(nullptr, 1, kCapsStatic));
    EXPECT_FALSE(buffer.Open(folder_.File("missing.wav").c_str(), 1, kCapsStatic));
    EXPECT_FALSE(buffer.Open(folder_.File("missing.ogg").c_str(), 1, kCapsStatic));
    EXPECT_FALSE(buffer.Open(path.c_str(), 1, 0)) << "only whole-file mode is implemented";
    EXPECT_TRUE(buffer.Open(path.c_str(), 1, kCapsStatic));
}

TEST_F(SoundBufferTest, TheStaticBufferHoldsTheDecodedData)
{
    const std::string path = WriteWave("data.wav", 6000);
    CSoundBuffer buffer;
    ASSERT_TRUE(buffer.Open(path.c_str(), 1, kCapsStatic));
    EXPECT_EQ(ReadBack(buffer), PatternBytes(6000));
    EXPECT_EQ(buffer.GetName(), path);
    EXPECT_EQ(buffer.GetNameSize(), path.size() + 1);
    EXPECT_EQ(buffer.GetType(), 4u);
    EXPECT_STREQ(buffer.GetClassName(), "CSoundBuffer");
    EXPECT_EQ(buffer.GetClassSize(), sizeof(CSoundBuffer));
    EXPECT_TRUE(buffer.IsLoaded());
    EXPECT_EQ(buffer.GetResourceSize(), 6000u);
}

TEST_F(SoundBufferTest, PreparesPlayInstancesThatShareTheOwnersInfo)
{
    const std::string path = WriteWave("voices.wav", 4000);
    CSoundBuffer buffer;
    ASSERT_TRUE(buffer.Open(path.c_str(), 3, kCapsStatic));
    ASSERT_EQ(buffer.GetInstanceCount(), 3u);
    for (std::uint32_t i = 0; i < 3; ++i)
    {
        const sound::PlayInstance* instance = buffer.GetInstance(i);
        ASSERT_NE(instance->buffer, nullptr);
        EXPECT_NE(instance->buffer, buffer.GetMasterBuffer());
        EXPECT_EQ(instance->owner, &buffer.GetInfo());
        EXPECT_EQ(instance->buffer3D, nullptr);
        EXPECT_EQ(instance->notify, nullptr);
        EXPECT_EQ(instance->playbackScale, 1.0f);
        EXPECT_EQ(instance->playbackLimit, 1.0e9f);
    }
    sound::DeviceBuffer* first = buffer.GetInstance(0)->buffer;
    ASSERT_TRUE(buffer.SetInstanceCount(1));
    EXPECT_EQ(buffer.GetInstanceCount(), 1u);
    EXPECT_EQ(buffer.GetInstance(0)->buffer, first) << "the first instances are kept";
    EXPECT_EQ(buffer.GetInstance(1), nullptr);
    ASSERT_TRUE(buffer.SetInstanceCount(4));
    EXPECT_EQ(buffer.GetInstance(0)->buffer, first);
    EXPECT_NE(buffer.GetInstance(3)->buffer, nullptr);
    ASSERT_TRUE(buffer.SetInstanceCount(0));
    EXPECT_EQ(buffer.GetInstanceCount(), 0u);
}

TEST_F(SoundBufferTest, AClonesSharesTheFormatAndTheCount)
{
    const std::string path = WriteWave("clone.wav", 4000);
    auto* original = new CSoundBuffer();
    ASSERT_TRUE(original->Open(path.c_str(), 2, kCapsStatic));
    CSoundBuffer* clone = original->Clone();
    ASSERT_NE(clone, nullptr);
    EXPECT_EQ(original->GetSharedCount(), 2u);
    EXPECT_EQ(clone->GetSharedCount(), 2u);
    EXPECT_EQ(clone->GetFormat(), original->GetFormat()) << "the format is shared";
    EXPECT_NE(clone->GetMasterBuffer(), original->GetMasterBuffer()) << "the buffer is duplicated";
    EXPECT_EQ(clone->GetLength(), original->GetLength());
    EXPECT_EQ(clone->GetInfo().dataBytes, 4000u);
    EXPECT_EQ(clone->GetInstanceCount(), 2u);
    EXPECT_EQ(clone->GetInstance(0)->owner, &clone->GetInfo());
    EXPECT_STREQ(clone->GetName(), path.c_str());

    delete original;
    EXPECT_EQ(clone->GetSharedCount(), 1u);
    EXPECT_EQ(ReadBack(*clone), PatternBytes(4000)) << "the data outlives the original";
    delete clone;
}

TEST_F(SoundBufferTest, CloneAtBuildsInTheCallersMemory)
{
    const std::string path = WriteWave("clone-at.wav", 4000);
    CSoundBuffer original;
    ASSERT_TRUE(original.Open(path.c_str(), 1, kCapsStatic));
    void* memory = base::AllocateZeroed(original.GetClassSize());
    CSoundBuffer* clone = original.CloneAt(memory);
    ASSERT_EQ(clone, memory);
    EXPECT_EQ(original.GetSharedCount(), 2u);
    clone->~CSoundBuffer();
    base::FreeBlock(memory);
    EXPECT_EQ(original.GetSharedCount(), 1u);

    CSoundBuffer* created = original.Create();
    ASSERT_NE(created, nullptr);
    EXPECT_FALSE(created->IsLoaded());
    EXPECT_EQ(created->GetType(), 4u);
    delete created;
}

TEST_F(SoundBufferTest, ReleaseMayRunTwiceAndAnOpenBufferCanBeOpenedAgain)
{
    const std::string first = WriteWave("first.wav", 4000);
    const std::string second = WriteWave("second.wav", 8000);
    CSoundBuffer buffer;
    ASSERT_TRUE(buffer.Open(first.c_str(), 1, kCapsStatic));
    ASSERT_TRUE(buffer.Open(second.c_str(), 2, kCapsStatic));
    EXPECT_EQ(buffer.GetInfo().dataBytes, 8000u);
    EXPECT_EQ(buffer.GetSharedCount(), 1u);
    EXPECT_STREQ(buffer.GetName(), second.c_str());
    EXPECT_TRUE(buffer.Release());
    EXPECT_TRUE(buffer.Release());
    EXPECT_FALSE(buffer.IsLoaded());
    EXPECT_STREQ(buffer.GetName(), "");
    ASSERT_TRUE(buffer.Open(first.c_str(), 1, kCapsStatic)) << "usable after a release";
    EXPECT_EQ(buffer.GetSharedCount(), 1u);
    ASSERT_TRUE(buffer.Open(buffer.GetName(), 1, kCapsStatic)) << "its own name as the path";
    EXPECT_STREQ(buffer.GetName(), first.c_str());
    ASSERT_TRUE(buffer.SetName(buffer.GetName()));
    EXPECT_STREQ(buffer.GetName(), first.c_str());
}

TEST_F(SoundBufferTest, AnyAllocationFailureFailsCleanly)
{
    OggFixture fixture;
    fixture.samplesPerChannel = 4410;
    const std::string paths[] = {WriteWave("alloc.wav", 4000),
                                 Write("alloc.ogg", EncodeOggVorbis(fixture))};
    for (const std::string& path : paths)
    {
        bool opened = false;
        for (int successes = 0; successes < 40 && !opened; ++successes)
        {
            CSoundBuffer buffer;
            base::ScopedAllocationFailure failure(successes);
            opened = buffer.Open(path.c_str(), 2, kCapsStatic);
        }
        EXPECT_TRUE(opened) << path << " opens once enough allocations succeed";
    }
}

TEST_F(SoundBufferTest, TheResourceEntryPointsForwardToOpen)
{
    const std::string path = WriteWave("resource.wav", 4000);
    CSoundBuffer buffer;
    EXPECT_FALSE(buffer.Reload()) << "no name yet";
    EXPECT_TRUE(buffer.Load(path.c_str()));
    EXPECT_TRUE(buffer.IsLoaded());
    EXPECT_EQ(buffer.GetInstanceCount(), 1u);
    EXPECT_TRUE(buffer.Reload());
    EXPECT_STREQ(buffer.GetName(), path.c_str());
    EXPECT_FALSE(buffer.LoadFromMemory(nullptr, 0));
    EXPECT_TRUE(buffer.Unload());
    EXPECT_FALSE(buffer.IsLoaded());

    char name[8];
    buffer.CopyClassName(name, sizeof name);
    EXPECT_STREQ(name, "CSoundB");
    char whole[32];
    buffer.CopyClassName(whole, sizeof whole);
    EXPECT_STREQ(whole, "CSoundBuffer");

    EXPECT_TRUE(buffer.ReserveName(5));
    EXPECT_EQ(buffer.GetNameSize(), 5u);
    EXPECT_STREQ(buffer.GetName(), "");
    EXPECT_TRUE(buffer.SetName("x"));
    EXPECT_EQ(buffer.GetNameSize(), 2u);
}

TEST_F(SoundBufferTest, AFolderOrAnEmptyFileIsNoMusic)
{
    const std::string folderWave = folder_.File("folder.wav");
    const std::string folderOgg = folder_.File("folder.ogg");
    std::filesystem::create_directory(folderWave);
    std::filesystem::create_directory(folderOgg);
    for (const std::string& path :
         {folderWave, folderOgg, Write("empty.wav", {}), Write("empty.ogg", {})})
    {
        CSoundBuffer buffer;
        EXPECT_FALSE(buffer.Open(path.c_str(), 1, kCapsStatic)) << path;
        EXPECT_EQ(buffer.GetMasterBuffer(), nullptr) << path;
    }
}

// Windows refuses paths of MAX_PATH (260) bytes and more to a program that
// does not opt in to long paths, the test's own writes included; POSIX and
// Wine take them. Whatever the test could write opens as itself, whole.
TEST_F(SoundBufferTest, PathsOf259260And300BytesOpenTheFileTheyName)
{
    OggFixture fixture;
    fixture.channels = 1;
    fixture.samplesPerChannel = 44100;
    const Bytes ogg = EncodeOggVorbis(fixture);
    const Bytes wave = testing_support::MakeWaveOfLength(2.0);
    for (const std::size_t length : {259u, 260u, 300u})
    {
        for (const char* ending : {".wav", ".ogg"})
        {
            const std::string path = testing_support::PathOfLength(folder_, length, ending);
            const bool isOgg = std::string(ending) == ".ogg";
            if (!path.empty())
                WriteBytes(path, isOgg ? ogg : wave);
            const bool written = !path.empty() && std::filesystem::exists(path);
            ASSERT_TRUE(written || length > 259) << "every platform takes 259 bytes";
            CSoundBuffer buffer;
            EXPECT_EQ(buffer.Open(path.c_str(), 1, kCapsStatic), written) << length << ending;
            if (written)
            {
                EXPECT_EQ(buffer.GetLength(), isOgg ? 1.0f : 2.0f) << length << ending;
                EXPECT_STREQ(buffer.GetName(), path.c_str()) << length << ending;
            }
        }
    }
}
