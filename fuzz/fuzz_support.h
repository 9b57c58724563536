#pragma once

// What the fuzz targets share: a property check that stops the run the way
// a crash does, so that libFuzzer keeps the input that broke it.
#include <cstddef>
#include <cstdio>
#include <cstdlib>

// The fuzz build compiles through tools/clang-cp932: literals must be the code
// page 932 bytes of the product, or the Japanese keys would never match.
static_assert(sizeof("表") == 3 && "表"[0] == '\x95' && "表"[1] == '\x5C');

namespace fuzzing
{

inline void Require(bool holds, const char* what)
{
    if (holds)
        return;
    std::fprintf(stderr, "property broken: %s\n", what);
    std::abort();
}

// fuzz_tension's input: two little-endian bytes give the music's length in
// 1/64 s (0 to 1024 s: too short, in range and too long, in steps the time
// values of a text can meet exactly), the rest is the tension text.
inline constexpr std::size_t kTensionLengthBytes = 2;
inline constexpr double kTensionLengthUnit = 1.0 / 64.0;

} // namespace fuzzing
