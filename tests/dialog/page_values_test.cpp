// The decisions of the value pages that do not need a window.
#include "dialog/page_values.h"

#include <gtest/gtest.h>
#include <string>

using dialog::KeptRadioChatLength;
using dialog::VolumeAtSliderPosition;

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

TEST(RadioChatText, KeepsAtMost37BytesAndNeverHalfACharacter)
{
    // "ぁ" is 82 9F: its trail byte lies in the lead-byte range, so only a
    // walk from the start tells where characters begin.
    const std::string small = "\x82\x9F";
    std::string eighteen;
    for (int i = 0; i < 18; ++i)
        eighteen += small;
    const struct
    {
        std::string text;
        std::size_t kept;
    } cases[] = {
        {"", 0},
        {"hello", 5},
        {std::string(37, 'a'), 37},
        {std::string(60, 'a'), 37},
        {eighteen, 36},
        {"a" + eighteen, 37},
        {"ab" + eighteen, 36},
        {eighteen + "xyz", 37},
        {"ab\x82", 2},
    };
    for (const auto& c : cases)
        EXPECT_EQ(KeptRadioChatLength(c.text.data(), c.text.size()), c.kept) << c.text.size();
}
