#include "base/file_system.h"

#include <cstdio>
#include <sys/stat.h>
#include <unistd.h>

namespace base
{

char PathSeparator()
{
    return '/';
}

void CreateDirectoryIgnoringFailure(const char* path)
{
    ::mkdir(path, 0777);
}

bool FlushToDisk(std::FILE* file)
{
    return std::fflush(file) == 0 && ::fsync(::fileno(file)) == 0;
}

bool ReplaceExistingFile(const char* source, const char* target)
{
    return std::rename(source, target) == 0;
}

bool MoveToNewName(const char* source, const char* target)
{
    // A link fails where a file stands; rename would replace it.
    if (::link(source, target) != 0)
        return false;
    ::unlink(source);
    return true;
}

} // namespace base
