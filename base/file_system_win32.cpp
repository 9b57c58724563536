#include "base/file_system.h"
#include "base/win32.h"

#include <io.h>

namespace base
{

char PathSeparator()
{
    return '\\';
}

void CreateDirectoryIgnoringFailure(const char* path)
{
    ::CreateDirectoryA(path, nullptr);
}

bool FlushToDisk(std::FILE* file)
{
    return std::fflush(file) == 0 && ::_commit(::_fileno(file)) == 0;
}

bool ReplaceExistingFile(const char* source, const char* target)
{
    return ::MoveFileExA(source, target, MOVEFILE_REPLACE_EXISTING | MOVEFILE_WRITE_THROUGH) != 0;
}

bool MoveToNewName(const char* source, const char* target)
{
    return ::MoveFileExA(source, target, MOVEFILE_WRITE_THROUGH) != 0;
}

} // namespace base
