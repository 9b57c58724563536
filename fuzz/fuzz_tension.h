#pragma once

// The input of fuzz_tension: the music's length, then the tension text.
#include <cstddef>
#include <cstdint>

namespace fuzzing
{

// Two little-endian bytes give the length in 1/64 s: 0 to 1024 s, so that
// music too short, in range and too long all occur, in steps that the time
// values of a text can meet exactly.
inline constexpr std::size_t kTensionLengthBytes = 2;
inline constexpr double kTensionLengthUnit = 1.0 / 64.0;

} // namespace fuzzing
