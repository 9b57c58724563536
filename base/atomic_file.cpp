#include "base/atomic_file.h"

#include "base/file_system.h"

#include <cstdio>
#include <string>

namespace base
{

std::string TemporaryPathFor(const std::string& path)
{
    const std::size_t nameStart = path.find_last_of(std::string("/") + PathSeparator()) + 1;
    const std::size_t dot = path.rfind('.');
    if (dot == std::string::npos || dot < nameStart)
        return path + ".new";
    const std::string extension = path.substr(dot + 1) == "new" ? "tmp" : "new";
    return path.substr(0, dot + 1) + extension;
}

namespace
{

bool WriteThenMove(const char* path, const void* data, std::size_t size, bool replacing)
{
    const std::string temporary = TemporaryPathFor(path);
    std::FILE* file = std::fopen(temporary.c_str(), "wb");
    if (file == nullptr)
        return false;
    bool written = std::fwrite(data, 1, size, file) == size;
    written = FlushToDisk(file) && written;
    written = std::fclose(file) == 0 && written;
    if (written && (replacing ? ReplaceExistingFile(temporary.c_str(), path)
                              : MoveToNewName(temporary.c_str(), path)))
        return true;
    std::remove(temporary.c_str());
    return false;
}

} // namespace

bool WriteFileAtomically(const char* path, const void* data, std::size_t size)
{
    return WriteThenMove(path, data, size, true);
}

bool WriteNewFileAtomically(const char* path, const void* data, std::size_t size)
{
    return WriteThenMove(path, data, size, false);
}

} // namespace base
