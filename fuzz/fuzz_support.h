#pragma once

// What every fuzz target shares: a property check that stops the run the
// way a crash does, so that libFuzzer keeps the input that broke it.
#include <cstdio>
#include <cstdlib>

// The fuzz build compiles through fuzz/clang-cp932: literals must be the code
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

} // namespace fuzzing
