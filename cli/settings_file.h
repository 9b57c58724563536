#pragma once

#include "config/save_config.h"

#include <cstdint>
#include <string>

namespace cli
{

// Reads a settings file into `record` as the tool would load it, but never
// writes: a missing, unreadable, too short or too new file is refused, with
// a message (UTF-8) that names the path. `version` receives the file's
// version word.
bool LoadSettingsFile(const std::string& path, config::CSaveConfig& record, std::uint32_t* version,
                      std::string* error);

} // namespace cli
