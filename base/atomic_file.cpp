#include "base/atomic_file.h"

#include "base/file_system.h"

#include <cstdio>
#include <string>

namespace base
{

bool WriteFileAtomically(const char* path, const void* data, std::size_t size)
{
    const std::string temporary = std::string(path) + ".new";
    std::FILE* file = std::fopen(temporary.c_str(), "wb");
    if (file == nullptr)
        return false;
    bool written = std::fwrite(data, 1, size, file) == size;
    written = FlushToDisk(file) && written;
    written = std::fclose(file) == 0 && written;
    if (written && ReplaceExistingFile(temporary.c_str(), path))
        return true;
    std::remove(temporary.c_str());
    return false;
}

} // namespace base
