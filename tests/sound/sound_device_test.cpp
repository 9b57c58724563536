// The sound device: Init, the current device, and where buffers come from.
#include "sound/sound_buffer.h"
#include "sound/sound_device.h"
#include "tests/support/audio_fixtures.h"
#include "tests/support/sound_device_fixture.h"
#include "tests/support/temp_folder.h"

#include <gtest/gtest.h>

using sound::CSound;
using sound::CurrentSound;

TEST(SoundDevice, ANullWindowFailsAtOnce)
{
    CSound sound;
    EXPECT_FALSE(sound.Init(nullptr));
    EXPECT_EQ(sound.GetWindow(), nullptr);
    EXPECT_EQ(CurrentSound(), nullptr);
    EXPECT_STREQ(sound.GetClassName(), "CSound");
}

TEST(SoundDevice, InitMakesTheDeviceCurrentUntilItIsDestroyed)
{
    void* window = testing_support::TestWindowHandle();
    {
        CSound sound;
        ASSERT_TRUE(sound.Init(window));
        EXPECT_EQ(CurrentSound(), &sound);
        EXPECT_EQ(sound.GetWindow(), window);
        EXPECT_GE(sound.GetMaxSecondaryRate(), 44100u);
        EXPECT_LE(sound.GetMinSecondaryRate(), 44100u);
        {
            CSound second;
            ASSERT_TRUE(second.Init(window));
            EXPECT_EQ(CurrentSound(), &second);
        }
        EXPECT_EQ(CurrentSound(), nullptr) << "a destroyed device is no longer current";
    }
    EXPECT_EQ(CurrentSound(), nullptr);
}

#ifndef _WIN32
TEST(SoundDevice, OnPosixBuffersNeedNoDevice)
{
    ASSERT_EQ(CurrentSound(), nullptr);
    testing_support::TempFolder folder;
    testing_support::WaveSpec fixture;
    fixture.dataBytes = 4000;
    const std::string path = folder.File("headless.wav");
    testing_support::WriteBytes(path, testing_support::MakeWave(fixture));
    sound::CSoundBuffer buffer;
    EXPECT_TRUE(buffer.Open(path.c_str(), 1, sound::kCapsStatic));
}

TEST(SoundDevice, ThePosixStandInRefusesBuffersDirectSoundWouldRefuse)
{
    testing_support::TempFolder folder;
    testing_support::WaveSpec fixture;
    fixture.dataBytes = 2; // below DSBSIZE_MIN
    const std::string path = folder.File("tiny.wav");
    testing_support::WriteBytes(path, testing_support::MakeWave(fixture));
    sound::CSoundBuffer buffer;
    EXPECT_FALSE(buffer.Open(path.c_str(), 1, sound::kCapsStatic));
}
#endif
