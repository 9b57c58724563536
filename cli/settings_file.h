#pragma once

#include "config/save_config.h"

#include <cstdint>
#include <cstdio>
#include <string>

namespace cli
{

// No settings file is this large (a million addresses); nothing larger is
// read into memory.
inline constexpr std::size_t kMaxSettingsFileBytes = std::size_t(16) << 20;

// Reads a whole stream of at most `limit` bytes. False with errno's reason,
// or with `tooLarge` set when the stream holds more.
bool ReadBounded(std::FILE* stream, std::size_t limit, std::string* bytes, bool* tooLarge);

// Reads a settings file into `record`, never writing: only a file exactly as
// this tool writes one is taken (the current version, its section lengths
// and the size they make); anything else is refused with a message (UTF-8)
// that names the path and says what the file is not. `version` receives the
// file's version word.
bool LoadSettingsFile(const std::string& path, config::CSaveConfig& record, std::uint32_t* version,
                      std::string* error);

} // namespace cli
