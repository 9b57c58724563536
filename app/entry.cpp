// Process entry. The command line is ignored.
#include "app/tool_main.h"

int WINAPI WinMain(HINSTANCE instance, HINSTANCE, LPSTR, int)
{
    return RunTool(instance, nullptr);
}
