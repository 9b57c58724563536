#include "app/tool_main.h"

#include "app/config_application.h"

#include <new>

int RunTool(HINSTANCE instance, void (*firstIdle)())
{
    CConfigApplication* application = new (std::nothrow) CConfigApplication();
    if (application == nullptr)
        return -1;
    SetApplication(application);
    if (!application->Init(instance, AppWindowProc))
        return -1;

    // Wide messages: a character typed in any language reaches the edits
    // as it is, whatever the system's code page.
    // The loop never waits: with the queue empty it updates continuously, so
    // that a key or button pressed for an assignment is seen at once.
    MSG message;
    for (;;)
    {
        if (PeekMessageW(&message, nullptr, 0, 0, PM_REMOVE))
        {
            if (message.message == WM_QUIT)
                break;
            TranslateMessage(&message);
            DispatchMessageW(&message);
            continue;
        }
        if (firstIdle != nullptr)
        {
            firstIdle();
            firstIdle = nullptr;
        }
        application->Update();
        application->Render();
    }

    application->Exit();
    delete application;
    SetApplication(nullptr);
    return 0;
}
