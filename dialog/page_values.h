#pragma once

// What the value pages decide about the values they show and store, kept
// apart from the windows so that it runs and is checked anywhere.

#include "base/cp932.h"
#include "config/config_sections.h"

#include <cstddef>
#include <cstdint>

namespace dialog
{

// The volume sliders run from this level at their left end to 0 at their
// right end, in hundredths of a decibel.
inline constexpr std::int32_t kSliderMinimumVolume = -3000;
// The level the game takes for silence.
inline constexpr std::int32_t kSilentVolume = -10000;

// The volume a slider position stands for: the left end means silence, not
// the quietest level the slider can show.
constexpr std::int32_t VolumeAtSliderPosition(std::int32_t position)
{
    return position <= kSliderMinimumVolume ? kSilentVolume : position;
}

// The most bytes of a radio-chat message the record keeps.
inline constexpr std::size_t kRadioChatTextLimit = 37;

// How many leading bytes of a message of `length` bytes the record keeps: at
// most kRadioChatTextLimit, and never half of a double-byte character, which
// the game would read together with the terminator.
constexpr std::size_t KeptRadioChatLength(const char* text, std::size_t length)
{
    std::size_t kept = 0;
    while (kept < length)
    {
        const bool lead = base::IsLeadByte(static_cast<std::uint8_t>(text[kept]));
        const std::size_t next = kept + (lead ? 2 : 1);
        if (next > length || next > kRadioChatTextLimit)
            break;
        kept = next;
    }
    return kept;
}

} // namespace dialog
