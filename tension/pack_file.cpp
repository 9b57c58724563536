#include "tension/pack_file.h"

#include <cstring>

namespace tension
{

CqvxPackFile::~CqvxPackFile()
{
    for (std::uint32_t i = 0; i < count_; ++i)
    {
        base::FreeBlock(entries_[i].name);
        base::FreeBlock(entries_[i].data);
    }
    base::FreeBlock(entries_);
}

bool CqvxPackFile::AddEntry(const char* name, const void* data, std::uint32_t size)
{
    if (name == nullptr || (data == nullptr && size != 0))
        return false;
    const std::size_t nameBytes = std::strlen(name) + 1;
    auto* copiedName = static_cast<char*>(base::AllocateZeroed(nameBytes));
    auto* copiedData = static_cast<std::uint8_t*>(base::AllocateZeroed(size));
    auto* grown = static_cast<Entry*>(base::AllocateZeroed((count_ + 1) * sizeof(Entry)));
    if (copiedName == nullptr || copiedData == nullptr || grown == nullptr)
    {
        base::FreeBlock(copiedName);
        base::FreeBlock(copiedData);
        base::FreeBlock(grown);
        return false;
    }
    std::memcpy(copiedName, name, nameBytes);
    if (size != 0)
        std::memcpy(copiedData, data, size);
    if (count_ != 0)
        std::memcpy(grown, entries_, count_ * sizeof(Entry));
    grown[count_] = Entry{copiedName, copiedData, size};
    base::FreeBlock(entries_);
    entries_ = grown;
    ++count_;
    return true;
}

std::int32_t CqvxPackFile::FindEntry(const char* name) const
{
    if (name == nullptr)
        return -1;
    for (std::uint32_t i = 0; i < count_; ++i)
    {
        if (std::strcmp(entries_[i].name, name) == 0)
            return static_cast<std::int32_t>(i);
    }
    return -1;
}

bool CqvxPackFile::GetEntryBytes(std::int32_t index, const std::uint8_t** data,
                                 std::uint32_t* size) const
{
    if (index < 0 || static_cast<std::uint32_t>(index) >= count_)
        return false;
    *data = entries_[index].data;
    *size = entries_[index].size;
    return true;
}

} // namespace tension
