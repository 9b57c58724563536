#pragma once

#include "base/memory.h"
#include "config/config_sections.h"

#include <cstddef>
#include <cstdint>
#include <vector>

namespace config
{

inline constexpr std::uint32_t kFileVersion = 0x13001000;
// Files of this version hold network, replay and radio-chat sections of
// another layout: those are read past and replaced by their defaults.
inline constexpr std::uint32_t kFirstFileVersion = 0x10001000;
inline constexpr char kSaveFolderName[] = "VEK";
inline constexpr char kFileName[] = "GameConfig.dat";
inline constexpr std::size_t kSavePathCapacity = 512;

// Fills `buffer` (all `size` bytes) with the folder of the settings file,
// derived from "TEMP", creating its two directories on the way; the result
// ends with a separator. False when "TEMP" is not set or the path would not
// fit in the buffer together with the file name.
bool BuildSaveDirectory(char* buffer, const char* folder, std::size_t size);

// The settings file's full path, built as the tool builds it.
bool BuildSaveFilePath(char* buffer, std::size_t size);

// Why an image is not a settings file exactly as this tool writes one.
enum class ImageFault
{
    None,
    ShorterThanVersion,
    NewerVersion,
    OtherVersion,
    SectionLength,
    SizeMismatch,
};

struct ImageCheck
{
    ImageFault fault = ImageFault::None;
    std::uint32_t version = 0;
    // SectionLength: which section, its stored length and ours.
    const char* section = nullptr;
    std::uint32_t storedLength = 0;
    std::uint32_t length = 0;
    // SizeMismatch: the size its sections and list counts make (0 when the
    // image ends before its list counts).
    std::uint64_t expectedSize = 0;
};

// Whether an image is a settings file of the current version with the
// section lengths it writes and the size they and its list counts make:
// the only kind of file vekcfg rewrites.
ImageCheck CheckWrittenImage(const std::uint8_t* data, std::size_t size);

// Every setting the tool edits: the image of "GameConfig.dat".
class CSaveConfig : public base::CAllocated
{
public:
    CSaveConfig();
    CSaveConfig(const CSaveConfig& other);
    CSaveConfig& operator=(const CSaveConfig&) = delete;

    virtual ~CSaveConfig();
    virtual bool Release();
    virtual const char* GetClassName() const;
    virtual std::uint32_t GetClassSize() const;
    virtual CSaveConfig* CreateAt(void* memory) const;
    virtual CSaveConfig* Create() const;
    virtual CSaveConfig* CloneAt(void* memory) const;
    virtual CSaveConfig* Clone() const;

    // The tool's own file in the save directory. A missing file gets the
    // defaults and is written at once.
    bool Load();
    bool Save() const;

    // The same from a given path, for tools and tests.
    bool LoadFromPath(const char* path);
    bool SaveToPath(const char* path) const;

    // Takes a whole file image. False for a file the tool must not use; the
    // record is then left as it was. An image shorter than its version word
    // is not a file: the caller decides (Load treats it as missing).
    bool LoadFromBytes(const std::uint8_t* data, std::size_t size);
    std::vector<std::uint8_t> SaveToBytes() const;

    ConfigGraphics* Graphics() { return &graphics_; }
    ConfigGame* Game() { return &game_; }
    ConfigNetwork* Network() { return &network_; }
    ConfigReplay* Replay() { return &replay_; }
    ConfigUserBgm* UserBgm() { return &userBgm_; }
    ConfigKeys* Keys() { return &keys_; }
    ConfigRadioChat* RadioChat() { return &radioChat_; }
    const ConfigGraphics* Graphics() const { return &graphics_; }
    const ConfigGame* Game() const { return &game_; }
    const ConfigNetwork* Network() const { return &network_; }
    const ConfigReplay* Replay() const { return &replay_; }
    const ConfigUserBgm* UserBgm() const { return &userBgm_; }
    const ConfigKeys* Keys() const { return &keys_; }
    const ConfigRadioChat* RadioChat() const { return &radioChat_; }

    // No bounds check: callers iterate below the list's count.
    IpEntry* GetAllowEntry(std::uint32_t index) { return &allowList_[index]; }
    IpEntry* GetDenyEntry(std::uint32_t index) { return &denyList_[index]; }
    const IpEntry* GetAllowEntry(std::uint32_t index) const { return &allowList_[index]; }
    const IpEntry* GetDenyEntry(std::uint32_t index) const { return &denyList_[index]; }

    bool AddAllowEntry(const IpEntry& entry);
    bool AddDenyEntry(const IpEntry& entry);
    bool RemoveAllowEntry(std::int32_t index);
    bool RemoveDenyEntry(std::int32_t index);
    bool AddConnectEntry(const IpEntry& entry);
    bool RemoveConnectEntry(std::int32_t index);

    bool ResetGraphics();
    bool ResetGame();
    bool ResetNetwork();
    bool ResetReplay();
    bool ResetUserBgm();
    bool ResetKeys();
    bool ResetRadioChat();
    bool ResetKeyboardKeys();
    bool ResetPadButtons(std::uint8_t player);
    // Every section to its defaults, as for a missing file.
    void ResetAll();

private:
    ConfigGraphics graphics_;
    ConfigGame game_;
    ConfigNetwork network_;
    IpEntry* allowList_;
    IpEntry* denyList_;
    ConfigReplay replay_;
    ConfigUserBgm userBgm_;
    ConfigKeys keys_;
    ConfigRadioChat radioChat_;
};

// A connect slot is empty when its four octets all read as 0 by atoi.
bool IsConnectSlotEmpty(const IpEntry& entry);

} // namespace config
