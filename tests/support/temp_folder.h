#pragma once

#include "tests/support/environment.h"

#include <cstdint>
#include <filesystem>
#include <string>
#include <vector>

namespace testing_support
{

// A fresh folder of the test's own, removed with everything in it at the end.
class TempFolder
{
public:
    TempFolder();
    ~TempFolder();
    TempFolder(const TempFolder&) = delete;
    TempFolder& operator=(const TempFolder&) = delete;

    const std::filesystem::path& Path() const { return path_; }
    std::string File(const std::string& name) const { return (path_ / name).string(); }

private:
    std::filesystem::path path_;
};

// A folder whose "Temp" subfolder is the process's TEMP for the scope, so
// the tool's own settings file lands inside it.
class TempSaveFolder
{
public:
    TempSaveFolder() : temp_("TEMP", (root_.Path() / "Temp").string().c_str()) {}

    // Where the tool keeps "GameConfig.dat" for this TEMP.
    std::filesystem::path SaveDirectory() const { return root_.Path() / "Tolvenik" / "VEK"; }
    std::string SettingsFile() const { return (SaveDirectory() / "GameConfig.dat").string(); }
    const TempFolder& Root() const { return root_; }
    // Writes the settings file, making its folder first.
    void WriteSettings(const std::vector<std::uint8_t>& bytes) const;

private:
    TempFolder root_;
    ScopedEnvironment temp_;
};

std::vector<std::uint8_t> ReadBytes(const std::string& path);
void WriteBytes(const std::string& path, const std::vector<std::uint8_t>& bytes);

} // namespace testing_support
