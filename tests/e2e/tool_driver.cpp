#include "tests/e2e/tool_driver.h"

#include <cstring>

namespace e2e
{

bool WaitFor(const std::function<bool()>& done, DWORD timeoutMs)
{
    for (const DWORD start = GetTickCount(); !done(); Sleep(20))
    {
        if (GetTickCount() - start > timeoutMs)
            return false;
    }
    return true;
}

std::string WindowText(HWND window)
{
    char text[1024] = {};
    SendMessageA(window, WM_GETTEXT, sizeof text, reinterpret_cast<LPARAM>(text));
    return text;
}

HWND FindControl(HWND dialog, int id)
{
    std::pair<int, HWND> search{id, nullptr};
    EnumChildWindows(
        dialog,
        [](HWND window, LPARAM parameter) -> BOOL
        {
            auto* s = reinterpret_cast<std::pair<int, HWND>*>(parameter);
            if (GetDlgCtrlID(window) == s->first)
                s->second = window;
            return s->second == nullptr;
        },
        reinterpret_cast<LPARAM>(&search));
    return search.second;
}

ToolProcess::ToolProcess(const std::string& program, const std::string& arguments)
{
    char path[MAX_PATH] = {};
    GetModuleFileNameA(nullptr, path, sizeof path);
    // A full path names the program itself; a bare name, the one beside the test.
    const std::string folder = program.find(':') == std::string::npos
                                   ? std::string(path, std::strrchr(path, '\\') + 1)
                                   : "";
    std::string command = "\"" + folder + program + "\" " + arguments;
    STARTUPINFOA startup = {};
    startup.cb = sizeof startup;
    CreateProcessA(nullptr, command.data(), nullptr, nullptr, FALSE, 0, nullptr, nullptr, &startup,
                   &process_);
}

ToolProcess::~ToolProcess()
{
    if (process_.hProcess == nullptr)
        return;
    if (ExitCode(0) == STILL_ACTIVE)
        TerminateProcess(process_.hProcess, 99);
    CloseHandle(process_.hThread);
    CloseHandle(process_.hProcess);
}

HWND ToolProcess::FindDialog(bool (*matches)(HWND dialog, int id), int id)
{
    struct Search
    {
        DWORD processId;
        bool (*matches)(HWND, int);
        int id;
        HWND found;
    } search{process_.dwProcessId, matches, id, nullptr};
    WaitFor(
        [&]
        {
            EnumWindows(
                [](HWND window, LPARAM parameter) -> BOOL
                {
                    auto* s = reinterpret_cast<Search*>(parameter);
                    DWORD processId = 0;
                    char className[16] = {};
                    GetWindowThreadProcessId(window, &processId);
                    GetClassNameA(window, className, sizeof className);
                    if (processId == s->processId && IsWindowVisible(window) &&
                        std::strcmp(className, "#32770") == 0 && s->matches(window, s->id))
                        s->found = window;
                    return s->found == nullptr;
                },
                reinterpret_cast<LPARAM>(&search));
            return search.found != nullptr;
        });
    return search.found;
}

HWND ToolProcess::MainDialog()
{
    return FindDialog([](HWND dialog, int) { return GetDlgItem(dialog, 0xFFFF) == nullptr; });
}

HWND ToolProcess::DialogWith(int id)
{
    return FindDialog([](HWND dialog, int id) { return GetDlgItem(dialog, id) != nullptr; }, id);
}

MessageBoxSeen ToolProcess::AnswerMessageBox(int answer)
{
    // A text of id 0xFFFF and no edit: the IP entry dialog's labels share the id.
    const HWND box = FindDialog(
        [](HWND dialog, int)
        {
            return GetDlgItem(dialog, 0xFFFF) != nullptr &&
                   FindWindowExA(dialog, nullptr, "Edit", nullptr) == nullptr;
        });
    if (box == nullptr)
        return {"(no message box)", "", nullptr};
    MessageBoxSeen seen{WindowText(box), WindowText(GetDlgItem(box, 0xFFFF)),
                        GetWindow(box, GW_OWNER)};
    PostMessageA(box, WM_COMMAND, answer, 0);
    // Under Wine the box's window lingers for a while after the box has ended.
    WaitFor([&] { return !IsWindowVisible(box); });
    return seen;
}

DWORD ToolProcess::ExitCode(DWORD timeoutMs)
{
    DWORD code = STILL_ACTIVE;
    if (WaitForSingleObject(process_.hProcess, timeoutMs) == WAIT_OBJECT_0)
        GetExitCodeProcess(process_.hProcess, &code);
    return code;
}

} // namespace e2e
