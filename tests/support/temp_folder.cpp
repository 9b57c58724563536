#include "tests/support/temp_folder.h"

#include <algorithm>
#include <atomic>
#include <cstdlib>
#include <fstream>
#include <iterator>
#include <random>

namespace testing_support
{
namespace
{
std::filesystem::path NewFolderPath()
{
    static std::atomic<int> counter{0};
    // <chrono> cannot be used here: its literals have no code page 932 form.
    static const unsigned stamp = std::random_device{}();
    return std::filesystem::temp_directory_path() /
           ("vek-test-" + std::to_string(stamp) + "-" + std::to_string(counter++));
}
} // namespace

ScopedEnvironment::ScopedEnvironment(const char* name, const char* value) : name_(name)
{
    if (const char* old = std::getenv(name))
        previous_ = old;
    if (value != nullptr)
        SetEnvironment(name, value);
    else
        ClearEnvironment(name);
}

ScopedEnvironment::~ScopedEnvironment()
{
    if (previous_)
        SetEnvironment(name_.c_str(), previous_->c_str());
    else
        ClearEnvironment(name_.c_str());
}

TempFolder::TempFolder() : path_(NewFolderPath())
{
    std::filesystem::create_directories(path_);
}

TempFolder::~TempFolder()
{
    std::error_code ignored;
    std::filesystem::remove_all(path_, ignored);
}

TempSaveFolder::TempSaveFolder() : temp_("TEMP", (root_.Path() / "Temp").string().c_str()) {}

std::filesystem::path TempSaveFolder::SaveDirectory() const
{
    return root_.Path() / "Tolvenik" / "VEK";
}

std::string TempSaveFolder::SettingsFile() const
{
    return (SaveDirectory() / "GameConfig.dat").string();
}

std::string PathOfLength(const TempFolder& folder, std::size_t length, const std::string& ending)
{
    constexpr std::size_t kLongestPart = 200;
    const std::string separator(1, std::filesystem::path::preferred_separator);
    std::string path = folder.Path().string();
    // Folders of at most kLongestPart bytes until the last part fits in one.
    for (;;)
    {
        const std::size_t minimum = path.size() + separator.size() + ending.size();
        if (minimum > length)
            return "";
        const std::size_t left = length - minimum;
        if (left <= kLongestPart)
        {
            path += separator + std::string(left, 'f') + ending;
            break;
        }
        const std::size_t part = std::min(kLongestPart, left - separator.size() - 1);
        path += separator + std::string(part, 'd');
    }
    std::error_code error;
    std::filesystem::create_directories(std::filesystem::path(path).parent_path(), error);
    return error ? "" : path;
}

std::vector<std::uint8_t> ReadBytes(const std::string& path)
{
    std::ifstream in(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>()};
}

void WriteBytes(const std::string& path, const std::vector<std::uint8_t>& bytes)
{
    std::ofstream out(path, std::ios::binary | std::ios::trunc);
    out.write(reinterpret_cast<const char*>(bytes.data()), std::streamsize(bytes.size()));
}

} // namespace testing_support
