#include "sound/byte_source.h"

#include <climits>
#include <cstring>

namespace sound
{

bool MemorySource::ReadAt(std::uint64_t offset, void* buffer, std::size_t size)
{
    if (offset > size_ || size > size_ - offset)
        return false;
    if (size != 0)
        std::memcpy(buffer, data_ + offset, size);
    return true;
}

FileSource::~FileSource()
{
    if (file_ != nullptr)
        std::fclose(file_);
}

bool FileSource::Open(const char* path)
{
    file_ = std::fopen(path, "rb");
    if (file_ == nullptr)
        return false;
    if (std::fseek(file_, 0, SEEK_END) != 0)
        return false;
    const long end = std::ftell(file_);
    if (end < 0)
        return false;
    size_ = static_cast<std::uint64_t>(end);
    return true;
}

bool FileSource::ReadAt(std::uint64_t offset, void* buffer, std::size_t size)
{
    if (file_ == nullptr || offset > size_ || size > size_ - offset)
        return false;
    // Positions that std::fseek cannot reach: the file is bigger than any
    // sound buffer then, and is refused.
    if (offset > static_cast<std::uint64_t>(LONG_MAX))
        return false;
    if (std::fseek(file_, static_cast<long>(offset), SEEK_SET) != 0)
        return false;
    return std::fread(buffer, 1, size, file_) == size;
}

} // namespace sound
