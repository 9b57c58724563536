#pragma once

// The text fields of the record are fixed byte arrays of code page 932 text
// and its terminating zero. The pages, the defaults and vekcfg all read and
// store them here, so that every reader of a field sees the same text.

#include "config/config_sections.h"

#include <cstddef>
#include <string>
#include <string_view>

namespace config
{

// The longest text each kind of field takes from the tool.
inline constexpr std::size_t kPathTextLimit = kPathCapacity - 1;
inline constexpr std::size_t kIdTextLimit = kIdCapacity - 2;
inline constexpr std::size_t kRadioChatTextLimit = 37;
inline constexpr std::size_t kOctetTextLimit = 3;

// The text of a field: up to its first zero, and never its last byte, which
// only the terminator may hold. A field of a damaged file, filled to its end,
// so reads as it would after the tool had stored it back.
std::string FieldText(const char* field, std::size_t capacity);

template <std::size_t N> std::string FieldText(const char (&field)[N])
{
    return FieldText(field, N);
}

// How many leading bytes of `text` a field of at most `limit` bytes keeps:
// never half of a double-byte character, which the game would read together
// with the terminator.
std::size_t KeptTextLength(std::string_view text, std::size_t limit);

// Puts what the field keeps of `text` into it, with zeros to its end, so
// that a shorter text leaves nothing of a longer one behind.
void StoreFieldText(char* field, std::size_t capacity, std::size_t limit, std::string_view text);

template <std::size_t N>
void StoreFieldText(char (&field)[N], std::size_t limit, std::string_view text)
{
    StoreFieldText(field, N, limit, text);
}

} // namespace config
