#pragma once

// What vekcfg needs that differs by platform, beyond the encodings.

#include "sound/sound_device.h"

#include <string>

namespace cli
{

// The settings file used when none is named: the tool's own, where the
// platform has one (Windows, from "TEMP" as the tool builds it). False where
// there is none, or when it cannot be found.
bool DefaultSettingsPath(std::string* path, std::string* reason);

// Makes ready the sound device that the check decodes music through. False
// with the reason (UTF-8) when there is none to be had.
bool StartSoundDevice(sound::CSound& device, std::string* reason);

} // namespace cli
