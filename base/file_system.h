#pragma once

#include <cstdio>

// The few file-system services whose form differs between Windows and POSIX.
namespace base
{

// '\\' on Windows, '/' elsewhere.
char PathSeparator();

// Creates one directory; an existing directory, or any other failure, is
// left for the caller's next file operation to report.
void CreateDirectoryIgnoringFailure(const char* path);

// Pushes a written file's data to the disk before it replaces another file.
bool FlushToDisk(std::FILE* file);

// Puts `source` in the place of `target` in one step, replacing it.
bool ReplaceExistingFile(const char* source, const char* target);

// Puts `source` in the place of `target` in one step, only when nothing
// stands there.
bool MoveToNewName(const char* source, const char* target);

} // namespace base
