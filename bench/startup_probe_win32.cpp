#include "bench/startup_probe_win32.h"

#include "base/win32.h"

#include <cstdio>

namespace bench
{
namespace
{
LARGE_INTEGER start;
}

void StartClock()
{
    QueryPerformanceCounter(&start);
}

void ReportStartup()
{
    LARGE_INTEGER now;
    LARGE_INTEGER frequency;
    QueryPerformanceCounter(&now);
    QueryPerformanceFrequency(&frequency);
    char line[64];
    const int length =
        std::snprintf(line, sizeof line, "%.6f\n",
                      double(now.QuadPart - start.QuadPart) / double(frequency.QuadPart));
    DWORD written = 0;
    WriteFile(GetStdHandle(STD_OUTPUT_HANDLE), line, DWORD(length), &written, nullptr);
    // Nothing after the first pass is measured: the process ends here rather
    // than waiting for a user to close it.
    ExitProcess(0);
}

} // namespace bench
