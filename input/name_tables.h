#pragma once

#include <cstddef>
#include <cstdint>

namespace input
{

// Key codes are DirectInput key codes; the table covers 0x00..0xFC.
inline constexpr std::size_t kKeyNameCount = 253;
// Controller button codes 0..47 come from controllers; the table names 0..63.
inline constexpr std::size_t kPadButtonNameCount = 64;

// The display text of a key or controller button code. A code without a
// name, including one beyond the table (a settings file may hold any
// value), gives the empty text.
const char* KeyName(std::uint8_t code);
const char* PadButtonName(std::uint8_t code);

// ESCAPE and the function keys F1 to F12 keep their fixed meanings in the
// game: no action can have them.
constexpr bool IsReservedKey(int code)
{
    return code == 0x01 || (code >= 0x3B && code <= 0x44) || code == 0x57 || code == 0x58;
}

} // namespace input
