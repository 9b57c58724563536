// CSoundBuffer: a file decoded by its path into a static buffer of the
// current device, its length, and what the game uses besides.
#include "base/memory.h"
#include "sound/sound_buffer.h"
#include "tests/support/audio_fixtures.h"
#include "tests/support/sound_device_fixture.h"
#include "tests/support/temp_folder.h"

#include <cstring>
#include <filesystem>
#include <gtest/gtest.h>
#include <string>
#include <tuple>

using sound::CSoundBuffer;
using sound::kCapsStatic;
using testing_support::Bytes;
using testing_support::EncodeOggVorbis;

namespace
{

class SoundBufferTest : public ::testing::Test
{
protected:
    void SetUp() override { ASSERT_TRUE(device_.Ready()); }

    std::string Write(const std::string& name, const Bytes& bytes)
    {
        testing_support::WriteBytes(folder_.File(name), bytes);
        return folder_.File(name);
    }
    std::string WriteWave(const std::string& name, std::uint32_t dataBytes)
    {
        return Write(name, testing_support::MakeWave({.dataBytes = dataBytes}));
    }

    testing_support::ScopedSoundDevice device_;
    testing_support::TempFolder folder_;
};

} // namespace

// A path holding ".ogg" or ".OGG" anywhere is an Ogg Vorbis file, decoded
// to 16-bit PCM.
TEST_F(SoundBufferTest, TheLengthIsTheDataOverChannelsRateAndBytesPerSample)
{
    const std::string stereo = Write("STEREO.OGG", EncodeOggVorbis({2, 8000, 80000, -0.1f})),
                      mono = Write("mono.ogg.bak", EncodeOggVorbis({1, 8000, 80000, -0.1f}));
    const std::tuple<std::string, float, sound::WaveFormat> cases[] = {
        {WriteWave("stereo.wav", 17640000), 100.0f, {1, 2, 44100, 176400, 4, 16, 0}},
        {stereo, 10.0f, {1, 2, 8000, 32000, 4, 16, 0}},
        {mono, 10.0f, {1, 1, 8000, 16000, 2, 16, 0}},
    };
    for (const auto& [path, length, format] : cases)
    {
        CSoundBuffer buffer;
        ASSERT_TRUE(buffer.Open(path.c_str(), 1, kCapsStatic)) << path;
        EXPECT_EQ(buffer.GetLength(), length) << path;
        EXPECT_EQ(std::memcmp(buffer.GetFormat(), &format, sizeof format), 0) << path;
    }
}

TEST_F(SoundBufferTest, WhatCannotBeDecodedOrBufferedDoesNotOpen)
{
    std::filesystem::create_directory(folder_.File("folder.wav"));
    std::filesystem::create_directory(folder_.File("folder.ogg"));
    const std::string ogg = Write("track.Ogg", EncodeOggVorbis({})); // a wave
    for (const std::string& path :
         {folder_.File("missing.wav"), folder_.File("missing.ogg"), folder_.File("folder.wav"),
          folder_.File("folder.ogg"), Write("empty.wav", {}), ogg,
          Write("noise.ogg", testing_support::PatternBytes(5000)), WriteWave("tiny.wav", 2)})
    {
        CSoundBuffer buffer;
        EXPECT_FALSE(buffer.Open(path.c_str(), 1, kCapsStatic)) << path;
        EXPECT_FALSE(buffer.IsLoaded()) << path;
        EXPECT_EQ(buffer.GetLength(), 0.0f) << path;
    }
    CSoundBuffer buffer;
    EXPECT_FALSE(buffer.Open(nullptr, 1, kCapsStatic));
    EXPECT_FALSE(buffer.Open(WriteWave("whole.wav", 4000).c_str(), 1, 0)) << "no streaming";
}

// Play instances and clones are the game's; the tool opens one instance.
TEST_F(SoundBufferTest, InstancesAndClonesDuplicateTheDataWhichOutlivesTheOriginal)
{
    const std::string path = WriteWave("voices.wav", 4000);
    auto* original = new CSoundBuffer();
    ASSERT_TRUE(original->Open(path.c_str(), 3, kCapsStatic));
    sound::DeviceBuffer* first = original->GetInstance(0)->buffer;
    ASSERT_TRUE(original->SetInstanceCount(1));
    ASSERT_TRUE(original->SetInstanceCount(2));
    EXPECT_EQ(original->GetInstance(0)->buffer, first) << "the first instances are kept";
    CSoundBuffer* clone = original->Clone();
    ASSERT_NE(clone, nullptr);
    EXPECT_EQ(clone->GetFormat(), original->GetFormat());
    delete original;
    EXPECT_EQ(clone->GetSharedCount(), 1u);
    Bytes held(4000);
    ASSERT_TRUE(sound::device::ReadBack(clone->GetMasterBuffer(), held.data(), 4000));
    EXPECT_EQ(held, testing_support::PatternBytes(4000));
    EXPECT_STREQ(clone->GetName(), path.c_str());
    ASSERT_EQ(clone->GetInstanceCount(), 2u);
    for (std::uint32_t i = 0; i < 2; ++i)
    {
        EXPECT_NE(clone->GetInstance(i)->buffer, nullptr);
        EXPECT_EQ(clone->GetInstance(i)->owner, &clone->GetInfo());
    }
    delete clone;
}

TEST_F(SoundBufferTest, ABufferIsReleasedTwiceAndOpenedAgainEvenFromItsOwnName)
{
    const std::string first = WriteWave("first.wav", 4000);
    CSoundBuffer buffer;
    ASSERT_TRUE(buffer.Open(first.c_str(), 1, kCapsStatic));
    ASSERT_TRUE(buffer.Open(WriteWave("second.wav", 8000).c_str(), 2, kCapsStatic));
    EXPECT_EQ(buffer.GetInfo().dataBytes, 8000u);
    EXPECT_TRUE(buffer.Release());
    EXPECT_TRUE(buffer.Release());
    EXPECT_STREQ(buffer.GetName(), "");
    ASSERT_TRUE(buffer.Open(first.c_str(), 1, kCapsStatic));
    EXPECT_EQ(buffer.GetSharedCount(), 1u);
    ASSERT_TRUE(buffer.Open(buffer.GetName(), 1, kCapsStatic));
    ASSERT_TRUE(buffer.Reload());
    EXPECT_STREQ(buffer.GetName(), first.c_str());
}

TEST_F(SoundBufferTest, AnyAllocationFailureFailsCleanly)
{
    for (const std::string& path :
         {WriteWave("alloc.wav", 4000), Write("alloc.ogg", EncodeOggVorbis({}))})
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
