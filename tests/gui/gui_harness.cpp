#include "tests/gui/gui_harness.h"

#include "app/system.h"

#include <commctrl.h>
#include <filesystem>

namespace gui
{
namespace
{
MessageBoxAnswerer* activeAnswerer = nullptr;

bool IsDialogClass(HWND window)
{
    char className[16] = {};
    GetClassNameA(window, className, sizeof className);
    return std::string(className) == "#32770";
}

void NotifyTab(HWND parent, HWND tab, int index)
{
    SendMessageA(tab, TCM_SETCURSEL, index, 0);
    NMHDR header = {};
    header.hwndFrom = tab;
    header.idFrom = GetDlgCtrlID(tab);
    header.code = TCN_SELCHANGE;
    SendMessageA(parent, WM_NOTIFY, header.idFrom, reinterpret_cast<LPARAM>(&header));
}
} // namespace

MessageBoxAnswerer::MessageBoxAnswerer(int fallback) : fallback_(fallback)
{
    activeAnswerer = this;
    hook_ = SetWindowsHookExA(WH_CBT, Hook, nullptr, GetCurrentThreadId());
}

MessageBoxAnswerer::~MessageBoxAnswerer()
{
    UnhookWindowsHookEx(hook_);
    activeAnswerer = nullptr;
}

LRESULT CALLBACK MessageBoxAnswerer::Hook(int code, WPARAM wParam, LPARAM lParam)
{
    MessageBoxAnswerer* self = activeAnswerer;
    if (code == HCBT_ACTIVATE && self != nullptr)
    {
        const HWND box = reinterpret_cast<HWND>(wParam);
        const HWND text = GetDlgItem(box, 0xFFFF);
        if (IsDialogClass(box) && text != nullptr)
        {
            self->seen_.push_back({WindowText(box), WindowText(text)});
            int answer = self->fallback_;
            if (!self->answers_.empty())
            {
                answer = self->answers_.front();
                self->answers_.pop_front();
            }
            PostMessageA(box, WM_COMMAND, MAKEWPARAM(answer, BN_CLICKED), 0);
        }
    }
    return CallNextHookEx(nullptr, code, wParam, lParam);
}

RunningTool::RunningTool()
{
    Start();
}

RunningTool::RunningTool(const std::vector<std::uint8_t>& settingsFile)
{
    std::filesystem::create_directories(folder_.SaveDirectory());
    testing_support::WriteBytes(folder_.SettingsFile(), settingsFile);
    Start();
}

void RunningTool::Start()
{
    application_ = std::make_unique<CConfigApplication>();
    SetApplication(application_.get());
    started_ = application_->Init(GetModuleHandleA(nullptr), AppWindowProc);
    Pump();
}

RunningTool::~RunningTool()
{
    if (started_ && IsWindow(MainDialog()))
        DestroyWindow(MainDialog());
    // Every window destroyed with the dialog posted its quit message.
    MSG message;
    while (PeekMessageA(&message, nullptr, 0, 0, PM_REMOVE))
    {
        if (message.message != WM_QUIT)
            DispatchMessageA(&message);
    }
    if (started_)
        application_->Exit();
    application_.reset();
    SetApplication(nullptr);
}

HWND RunningTool::MainDialog()
{
    return application_->System()->GetHwnd();
}

void RunningTool::Pump()
{
    MSG message;
    while (PeekMessageA(&message, nullptr, 0, 0, PM_REMOVE))
    {
        if (message.message == WM_QUIT)
            continue;
        TranslateMessage(&message);
        DispatchMessageA(&message);
    }
    if (started_)
    {
        application_->Update();
        application_->Render();
    }
}

void RunningTool::ClickTab(int index)
{
    NotifyTab(MainDialog(), application_->MainTab(), index);
    Pump();
}

void RunningTool::ClickKeyTab(int index)
{
    NotifyTab(Page(kKeyConfigPageIndex), application_->KeyTab(), index);
    Pump();
}

void RunningTool::Click(HWND page, int id)
{
    SendMessageA(page, WM_COMMAND, MAKEWPARAM(id, BN_CLICKED),
                 reinterpret_cast<LPARAM>(GetDlgItem(page, id)));
    Pump();
}

void RunningTool::SetCheck(HWND page, int id, bool on)
{
    SendDlgItemMessageA(page, id, BM_SETCHECK, on ? BST_CHECKED : BST_UNCHECKED, 0);
    Click(page, id);
}

void RunningTool::Choose(HWND page, int id, int index)
{
    SendDlgItemMessageA(page, id, CB_SETCURSEL, index, 0);
    SendMessageA(page, WM_COMMAND, MAKEWPARAM(id, CBN_SELCHANGE),
                 reinterpret_cast<LPARAM>(GetDlgItem(page, id)));
    Pump();
}

void RunningTool::Type(HWND page, int id, const std::string& text)
{
    // A single-line edit reports EN_UPDATE by itself when its text is set.
    SetDlgItemTextA(page, id, text.c_str());
    Pump();
}

std::vector<MessageBoxSeen> RunningTool::Save(int answer)
{
    MessageBoxAnswerer answerer(answer);
    SendMessageA(MainDialog(), WM_COMMAND, MAKEWPARAM(IDOK, BN_CLICKED),
                 reinterpret_cast<LPARAM>(GetDlgItem(MainDialog(), IDOK)));
    Pump();
    return answerer.Seen();
}

std::string WindowText(HWND window)
{
    char text[1024] = {};
    GetWindowTextA(window, text, sizeof text);
    return text;
}

std::vector<std::uint8_t> ReadFile(const std::string& path)
{
    return testing_support::ReadBytes(path);
}

} // namespace gui
