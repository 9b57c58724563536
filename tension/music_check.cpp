#include "tension/music_check.h"

#include "sound/sound_buffer.h"
#include "sound/sound_device.h"
#include "tension/tension_file.h"

namespace tension
{
namespace
{

MusicCheckResult Report(MusicCheckResult result, const CTextString& text, CTextString* message)
{
    if (message != nullptr)
        *message = text;
    return result;
}

} // namespace

MusicCheckResult CheckMusicRow(const char* musicPath, const char* tensionPath, CTextString* message)
{
    // Both objects live on this frame only: neither file stays open, nor the
    // decoded music in the device, while the caller shows the outcome.
    sound::CSoundBuffer music;
    if (!music.Open(musicPath, 1, sound::kCapsStatic))
        return Report(MusicCheckResult::MusicUnreadable, CTextString("BGMファイルが開けません"),
                      message);

    CTensionFile tensionFile;
    CTextString log;
    if (!tensionFile.LoadFromFile(&music, tensionPath, &log))
        return Report(MusicCheckResult::TensionRejected, log, message);
    return Report(MusicCheckResult::Accepted, CTextString("テンションファイル作成成功!!"), message);
}

} // namespace tension
