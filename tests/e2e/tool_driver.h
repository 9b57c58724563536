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

// Read wide, as a user sees it whatever the code page of either process;
// WindowText gives it in code page 932, the tool's own texts' form.
std::wstring WideText(HWND window);
std::string WindowText(HWND window);
// A control anywhere below `dialog` (its pages included), by its id.
HWND FindControl(HWND dialog, int id);

// Posted, so that a message box the command opens does not block the test.
inline void PostCommand(HWND dialog, int id)
{
    PostMessageA(dialog, WM_COMMAND, id, 0);
}

// Every text a user sees below `dialog`, one line per text (a list's or a
// tab's items each on its own line), each named by its control's parent id,
// id and class, in window order.
std::wstring ShownTexts(HWND dialog);

// Memory in the process of `window`, for the messages that write through a
// pointer (TCM_GETITEMW, TCM_ADJUSTRECT): they write in the receiver's own
// address space.
class LentMemory
{
public:
    LentMemory(HWND window, std::size_t size);
    ~LentMemory();
    LentMemory(const LentMemory&) = delete;
    LentMemory& operator=(const LentMemory&) = delete;

    char* Remote() const { return remote_; }
    void Write(const void* data, std::size_t size, std::size_t offset = 0)
    {
        WriteProcessMemory(process_, remote_ + offset, data, size, nullptr);
    }
    void Read(void* data, std::size_t size, std::size_t offset = 0) const
    {
        ReadProcessMemory(process_, remote_ + offset, data, size, nullptr);
    }

private:
    HANDLE process_ = nullptr;
    char* remote_ = nullptr;
};

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
    explicit ToolProcess(const std::string& program = "VEKConfig.exe");
    ~ToolProcess();
    ToolProcess(const ToolProcess&) = delete;
    ToolProcess& operator=(const ToolProcess&) = delete;

    // The main dialog once its pages are made and filled; null after the timeout.
    HWND MainDialog();
    // A shown dialog of the tool holding a control of id `id`.
    HWND DialogWith(int id);
    // Reads the next message box the tool shows and presses `answer` in it.
    MessageBoxSeen AnswerMessageBox(int answer);
    // The exit code once the process has ended, else STILL_ACTIVE.
    DWORD ExitCode(DWORD timeoutMs = 10000);

private:
    // A shown dialog of the tool that `matches`; null after the timeout.
    HWND FindDialog(const std::function<bool(HWND)>& matches);

    PROCESS_INFORMATION process_{};
};

} // namespace e2e
