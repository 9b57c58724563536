// The volume a slider position stands for.
#include "config/volume.h"

#include <gtest/gtest.h>

using config::VolumeAtSliderPosition;

TEST(VolumeSlider, OnlyTheLeftEndMeansSilence)
{
    const struct
    {
        std::int32_t position;
        std::int32_t volume;
    } cases[] = {{-3000, -10000}, {-2999, -2999}, {-1500, -1500}, {-10, -10}, {0, 0}};
    for (const auto& c : cases)
        EXPECT_EQ(VolumeAtSliderPosition(c.position), c.volume) << c.position;
}
