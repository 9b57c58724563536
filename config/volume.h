#pragma once

// The volumes of the game section, in hundredths of a decibel.

#include <cstdint>

namespace config
{

// The volume sliders run from this level at their left end to 0 at their
// right end.
inline constexpr std::int32_t kSliderMinimumVolume = -3000;
// The level the game takes for silence.
inline constexpr std::int32_t kSilentVolume = -10000;

// The volume a slider position stands for: the left end means silence, not
// the quietest level the slider can show.
constexpr std::int32_t VolumeAtSliderPosition(std::int32_t position)
{
    return position <= kSliderMinimumVolume ? kSilentVolume : position;
}

} // namespace config
