#pragma once

// Drives VEKConfig.exe from outside, as a user would: start it with a TEMP of
// the test's own, find its windows, read their texts, press buttons, answer
// its message boxes and read the settings file it writes.

#include "base/win32.h"

#include <cstdint>
#include <string>
#include <vector>

namespace e2e
{

// A folder of the test's own whose "Temp" subfolder is the tool's TEMP.
class SaveFolder
{
public:
    SaveFolder();
    ~SaveFolder();
    SaveFolder(const SaveFolder&) = delete;
    SaveFolder& operator=(const SaveFolder&) = delete;

    const std::string& Root() const { return root_; }
    std::string Temp() const { return root_ + "\\Temp"; }
    std::string SaveDirectory() const { return root_ + "\\Tolvenik\\VEK"; }
    std::string SettingsFile() const { return SaveDirectory() + "\\GameConfig.dat"; }

private:
    std::string root_;
};

struct MessageBoxSeen
{
    std::string caption;
    std::string text;
    bool found = false;
};

class ToolProcess
{
public:
    // Starts the tool that lies beside the test executable, or `program`.
    explicit ToolProcess(const SaveFolder& folder);
    ToolProcess(const SaveFolder& folder, const std::string& program);
    ~ToolProcess();
    ToolProcess(const ToolProcess&) = delete;
    ToolProcess& operator=(const ToolProcess&) = delete;

    bool Started() const { return process_.hProcess != nullptr; }

    // The main dialog once it is visible (null after the timeout).
    HWND WaitForMainDialog(DWORD timeoutMs = 10000);
    // A message box of the tool: a dialog with a static text of id 0xFFFF.
    HWND WaitForMessageBox(DWORD timeoutMs = 10000);
    // Reads a message box's caption and text, then presses `answer`.
    MessageBoxSeen AnswerMessageBox(int answer, DWORD timeoutMs = 10000);

    // Posted, so a message box the command opens does not block the test.
    void PostCommand(HWND dialog, int controlId);
    void PostClose(HWND dialog);

    // True with the exit code once the process has ended.
    bool WaitForExit(DWORD& exitCode, DWORD timeoutMs = 10000);
    bool IsRunning();

private:
    std::vector<HWND> TopLevelDialogs();

    PROCESS_INFORMATION process_{};
};

std::string WindowText(HWND window);
// A control anywhere below `dialog` (its pages included), by its id.
HWND FindControl(HWND dialog, int id);
std::vector<std::uint8_t> ReadFileBytes(const std::string& path);
bool WriteFileBytes(const std::string& path, const std::vector<std::uint8_t>& bytes);

} // namespace e2e
