// Windows: the tool's own settings file, and a DirectSound device for the
// check bound to the desktop window, as a console program has no window.
#include "cli/encoding.h"
#include "cli/platform.h"
#include "config/save_config.h"
#include "sound/direct_sound_win32.h"

namespace cli
{
namespace
{

std::string deviceFailure;

// The device reports its failures in a message box; a command-line tool
// must not stop for one, so the text becomes the reason instead.
int WINAPI RecordDeviceFailure(HWND, LPCSTR text, LPCSTR, UINT)
{
    deviceFailure = text != nullptr ? text : "";
    return IDOK;
}

} // namespace

bool DefaultSettingsPath(std::string* path, std::string* reason)
{
    char buffer[config::kSavePathCapacity];
    if (!config::BuildSaveFilePath(buffer, sizeof buffer))
    {
        *reason = "no FILE given, and the tool's own settings file cannot be found "
                  "(TEMP is not set or too long)";
        return false;
    }
    *path = buffer;
    return true;
}

bool StartSoundDevice(sound::CSound& device, std::string* reason)
{
    const sound::DeviceApi api{DirectSoundCreate8, RecordDeviceFailure};
    deviceFailure.clear();
    if (device.InitWith(GetDesktopWindow(), api))
        return true;
    *reason = "no sound device to decode the music with";
    if (!deviceFailure.empty())
        *reason += ": " + Utf8FromCp932(deviceFailure);
    return false;
}

} // namespace cli
