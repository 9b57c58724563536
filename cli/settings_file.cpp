#include "cli/settings_file.h"

#include "cli/encoding.h"

#include <cerrno>
#include <cstdio>
#include <cstring>
#include <vector>

namespace cli
{
namespace
{

std::string Quoted(const std::string& path)
{
    std::string quoted = "\"";
    quoted += Utf8FromNative(path);
    quoted += '"';
    return quoted;
}

} // namespace

bool LoadSettingsFile(const std::string& path, config::CSaveConfig& record, std::uint32_t* version,
                      std::string* error)
{
    errno = 0;
    std::FILE* file = std::fopen(path.c_str(), "rb");
    std::vector<std::uint8_t> image;
    int readError = 0;
    if (file != nullptr)
    {
        std::uint8_t chunk[4096];
        for (std::size_t got; (got = std::fread(chunk, 1, sizeof chunk, file)) != 0;)
            image.insert(image.end(), chunk, chunk + got);
        // A folder opens on POSIX and fails at the first read.
        if (std::ferror(file))
            readError = errno != 0 ? errno : EIO;
        std::fclose(file);
    }
    else
    {
        readError = errno != 0 ? errno : ENOENT;
    }
    if (readError != 0)
    {
        *error = "cannot read the settings file " + Quoted(path) + ": " +
                 Utf8FromNative(std::strerror(readError));
        return false;
    }

    std::uint32_t stored = 0;
    if (image.size() < sizeof stored)
    {
        *error = "the settings file " + Quoted(path) +
                 " is not a settings file: it is shorter than its version word";
        return false;
    }
    std::memcpy(&stored, image.data(), sizeof stored);
    *version = stored;
    if (stored > config::kFileVersion)
    {
        char versions[96];
        std::snprintf(versions, sizeof versions,
                      " has version 0x%08X; this tool reads versions up to 0x%08X",
                      static_cast<unsigned>(stored), static_cast<unsigned>(config::kFileVersion));
        *error = "the settings file " + Quoted(path) + versions;
        return false;
    }
    if (!record.LoadFromBytes(image.data(), image.size()))
    {
        *error =
            "the settings file " + Quoted(path) + " is damaged: its address lists run past its end";
        return false;
    }
    return true;
}

} // namespace cli
