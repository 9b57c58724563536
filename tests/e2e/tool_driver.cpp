#include "tests/e2e/tool_driver.h"

#include "base/window_text_win32.h"
#include "resources/resource.h"

#include <commctrl.h>
#include <cstring>
#include <vector>

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

std::wstring WideText(HWND window)
{
    wchar_t text[1024] = {};
    SendMessageW(window, WM_GETTEXT, std::size(text), reinterpret_cast<LPARAM>(text));
    return text;
}

std::string WindowText(HWND window)
{
    return base::Cp932From(WideText(window));
}

namespace
{

// A tab's item text: the item and its text are lent from the tool.
std::wstring TabItemText(HWND tab, int index)
{
    wchar_t text[128] = {};
    LentMemory lent(tab, sizeof(TCITEMW) + sizeof text);
    TCITEMW item = {};
    item.mask = TCIF_TEXT;
    item.pszText = reinterpret_cast<wchar_t*>(lent.Remote() + sizeof item);
    item.cchTextMax = std::size(text) - 1;
    lent.Write(&item, sizeof item);
    if (SendMessageW(tab, TCM_GETITEMW, index, reinterpret_cast<LPARAM>(lent.Remote())) != 0)
        lent.Read(text, sizeof text - sizeof(wchar_t), sizeof item);
    return text;
}

std::vector<std::wstring> TextsOf(HWND control, const std::wstring& kind)
{
    // The messages that count, measure and read a list's lines.
    const bool combo = kind == L"ComboBox";
    const UINT count = combo ? CB_GETCOUNT : LB_GETCOUNT;
    const UINT length = combo ? CB_GETLBTEXTLEN : LB_GETTEXTLEN;
    const UINT read = combo ? CB_GETLBTEXT : LB_GETTEXT;
    std::vector<std::wstring> texts;
    if (kind == L"Static" || kind == L"Button" || kind == L"Edit")
        texts.push_back(WideText(control));
    for (int index = 0; kind == WC_TABCONTROLW && index < TabCtrl_GetItemCount(control); ++index)
        texts.push_back(TabItemText(control, index));
    for (LRESULT index = 0;
         (combo || kind == L"ListBox") && index < SendMessageW(control, count, 0, 0); ++index)
    {
        std::wstring text(SendMessageW(control, length, index, 0) + 1, L'\0');
        SendMessageW(control, read, index, reinterpret_cast<LPARAM>(text.data()));
        texts.push_back(text.c_str());
    }
    return texts;
}

// The first window `enumerate` passes that `matches`; null if none.
template <typename Enumerate>
HWND FirstWindow(Enumerate enumerate, const std::function<bool(HWND)>& matches)
{
    std::pair<const std::function<bool(HWND)>*, HWND> search{&matches, nullptr};
    enumerate(
        [](HWND window, LPARAM parameter) -> BOOL
        {
            auto* s =
                reinterpret_cast<std::pair<const std::function<bool(HWND)>*, HWND>*>(parameter);
            if ((*s->first)(window))
                s->second = window;
            return s->second == nullptr;
        },
        reinterpret_cast<LPARAM>(&search));
    return search.second;
}

} // namespace

std::wstring ShownTexts(HWND dialog)
{
    std::wstring lines = L"caption: " + WideText(dialog) + L"\n";
    EnumChildWindows(
        dialog,
        [](HWND control, LPARAM parameter) -> BOOL
        {
            wchar_t kind[64] = {};
            GetClassNameW(control, kind, std::size(kind));
            const std::wstring name = std::to_wstring(GetDlgCtrlID(GetParent(control))) + L"/" +
                                      std::to_wstring(GetDlgCtrlID(control)) + L" " + kind + L": ";
            for (const std::wstring& text : TextsOf(control, kind))
                *reinterpret_cast<std::wstring*>(parameter) += name + text + L"\n";
            return TRUE;
        },
        reinterpret_cast<LPARAM>(&lines));
    return lines;
}

HWND FindControl(HWND dialog, int id)
{
    return FirstWindow([&](WNDENUMPROC each, LPARAM search)
                       { EnumChildWindows(dialog, each, search); },
                       [id](HWND window) { return GetDlgCtrlID(window) == id; });
}

LentMemory::LentMemory(HWND window, std::size_t size)
{
    DWORD processId = 0;
    GetWindowThreadProcessId(window, &processId);
    process_ =
        OpenProcess(PROCESS_VM_OPERATION | PROCESS_VM_READ | PROCESS_VM_WRITE, FALSE, processId);
    remote_ = static_cast<char*>(
        VirtualAllocEx(process_, nullptr, size, MEM_COMMIT | MEM_RESERVE, PAGE_READWRITE));
}

LentMemory::~LentMemory()
{
    VirtualFreeEx(process_, remote_, 0, MEM_RELEASE);
    CloseHandle(process_);
}

ToolProcess::ToolProcess(const std::string& program)
{
    char path[MAX_PATH] = {};
    GetModuleFileNameA(nullptr, path, sizeof path);
    // A full path names the program itself; a bare name, the one beside the test.
    const std::string folder = program.find(':') == std::string::npos
                                   ? std::string(path, std::strrchr(path, '\\') + 1)
                                   : "";
    std::string command = "\"" + folder + program + "\"";
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

HWND ToolProcess::FindDialog(const std::function<bool(HWND)>& matches)
{
    const auto shown = [&](HWND window)
    {
        DWORD processId = 0;
        char className[16] = {};
        GetWindowThreadProcessId(window, &processId);
        GetClassNameA(window, className, sizeof className);
        return processId == process_.dwProcessId && IsWindowVisible(window) &&
               std::strcmp(className, "#32770") == 0 && matches(window);
    };
    HWND found = nullptr;
    WaitFor([&] { return (found = FirstWindow(EnumWindows, shown)) != nullptr; });
    return found;
}

HWND ToolProcess::MainDialog()
{
    const HWND dialog =
        FindDialog([](HWND dialog) { return GetDlgItem(dialog, 0xFFFF) == nullptr; });
    const int lastMade = IDC_RADIO_CHAT_TO_ALL_FIRST + IDC_RADIO_CHAT_ROW_STEP * 11;
    if (dialog == nullptr || !WaitFor([&] { return FindControl(dialog, lastMade); }))
        return nullptr;
    // Taken only by the tool's message loop, which starts once every page is filled.
    SendMessageW(dialog, WM_NULL, 0, 0);
    return dialog;
}

HWND ToolProcess::DialogWith(int id)
{
    return FindDialog([id](HWND dialog) { return GetDlgItem(dialog, id) != nullptr; });
}

MessageBoxSeen ToolProcess::AnswerMessageBox(int answer)
{
    // A text of id 0xFFFF and no edit: the IP entry dialog's labels share the id.
    const HWND box = FindDialog(
        [](HWND dialog)
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
