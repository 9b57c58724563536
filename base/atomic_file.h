#pragma once

#include <cstddef>

namespace base
{

// Writes `size` bytes to a temporary file beside `path` and then puts it in
// the place of `path` in one step. On any failure the temporary file is
// removed, false is returned and a previous file at `path` is untouched.
bool WriteFileAtomically(const char* path, const void* data, std::size_t size);

} // namespace base
