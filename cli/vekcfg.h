#pragma once

namespace cli
{

// The whole of vekcfg: reads the arguments (without the program's name, in
// UTF-8), prints to stdout and stderr and returns the exit status: 0 done,
// 1 a check failed, 2 refused or not written.
int RunVekcfg(int argc, const char* const* argv);

inline constexpr int kExitSuccess = 0;
inline constexpr int kExitCheckFailed = 1;
inline constexpr int kExitTrouble = 2;

} // namespace cli
