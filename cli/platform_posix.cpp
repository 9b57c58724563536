// Linux has no settings file of the tool's own, and needs no sound device:
// the check decodes into memory.
#include "cli/platform.h"

namespace cli
{

bool DefaultSettingsPath(std::string*, std::string* reason)
{
    *reason = "FILE is required on this platform";
    return false;
}

bool StartSoundDevice(sound::CSound&, std::string*)
{
    return true;
}

} // namespace cli
