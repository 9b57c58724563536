#pragma once

// The check of one user music row: does the game accept this tension file
// for this music? The user music page's チェック button and the command-line
// companion both ask it here, so that they can never disagree.

#include "tension/text_string.h"

namespace tension
{

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

} // namespace tension
