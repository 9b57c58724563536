#pragma once

// `vekcfg draft`: a first tension file for a piece of music, which the check
// accepts, for an author to start from.

#include <string>
#include <string_view>

namespace cli
{

// The file-name entry made from a music file's name (code page 932): the
// name without its folder and extension, at most 40 bytes and never cut
// inside a character, with what would end the entry replaced.
std::string DraftName(std::string_view musicFileName);

// The whole tension file (code page 932) for music of `length` seconds
// called `name`: a timeline in proportion to the length that keeps every
// limit of the check, the finale inside the climax with its window, a short
// comment, and the limits for this length as comments.
std::string DraftTension(const std::string& name, float length);

} // namespace cli
