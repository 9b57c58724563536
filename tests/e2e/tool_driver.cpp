#include "tests/e2e/tool_driver.h"

#include <cstring>
#include <fstream>
#include <iterator>

namespace e2e
{
namespace
{

std::string ExecutableDirectory()
{
    char path[MAX_PATH] = {};
    GetModuleFileNameA(nullptr, path, sizeof path);
    std::string directory(path);
    return directory.substr(0, directory.find_last_of('\\') + 1);
}

// The test's own environment with TEMP replaced, as a CreateProcess block.
std::vector<char> EnvironmentWithTemp(const std::string& temp)
{
    std::vector<char> block;
    char* strings = GetEnvironmentStringsA();
    for (const char* entry = strings; *entry != '\0'; entry += std::strlen(entry) + 1)
    {
        if (_strnicmp(entry, "TEMP=", 5) == 0)
            continue;
        block.insert(block.end(), entry, entry + std::strlen(entry) + 1);
    }
    FreeEnvironmentStringsA(strings);
    const std::string own = "TEMP=" + temp;
    block.insert(block.end(), own.c_str(), own.c_str() + own.size() + 1);
    block.push_back('\0');
    return block;
}

bool IsDialog(HWND window)
{
    char className[16] = {};
    GetClassNameA(window, className, sizeof className);
    return std::strcmp(className, "#32770") == 0;
}

void RemoveTree(const std::string& path)
{
    WIN32_FIND_DATAA found;
    HANDLE search = FindFirstFileA((path + "\\*").c_str(), &found);
    if (search != INVALID_HANDLE_VALUE)
    {
        do
        {
            const std::string name = found.cFileName;
            if (name == "." || name == "..")
                continue;
            const std::string child = path + "\\" + name;
            if (found.dwFileAttributes & FILE_ATTRIBUTE_DIRECTORY)
                RemoveTree(child);
            else
                DeleteFileA(child.c_str());
        } while (FindNextFileA(search, &found));
        FindClose(search);
    }
    RemoveDirectoryA(path.c_str());
}

template <typename Predicate> bool WaitUntil(DWORD timeoutMs, Predicate predicate)
{
    const DWORD start = GetTickCount();
    for (;;)
    {
        if (predicate())
            return true;
        if (GetTickCount() - start > timeoutMs)
            return false;
        Sleep(20);
    }
}

} // namespace

SaveFolder::SaveFolder()
{
    static int counter = 0;
    char temp[MAX_PATH] = {};
    GetTempPathA(sizeof temp, temp);
    root_ = std::string(temp) + "vek-e2e-" + std::to_string(GetCurrentProcessId()) + "-" +
            std::to_string(counter++);
    CreateDirectoryA(root_.c_str(), nullptr);
    CreateDirectoryA(Temp().c_str(), nullptr);
}

SaveFolder::~SaveFolder()
{
    RemoveTree(root_);
}

ToolProcess::ToolProcess(const SaveFolder& folder)
    : ToolProcess(folder, ExecutableDirectory() + "VEKConfig.exe")
{
}

ToolProcess::ToolProcess(const SaveFolder& folder, const std::string& program)
{
    std::string command = "\"" + program + "\"";
    std::vector<char> environment = EnvironmentWithTemp(folder.Temp());
    STARTUPINFOA startup = {};
    startup.cb = sizeof startup;
    if (!CreateProcessA(nullptr, command.data(), nullptr, nullptr, FALSE, 0, environment.data(),
                        nullptr, &startup, &process_))
        process_ = {};
}

ToolProcess::~ToolProcess()
{
    if (!Started())
        return;
    if (IsRunning())
    {
        TerminateProcess(process_.hProcess, 99);
        WaitForSingleObject(process_.hProcess, 5000);
    }
    CloseHandle(process_.hThread);
    CloseHandle(process_.hProcess);
}

std::vector<HWND> ToolProcess::TopLevelDialogs()
{
    struct Search
    {
        DWORD processId;
        std::vector<HWND> found;
    } search{process_.dwProcessId, {}};
    EnumWindows(
        [](HWND window, LPARAM parameter) -> BOOL
        {
            auto* s = reinterpret_cast<Search*>(parameter);
            DWORD owner = 0;
            GetWindowThreadProcessId(window, &owner);
            if (owner == s->processId && IsWindowVisible(window) && IsDialog(window))
                s->found.push_back(window);
            return TRUE;
        },
        reinterpret_cast<LPARAM>(&search));
    return search.found;
}

HWND ToolProcess::WaitForMainDialog(DWORD timeoutMs)
{
    HWND main = nullptr;
    WaitUntil(timeoutMs,
              [&]
              {
                  for (HWND window : TopLevelDialogs())
                  {
                      if (GetDlgItem(window, IDOK) != nullptr &&
                          GetDlgItem(window, 0xFFFF) == nullptr)
                          main = window;
                  }
                  return main != nullptr;
              });
    return main;
}

HWND ToolProcess::WaitForMessageBox(DWORD timeoutMs)
{
    HWND box = nullptr;
    WaitUntil(timeoutMs,
              [&]
              {
                  for (HWND window : TopLevelDialogs())
                  {
                      if (GetDlgItem(window, 0xFFFF) != nullptr)
                          box = window;
                  }
                  return box != nullptr;
              });
    return box;
}

MessageBoxSeen ToolProcess::AnswerMessageBox(int answer, DWORD timeoutMs)
{
    MessageBoxSeen seen;
    HWND box = WaitForMessageBox(timeoutMs);
    if (box == nullptr)
        return seen;
    seen.found = true;
    seen.caption = WindowText(box);
    seen.text = WindowText(GetDlgItem(box, 0xFFFF));
    PostMessageA(box, WM_COMMAND, MAKEWPARAM(answer, BN_CLICKED), 0);
    // Hidden is answered: under Wine the box's window lingers for a while
    // after the dialog has ended.
    WaitUntil(timeoutMs, [&] { return !IsWindowVisible(box); });
    return seen;
}

void ToolProcess::PostCommand(HWND dialog, int controlId)
{
    PostMessageA(dialog, WM_COMMAND, MAKEWPARAM(controlId, BN_CLICKED),
                 reinterpret_cast<LPARAM>(GetDlgItem(dialog, controlId)));
}

void ToolProcess::PostClose(HWND dialog)
{
    PostMessageA(dialog, WM_SYSCOMMAND, SC_CLOSE, 0);
}

bool ToolProcess::WaitForExit(DWORD& exitCode, DWORD timeoutMs)
{
    if (!Started() || WaitForSingleObject(process_.hProcess, timeoutMs) != WAIT_OBJECT_0)
        return false;
    return GetExitCodeProcess(process_.hProcess, &exitCode) != 0;
}

bool ToolProcess::IsRunning()
{
    return Started() && WaitForSingleObject(process_.hProcess, 0) == WAIT_TIMEOUT;
}

HWND FindControl(HWND dialog, int id)
{
    struct Search
    {
        int id;
        HWND found;
    } search{id, nullptr};
    EnumChildWindows(
        dialog,
        [](HWND window, LPARAM parameter) -> BOOL
        {
            auto* s = reinterpret_cast<Search*>(parameter);
            if (GetDlgCtrlID(window) != s->id)
                return TRUE;
            s->found = window;
            return FALSE;
        },
        reinterpret_cast<LPARAM>(&search));
    return search.found;
}

std::string WindowText(HWND window)
{
    char text[1024] = {};
    SendMessageA(window, WM_GETTEXT, sizeof text, reinterpret_cast<LPARAM>(text));
    return text;
}

std::vector<std::uint8_t> ReadFileBytes(const std::string& path)
{
    std::ifstream in(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>()};
}

bool WriteFileBytes(const std::string& path, const std::vector<std::uint8_t>& bytes)
{
    std::ofstream out(path, std::ios::binary | std::ios::trunc);
    out.write(reinterpret_cast<const char*>(bytes.data()), std::streamsize(bytes.size()));
    return bool(out);
}

} // namespace e2e
