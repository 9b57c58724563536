#pragma once

#include <cstdint>

namespace base
{

// True for the first byte of a double-byte character of code page 932.
constexpr bool IsLeadByte(std::uint8_t byte)
{
    return (byte >= 0x81 && byte <= 0x9F) || (byte >= 0xE0 && byte <= 0xFC);
}

// The last single-byte character `c` of a text, or null. The scan goes
// forward a character at a time, as the trail byte of a double-byte character
// may equal `c`: ソ is 0x83 0x5C, and 0x5C is the backslash.
constexpr const char* FindLastCharacter(const char* text, char c)
{
    const char* last = nullptr;
    for (const char* p = text; *p != '\0'; ++p)
    {
        if (*p == c)
            last = p;
        else if (IsLeadByte(static_cast<std::uint8_t>(*p)) && p[1] != '\0')
            ++p;
    }
    return last;
}

} // namespace base
