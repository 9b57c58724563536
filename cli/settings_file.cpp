#include "cli/settings_file.h"

#include "cli/encoding.h"

#include <cerrno>
#include <cstring>

namespace cli
{
namespace
{

std::string Hex(std::uint32_t value)
{
    char text[16];
    std::snprintf(text, sizeof text, "0x%08X", static_cast<unsigned>(value));
    return text;
}

// What a file that is not one this tool writes is not, or empty.
std::string ImageProblem(const config::ImageCheck& check, std::size_t size)
{
    const std::string notOne = " is not a settings file: ";
    switch (check.fault)
    {
    case config::ImageFault::None:
        break;
    case config::ImageFault::ShorterThanVersion:
        return notOne + "it is shorter than its version word";
    case config::ImageFault::NewerVersion:
        return notOne + "its version word, " + Hex(check.version) +
               ", is above the versions this tool reads, up to " + Hex(config::kFileVersion);
    case config::ImageFault::OtherVersion:
        return check.version == config::kFirstFileVersion
                   ? " has the first layout, version " + Hex(check.version) +
                         ", which vekcfg does not read: save it once in VEK Config"
                   : notOne + "its first word, " + Hex(check.version) +
                         ", is no version this tool writes (" + Hex(config::kFileVersion) + ")";
    case config::ImageFault::SectionLength:
        return notOne + "its " + check.section + " section is " +
               std::to_string(check.storedLength) + " bytes where this tool writes " +
               std::to_string(check.length);
    case config::ImageFault::SizeMismatch:
        return notOne + "it is " + std::to_string(size) + " bytes" +
               (check.expectedSize != 0 ? " where its sections and address lists make " +
                                              std::to_string(check.expectedSize)
                                        : ", too short for its sections");
    }
    return std::string();
}

} // namespace

bool ReadBounded(std::FILE* stream, std::size_t limit, std::string* bytes, bool* tooLarge)
{
    *tooLarge = false;
    char chunk[4096];
    for (std::size_t got; (got = std::fread(chunk, 1, sizeof chunk, stream)) != 0;)
    {
        if (got > limit - bytes->size())
        {
            *tooLarge = true;
            return false;
        }
        bytes->append(chunk, got);
    }
    return std::ferror(stream) == 0;
}

bool LoadSettingsFile(const std::string& path, config::CSaveConfig& record, std::uint32_t* version,
                      std::string* error)
{
    const std::string quoted = "the file \"" + Utf8FromNative(path) + "\"";
    errno = 0;
    std::FILE* file = std::fopen(path.c_str(), "rb");
    std::string image;
    bool tooLarge = false;
    // A folder opens on POSIX and fails at the first read.
    const bool read =
        file != nullptr && ReadBounded(file, kMaxSettingsFileBytes, &image, &tooLarge);
    const int readError = errno != 0 ? errno : EIO;
    if (file != nullptr)
        std::fclose(file);
    if (tooLarge)
    {
        *error = quoted + " is not a settings file: it is larger than " +
                 std::to_string(kMaxSettingsFileBytes >> 20) + " MiB";
        return false;
    }
    if (!read)
    {
        *error = "cannot read the settings file \"" + Utf8FromNative(path) +
                 "\": " + Utf8FromNative(std::strerror(readError));
        return false;
    }
    const auto* data = reinterpret_cast<const std::uint8_t*>(image.data());
    const config::ImageCheck check = config::CheckWrittenImage(data, image.size());
    *version = check.version;
    const std::string problem = ImageProblem(check, image.size());
    if (!problem.empty())
    {
        *error = quoted + problem;
        return false;
    }
    if (!record.LoadFromBytes(data, image.size()))
    {
        *error = "cannot load " + quoted + ": out of memory for its address lists";
        return false;
    }
    return true;
}

} // namespace cli
