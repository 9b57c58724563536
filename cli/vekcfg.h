#pragma once

namespace cli
{

// The whole of vekcfg: reads the arguments (without the program's name),
// prints to stdout and stderr and returns the exit status: 0 success, 1 a
// check failed, 2 a usage error or a file that could not be read or written.
int RunVekcfg(int argc, const char* const* argv);

inline constexpr int kExitSuccess = 0;
inline constexpr int kExitCheckFailed = 1;
inline constexpr int kExitTrouble = 2;

} // namespace cli
