#pragma once

#include <cstddef>
#include <string>

namespace base
{

// Writes `size` bytes to a temporary file beside `path` and then puts it in
// the place of `path` in one step. On any failure the temporary file is
// removed, false is returned and a previous file at `path` is untouched.
bool WriteFileAtomically(const char* path, const void* data, std::size_t size);

// The same for a file that must not exist yet: when something stands at
// `path`, or comes to stand there while the file is written, it is left as
// it is and false is returned.
bool WriteNewFileAtomically(const char* path, const void* data, std::size_t size);

// The temporary file's path: `path` with its extension replaced by "new"
// ("tmp" for a ".new" file), so that it is no longer than `path` and every
// path short enough for the system has a temporary name that is too.
std::string TemporaryPathFor(const std::string& path);

} // namespace base
