#pragma once

#include "base/memory.h"

#include <cstdint>

namespace tension
{

// The least pack archive that LoadFromArchive needs: named entries, asked
// for by exact name and for their bytes. Entries are held in memory.
class CqvxPackFile : public base::CAllocated
{
public:
    CqvxPackFile() = default;
    CqvxPackFile(const CqvxPackFile&) = delete;
    CqvxPackFile& operator=(const CqvxPackFile&) = delete;
    virtual ~CqvxPackFile();

    // A copy of `size` bytes under `name`; false when it cannot be had.
    bool AddEntry(const char* name, const void* data, std::uint32_t size);
    std::uint32_t GetEntryCount() const { return count_; }

    // The index of the first entry of exactly this name, or -1.
    virtual std::int32_t FindEntry(const char* name) const;
    // The bytes of an entry; false when the archive cannot deliver them.
    virtual bool GetEntryBytes(std::int32_t index, const std::uint8_t** data,
                               std::uint32_t* size) const;

private:
    struct Entry
    {
        char* name;
        std::uint8_t* data;
        std::uint32_t size;
    };
    Entry* entries_ = nullptr;
    std::uint32_t count_ = 0;
};

// The archives LoadFromArchiveList tries, in order.
struct CqvxPackFileList
{
    const CqvxPackFile* const* archives;
    std::uint32_t count;
};

} // namespace tension
