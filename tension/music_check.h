#pragma once

// The check of one user music row: does the game accept this tension file
// for this music? The user music page's チェック button and the command-line
// companion both ask it here, so that they can never disagree.

#include "tension/text_string.h"

#include <functional>

namespace sound
{
class CSoundBuffer;
}

namespace tension
{

class CTensionFile;

// What the user is shown for music the check cannot open.
inline constexpr const char* kMusicUnreadableMessage = "BGMファイルが開けません";

enum class MusicCheckResult
{
    // The tension file fits the music (warnings are not reported).
    Accepted,
    // The music file is missing, unreadable, or neither a readable RIFF wave
    // nor an Ogg Vorbis file.
    MusicUnreadable,
    // The tension file cannot be read or fails validation against the
    // music's length.
    TensionRejected,
};

// Decodes the whole music at `musicPath` into a static sound buffer (a path
// containing ".ogg" or ".OGG" is Ogg Vorbis, any other a RIFF wave), then
// loads the tension file at `tensionPath` against the music's length. Both
// are read only, and both are closed and released before this returns.
//
// `message` (may be null) receives what the user is to be shown:
//   Accepted         "テンションファイル作成成功!!"
//   MusicUnreadable  "BGMファイルが開けません"
//   TensionRejected  the whole log of the load, one message per line, each
//                    ending with a line feed, in the order they arose
// Code page 932, as every text of the tool; the caller converts for display
// elsewhere.
//
// On Windows the music is decoded into a buffer of the current sound device,
// so a CSound must have been initialised first (a console program may bind
// it to GetDesktopWindow()); without one every music is unreadable. On POSIX
// no device is needed.
MusicCheckResult CheckMusicRow(const char* musicPath, const char* tensionPath,
                               CTextString* message);

// What one check used, for a caller that explains its outcome to an author
// (how long the music is, the timeline, the warnings the user is not shown).
// Valid only during the inspector's call.
struct MusicCheckInspection
{
    MusicCheckResult result;
    // Null when the music could not be opened; then so is `tensionFile`.
    const sound::CSoundBuffer* music;
    // As the load left it: without a timeline when the file could not be
    // read.
    CTensionFile* tensionFile;
    // Everything the load recorded; on acceptance these are the warnings.
    const CTextString* log;
};
using MusicCheckInspector = std::function<void(const MusicCheckInspection&)>;

// The same check; `inspect` is called once at its end, before the two
// objects are released.
MusicCheckResult CheckMusicRow(const char* musicPath, const char* tensionPath, CTextString* message,
                               const MusicCheckInspector& inspect);

} // namespace tension
