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
    return CheckMusicRow(musicPath, tensionPath, message, MusicCheckInspector());
}

MusicCheckResult CheckMusicRow(const char* musicPath, const char* tensionPath, CTextString* message,
                               const MusicCheckInspector& inspect)
{
    const auto finish = [&inspect](MusicCheckInspection inspection)
    {
        if (inspect)
            inspect(inspection);
        return inspection.result;
    };
    // Both objects live on this frame only: neither file stays open, nor the
    // decoded music in the device, while the caller shows the outcome.
    sound::CSoundBuffer music;
    if (!music.Open(musicPath, 1, sound::kCapsStatic))
    {
        const CTextString none;
        return finish({Report(MusicCheckResult::MusicUnreadable,
                              CTextString(kMusicUnreadableMessage), message),
                       nullptr, nullptr, &none});
    }

    CTensionFile tensionFile;
    CTextString log;
    if (!tensionFile.LoadFromFile(&music, tensionPath, &log))
        return finish(
            {Report(MusicCheckResult::TensionRejected, log, message), &music, &tensionFile, &log});
    return finish(
        {Report(MusicCheckResult::Accepted, CTextString("テンションファイル作成成功!!"), message),
         &music, &tensionFile, &log});
}

} // namespace tension
