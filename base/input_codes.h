#pragma once

// The codes a key or a controller button is assigned by, their names and
// the keys no action can have: what the settings record and the input layer
// share, without any device header.

#include <cstddef>
#include <cstdint>

namespace input
{

// The game's actions, each with one key and one button per player.
inline constexpr int kActionCount = 24;

// DirectInput key codes index a keyboard state of this many bytes.
inline constexpr int kKeyCodeCount = 256;

// The controller button codes: indexes of a pad frame. A code's text comes
// from the pad button name table.
inline constexpr int kPadFrameSize = 48;

enum PadCode : std::uint8_t
{
    kDpadUp = 0,
    kDpadDown = 1,
    kDpadLeft = 2,
    kDpadRight = 3,
    kLeftStickUp = 4,
    kLeftStickDown = 5,
    kLeftStickLeft = 6,
    kLeftStickRight = 7,
    kLeftStickPush = 8,
    kRightStickUp = 9,
    kRightStickDown = 10,
    kRightStickLeft = 11,
    kRightStickRight = 12,
    kRightStickPush = 13,
    kButton1 = 14,
    kButton2 = 15,
    kButton3 = 16,
    kButton4 = 17,
    kButton7 = 18,
    kButton5 = 19,
    kButton8 = 20,
    kButton6 = 21,
    kButton9 = 22,
    kButton10 = 23,
    kButton13 = 24,
};

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
