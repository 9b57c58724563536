#pragma once

// The clock both start-up programs of the benchmark share: started at their
// entry, read at the first pass of their message loop, where the program
// writes the seconds in between to its standard output and ends.

namespace bench
{

void StartClock();
[[noreturn]] void ReportStartup();

} // namespace bench
