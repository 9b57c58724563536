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

} // namespace input
