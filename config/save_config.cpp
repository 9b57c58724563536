#include "config/save_config.h"

#include "base/atomic_file.h"
#include "base/c_runtime.h"
#include "base/cp932.h"
#include "base/file_system.h"
#include "config/field_table.h"
#include "config/fixed_text.h"

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <new>

namespace config
{
namespace
{

constexpr std::size_t kEntrySize = sizeof(IpEntry);

// A new exact-size copy of a list; null when the block cannot be had.
IpEntry* AllocateList(std::uint64_t count)
{
    return static_cast<IpEntry*>(
        base::AllocateZeroed(static_cast<std::size_t>(count * kEntrySize)));
}

bool AppendEntry(IpEntry*& list, std::uint32_t& count, const IpEntry& entry)
{
    IpEntry* grown = AllocateList(std::uint64_t(count) + 1);
    if (grown == nullptr)
        return false;
    if (count != 0)
        std::memcpy(grown, list, count * kEntrySize);
    grown[count] = entry;
    base::FreeBlock(list);
    list = grown;
    ++count;
    return true;
}

bool RemoveEntry(IpEntry*& list, std::uint32_t& count, std::int32_t index)
{
    if (index < 0 || static_cast<std::uint32_t>(index) >= count)
        return false;
    if (count == 1)
    {
        base::FreeBlock(list);
        list = nullptr;
        count = 0;
        return true;
    }
    IpEntry* shrunk = AllocateList(count - 1);
    if (shrunk == nullptr)
        return false;
    std::memcpy(shrunk, list, index * kEntrySize);
    std::memcpy(shrunk + index, list + index + 1, (count - index - 1) * kEntrySize);
    base::FreeBlock(list);
    list = shrunk;
    --count;
    return true;
}

// Reads the parts of a file image in order. Where the image ends, reads
// take what is left and report it: a short file keeps the defaults beyond.
class ImageReader
{
public:
    ImageReader(const std::uint8_t* data, std::size_t size) : data_(data), size_(size) {}

    std::size_t Remaining() const { return size_ - position_; }

    bool ReadU32(std::uint32_t& value)
    {
        if (Remaining() < sizeof value)
        {
            position_ = size_;
            return false;
        }
        std::memcpy(&value, data_ + position_, sizeof value);
        position_ += sizeof value;
        return true;
    }

    // Copies at most `capacity` of the `stored` bytes and passes over the
    // rest, so a longer section of a later version cannot overrun ours.
    void ReadSection(void* section, std::size_t capacity, std::uint32_t stored)
    {
        std::size_t wanted = stored < capacity ? stored : capacity;
        std::size_t taken = wanted < Remaining() ? wanted : Remaining();
        std::memcpy(section, data_ + position_, taken);
        position_ += taken;
        std::size_t excess = stored - wanted;
        position_ += excess < Remaining() ? excess : Remaining();
    }

    void ReadBytes(void* target, std::size_t size)
    {
        std::memcpy(target, data_ + position_, size);
        position_ += size;
    }

private:
    const std::uint8_t* data_;
    std::size_t size_;
    std::size_t position_ = 0;
};

// The length word and the payload of one section; absent parts keep what
// the section holds.
template <typename Section> void ReadSection(ImageReader& reader, Section& section)
{
    std::uint32_t stored = 0;
    if (reader.ReadU32(stored))
        reader.ReadSection(&section, sizeof section, stored);
}

// A list whose entries are not all in the image makes the whole file bad.
bool ReadList(ImageReader& reader, IpEntry*& list, std::uint32_t count)
{
    base::FreeBlock(list);
    list = nullptr;
    if (count == 0)
        return true;
    if (std::uint64_t(count) * kEntrySize > reader.Remaining())
        return false;
    list = AllocateList(count);
    if (list == nullptr)
        return false;
    reader.ReadBytes(list, count * kEntrySize);
    return true;
}

template <typename Section>
void AppendSection(std::vector<std::uint8_t>& image, const Section& section)
{
    const std::uint32_t length = sizeof section;
    const auto* lengthBytes = reinterpret_cast<const std::uint8_t*>(&length);
    image.insert(image.end(), lengthBytes, lengthBytes + sizeof length);
    const auto* bytes = reinterpret_cast<const std::uint8_t*>(&section);
    image.insert(image.end(), bytes, bytes + sizeof section);
}

void AppendList(std::vector<std::uint8_t>& image, const IpEntry* list, std::uint32_t count)
{
    if (count == 0 || list == nullptr)
        return;
    const auto* bytes = reinterpret_cast<const std::uint8_t*>(list);
    image.insert(image.end(), bytes, bytes + count * kEntrySize);
}

std::uint32_t WordAt(const std::uint8_t* data, std::size_t offset)
{
    std::uint32_t word;
    std::memcpy(&word, data + offset, sizeof word);
    return word;
}

} // namespace

ImageCheck CheckWrittenImage(const std::uint8_t* data, std::size_t size)
{
    ImageCheck check;
    if (size < sizeof(std::uint32_t))
    {
        check.fault = ImageFault::ShorterThanVersion;
        return check;
    }
    check.version = WordAt(data, 0);
    if (check.version != kFileVersion)
    {
        check.fault =
            check.version > kFileVersion ? ImageFault::NewerVersion : ImageFault::OtherVersion;
        return check;
    }
    const struct
    {
        const char* name;
        std::uint32_t length;
        bool listsFollow;
    } sections[] = {
        {"graphics", sizeof(ConfigGraphics), false},   {"game", sizeof(ConfigGame), false},
        {"network", sizeof(ConfigNetwork), true},      {"replay", sizeof(ConfigReplay), false},
        {"userBgm", sizeof(ConfigUserBgm), false},     {"keys", sizeof(ConfigKeys), false},
        {"radioChat", sizeof(ConfigRadioChat), false},
    };
    std::uint64_t position = sizeof(std::uint32_t);
    for (const auto& section : sections)
    {
        if (position + sizeof(std::uint32_t) > size)
        {
            check.fault = ImageFault::SizeMismatch;
            return check;
        }
        const std::uint32_t stored = WordAt(data, position);
        if (stored != section.length)
        {
            check.fault = ImageFault::SectionLength;
            check.section = section.name;
            check.storedLength = stored;
            check.length = section.length;
            return check;
        }
        position += sizeof stored + stored;
        if (section.listsFollow && position <= size)
        {
            const std::size_t counts =
                position - sizeof(ConfigNetwork) + offsetof(ConfigNetwork, allowCount);
            position +=
                (std::uint64_t(WordAt(data, counts)) + WordAt(data, counts + 4)) * kEntrySize;
        }
    }
    if (position != size)
    {
        check.fault = ImageFault::SizeMismatch;
        check.expectedSize = position;
    }
    return check;
}

bool IsConnectSlotEmpty(const IpEntry& entry)
{
    for (const char(&octet)[4] : entry.octets)
    {
        if (base::ReadLeadingInteger(FieldText(octet).c_str()) != 0)
            return false;
    }
    return true;
}

bool BuildSaveDirectory(char* buffer, const char* folder, std::size_t size)
{
    const char* temp = std::getenv("TEMP");
    if (temp == nullptr || size == 0)
        return false;
    const char separator = base::PathSeparator();
    const char* lastSeparator = base::FindLastCharacter(temp, separator);
    const std::size_t kept = lastSeparator != nullptr ? std::size_t(lastSeparator - temp) + 1 : 1;
    const std::size_t companyLength = std::strlen("Tolvenik");
    // The kept part, the two folders with their separators, the file name
    // and the terminator must all fit.
    const std::size_t needed =
        kept + companyLength + 1 + std::strlen(folder) + 1 + std::strlen(kFileName) + 1;
    if (needed > size)
        return false;
    std::memset(buffer, 0, size);
    std::memcpy(buffer, temp, kept);
    std::size_t length = std::strlen(buffer);
    std::memcpy(buffer + length, "Tolvenik", companyLength);
    base::CreateDirectoryIgnoringFailure(buffer);
    length = std::strlen(buffer);
    buffer[length] = separator;
    std::memcpy(buffer + length + 1, folder, std::strlen(folder));
    base::CreateDirectoryIgnoringFailure(buffer);
    buffer[std::strlen(buffer)] = separator;
    return true;
}

bool BuildSaveFilePath(char* buffer, std::size_t size)
{
    if (!BuildSaveDirectory(buffer, kSaveFolderName, size))
        return false;
    std::strcat(buffer, kFileName);
    return true;
}

CSaveConfig::CSaveConfig()
    : graphics_(), game_(), network_(), allowList_(nullptr), denyList_(nullptr), replay_(),
      userBgm_(), keys_(), radioChat_()
{
}

CSaveConfig::CSaveConfig(const CSaveConfig& other)
    : graphics_(other.graphics_), game_(other.game_), network_(other.network_), allowList_(nullptr),
      denyList_(nullptr), replay_(other.replay_), userBgm_(other.userBgm_), keys_(other.keys_),
      radioChat_(other.radioChat_)
{
    // A list that cannot be copied leaves the clone with an empty list, so
    // its count always matches its array; Clone reports it.
    if (other.network_.allowCount != 0)
    {
        allowList_ = AllocateList(other.network_.allowCount);
        if (allowList_ != nullptr)
            std::memcpy(allowList_, other.allowList_, other.network_.allowCount * kEntrySize);
        else
            network_.allowCount = 0;
    }
    if (other.network_.denyCount != 0)
    {
        denyList_ = AllocateList(other.network_.denyCount);
        if (denyList_ != nullptr)
            std::memcpy(denyList_, other.denyList_, other.network_.denyCount * kEntrySize);
        else
            network_.denyCount = 0;
    }
}

CSaveConfig::~CSaveConfig()
{
    Release();
}

bool CSaveConfig::Release()
{
    base::FreeBlock(allowList_);
    allowList_ = nullptr;
    base::FreeBlock(denyList_);
    denyList_ = nullptr;
    return true;
}

const char* CSaveConfig::GetClassName() const
{
    return "CSaveConfig";
}

std::uint32_t CSaveConfig::GetClassSize() const
{
    return sizeof(CSaveConfig);
}

CSaveConfig* CSaveConfig::CreateAt(void* memory) const
{
    return new (memory) CSaveConfig();
}

CSaveConfig* CSaveConfig::Create() const
{
    return new (std::nothrow) CSaveConfig();
}

CSaveConfig* CSaveConfig::CloneAt(void* memory) const
{
    return new (memory) CSaveConfig(*this);
}

CSaveConfig* CSaveConfig::Clone() const
{
    CSaveConfig* clone = new (std::nothrow) CSaveConfig(*this);
    if (clone != nullptr && (clone->network_.allowCount != network_.allowCount ||
                             clone->network_.denyCount != network_.denyCount))
    {
        delete clone;
        return nullptr;
    }
    return clone;
}

bool CSaveConfig::Load()
{
    char path[kSavePathCapacity];
    if (!BuildSaveFilePath(path, sizeof path))
        return false;
    return LoadFromPath(path);
}

bool CSaveConfig::Save() const
{
    char path[kSavePathCapacity];
    if (!BuildSaveFilePath(path, sizeof path))
        return false;
    return SaveToPath(path);
}

bool CSaveConfig::LoadFromPath(const char* path)
{
    std::vector<std::uint8_t> image;
    errno = 0;
    std::FILE* file = std::fopen(path, "rb");
    // Only a file that is not there gets the defaults: one that is there but
    // cannot be opened now (locked, a folder in its place) must not be
    // replaced by them.
    if (file == nullptr && errno != ENOENT)
        return false;
    if (file != nullptr)
    {
        std::uint8_t chunk[4096];
        std::size_t read;
        while ((read = std::fread(chunk, 1, sizeof chunk, file)) != 0)
            image.insert(image.end(), chunk, chunk + read);
        const bool failed = std::ferror(file) != 0;
        std::fclose(file);
        if (failed)
            return false;
    }
    if (file == nullptr || image.size() < sizeof(std::uint32_t))
    {
        ResetAll();
        return SaveToPath(path);
    }
    return LoadFromBytes(image.data(), image.size());
}

bool CSaveConfig::LoadFromBytes(const std::uint8_t* data, std::size_t size)
{
    ImageReader reader(data, size);
    std::uint32_t version = 0;
    if (!reader.ReadU32(version) || version > kFileVersion)
        return false;

    // Read into a scratch record so that a bad file leaves this one alone.
    CSaveConfig loaded;
    loaded.ResetGraphics();
    ReadSection(reader, loaded.graphics_);
    loaded.ResetGame();
    ReadSection(reader, loaded.game_);
    loaded.ResetNetwork();
    ReadSection(reader, loaded.network_);
    if (!ReadList(reader, loaded.allowList_, loaded.network_.allowCount) ||
        !ReadList(reader, loaded.denyList_, loaded.network_.denyCount))
        return false;
    loaded.ResetReplay();
    ReadSection(reader, loaded.replay_);
    loaded.ResetUserBgm();
    ReadSection(reader, loaded.userBgm_);
    loaded.ResetKeys();
    ReadSection(reader, loaded.keys_);
    loaded.ResetRadioChat();
    ReadSection(reader, loaded.radioChat_);
    if (version == kFirstFileVersion)
    {
        loaded.ResetNetwork();
        loaded.ResetReplay();
        loaded.ResetRadioChat();
    }

    Release();
    graphics_ = loaded.graphics_;
    game_ = loaded.game_;
    network_ = loaded.network_;
    allowList_ = loaded.allowList_;
    denyList_ = loaded.denyList_;
    replay_ = loaded.replay_;
    userBgm_ = loaded.userBgm_;
    keys_ = loaded.keys_;
    radioChat_ = loaded.radioChat_;
    loaded.allowList_ = nullptr;
    loaded.denyList_ = nullptr;
    return true;
}

std::vector<std::uint8_t> CSaveConfig::SaveToBytes() const
{
    std::vector<std::uint8_t> image;
    image.reserve(6876 + (std::size_t(network_.allowCount) + network_.denyCount) * kEntrySize);
    const std::uint32_t version = kFileVersion;
    const auto* versionBytes = reinterpret_cast<const std::uint8_t*>(&version);
    image.insert(image.end(), versionBytes, versionBytes + sizeof version);
    AppendSection(image, graphics_);
    AppendSection(image, game_);
    AppendSection(image, network_);
    AppendList(image, allowList_, network_.allowCount);
    AppendList(image, denyList_, network_.denyCount);
    AppendSection(image, replay_);
    AppendSection(image, userBgm_);
    AppendSection(image, keys_);
    AppendSection(image, radioChat_);
    return image;
}

bool CSaveConfig::SaveToPath(const char* path) const
{
    const std::vector<std::uint8_t> image = SaveToBytes();
    return base::WriteFileAtomically(path, image.data(), image.size());
}

bool CSaveConfig::AddAllowEntry(const IpEntry& entry)
{
    std::uint32_t count = network_.allowCount;
    const bool added = AppendEntry(allowList_, count, entry);
    network_.allowCount = count;
    return added;
}

bool CSaveConfig::AddDenyEntry(const IpEntry& entry)
{
    std::uint32_t count = network_.denyCount;
    const bool added = AppendEntry(denyList_, count, entry);
    network_.denyCount = count;
    return added;
}

bool CSaveConfig::RemoveAllowEntry(std::int32_t index)
{
    std::uint32_t count = network_.allowCount;
    const bool removed = RemoveEntry(allowList_, count, index);
    network_.allowCount = count;
    return removed;
}

bool CSaveConfig::RemoveDenyEntry(std::int32_t index)
{
    std::uint32_t count = network_.denyCount;
    const bool removed = RemoveEntry(denyList_, count, index);
    network_.denyCount = count;
    return removed;
}

bool CSaveConfig::AddConnectEntry(const IpEntry& entry)
{
    for (IpEntry& slot : network_.connectList)
    {
        if (IsConnectSlotEmpty(slot))
        {
            slot = entry;
            return true;
        }
    }
    return false;
}

bool CSaveConfig::RemoveConnectEntry(std::int32_t index)
{
    if (index < 0 || index >= kConnectSlotCount)
        return false;
    IpEntry* slots = network_.connectList;
    std::memmove(&slots[index], &slots[index + 1], (kConnectSlotCount - 1 - index) * kEntrySize);
    std::memset(&slots[kConnectSlotCount - 1], 0, kEntrySize);
    return true;
}

bool CSaveConfig::ResetGraphics()
{
    ResetFields(*this, "graphics.");
    return true;
}

bool CSaveConfig::ResetGame()
{
    ResetFields(*this, "game.");
    return true;
}

bool CSaveConfig::ResetNetwork()
{
    ResetFields(*this, "network.");
    network_.allowCount = 0;
    network_.denyCount = 0;
    base::FreeBlock(allowList_);
    allowList_ = nullptr;
    base::FreeBlock(denyList_);
    denyList_ = nullptr;
    return true;
}

bool CSaveConfig::ResetReplay()
{
    ResetFields(*this, "replay.");
    return true;
}

bool CSaveConfig::ResetUserBgm()
{
    ResetFields(*this, "userBgm.");
    return true;
}

bool CSaveConfig::ResetKeys()
{
    ResetFields(*this, "keys.");
    return true;
}

bool CSaveConfig::ResetRadioChat()
{
    ResetFields(*this, "radioChat.");
    return true;
}

bool CSaveConfig::ResetKeyboardKeys()
{
    ResetFields(*this, "keys.keyboardKeys");
    return true;
}

bool CSaveConfig::ResetPadButtons(std::uint8_t player)
{
    if (player >= kPlayerCount)
        return false;
    ResetFields(*this, "keys.padConfigs", player);
    return true;
}

void CSaveConfig::ResetAll()
{
    ResetGraphics();
    ResetGame();
    ResetNetwork();
    ResetReplay();
    ResetUserBgm();
    ResetKeys();
    ResetRadioChat();
}

} // namespace config
