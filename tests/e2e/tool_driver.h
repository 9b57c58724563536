#pragma once

// Drives VEKConfig.exe from outside, as a user would: starts it with the
// test's own TEMP, finds its windows, reads their texts, presses buttons and
// answers its message boxes.

#include "base/win32.h"

#include <functional>
#include <string>

namespace e2e
{

// Polls until `done` holds; false after the timeout.
bool WaitFor(const std::function<bool()>& done, DWORD timeoutMs = 10000);

std::string WindowText(HWND window);
// A control anywhere below `dialog` (its pages included), by its id.
HWND FindControl(HWND dialog, int id);

// Posted, so that a message box the command opens does not block the test.
inline void PostCommand(HWND dialog, int id)
{
    PostMessageA(dialog, WM_COMMAND, id, 0);
}

struct MessageBoxSeen
{
    std::string caption;
    std::string text;
    HWND owner = nullptr;
};

class ToolProcess
{
public:
    // Starts `program` (beside the test executable, unless a full path) with
    // the test's own environment: a TempSaveFolder made before gives it its TEMP.
    explicit ToolProcess(const std::string& program = "VEKConfig.exe",
                         const std::string& arguments = "");
    ~ToolProcess();
    ToolProcess(const ToolProcess&) = delete;
    ToolProcess& operator=(const ToolProcess&) = delete;

    // The main dialog once it is shown; null after the timeout.
    HWND MainDialog();
    // A shown dialog of the tool holding a control of id `id`.
    HWND DialogWith(int id);
    // Reads the next message box the tool shows and presses `answer` in it.
    MessageBoxSeen AnswerMessageBox(int answer);
    // The exit code once the process has ended, else STILL_ACTIVE.
    DWORD ExitCode(DWORD timeoutMs = 10000);

private:
    // A shown dialog of the tool that `matches`; null after the timeout.
    HWND FindDialog(bool (*matches)(HWND dialog, int id), int id = 0);

    PROCESS_INFORMATION process_{};
};

} // namespace e2e
