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

inline constexpr std::uint8_t kEscapeKey = 0x01;
inline constexpr std::uint8_t kF1Key = 0x3B;
inline constexpr std::uint8_t kF10Key = 0x44;
inline constexpr std::uint8_t kF11Key = 0x57;
inline constexpr std::uint8_t kF12Key = 0x58;

// ESCAPE and the function keys F1 to F12 keep their fixed meanings in the
// game: no action can have them.
constexpr bool IsReservedKey(int code)
{
    return code == kEscapeKey || (code >= kF1Key && code <= kF10Key) || code == kF11Key ||
           code == kF12Key;
}

} // namespace input
