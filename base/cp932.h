#pragma once

#include <cstdint>

namespace base
{

// True for the first byte of a double-byte character of code page 932.
constexpr bool IsLeadByte(std::uint8_t byte)
{
    return (byte >= 0x81 && byte <= 0x9F) || (byte >= 0xE0 && byte <= 0xFC);
}

} // namespace base
