#pragma once

// A first tension file for a piece of music, which the check accepts, laid
// on the music's loudness: `vekcfg draft` writes one, and the BGM page
// offers one when a row's tension file is missing.

#include <string>
#include <string_view>
#include <vector>

namespace tension
{

// The file-name entry made from a music file's name (code page 932): the
// name without its folder and extension, at most 40 bytes and never cut
// inside a character. Control characters, the entry's terminator and a
// lead byte without its trail byte become "_", so that the entry holds
// one line and ends where it should.
std::string DraftName(std::string_view musicFileName);

// The whole tension file (code page 932) for music of `length` seconds (60
// to 480) called `name`, whose whole seconds have the given loudness: the
// timeline that follows the loudness best within the check's limits (see
// LayTimeline), its finale, a comment that says how it was made and how
// well it follows the loudness, and the limits for this length as comments.
std::string DraftTension(const std::string& name, float length,
                         const std::vector<double>& loudness);

// Where the BGM page writes a draft after the check of a row, or empty when
// it offers none. It offers one only for music that opened and lasts 60 to
// 480 seconds, whose tension file is missing: `tensionPath` empty or naming
// no file. The draft goes to `tensionPath`, or when that is empty beside the
// music, its extension replaced by ".txt"; never where something stands, nor
// to a path longer than `pathLimit` bytes.
std::string DraftPathFor(const std::string& musicPath, const std::string& tensionPath,
                         bool musicOpened, float musicLength, std::size_t pathLimit);

} // namespace tension
