#include "tests/support/temp_folder.h"

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
    SetEnvironment(name, value);
}

ScopedEnvironment::~ScopedEnvironment()
{
    SetEnvironment(name_.c_str(), previous_ ? previous_->c_str() : nullptr);
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

void TempSaveFolder::WriteSettings(const std::vector<std::uint8_t>& bytes) const
{
    std::filesystem::create_directories(SaveDirectory());
    WriteBytes(SettingsFile(), bytes);
}

} // namespace testing_support
