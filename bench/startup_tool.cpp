// The tool as a user starts it, timed from its entry to the first pass of
// its message loop.
#include "app/tool_main.h"
#include "bench/startup_probe_win32.h"

int WINAPI WinMain(HINSTANCE instance, HINSTANCE, LPSTR, int)
{
    bench::StartClock();
    return RunTool(instance, bench::ReportStartup);
}
