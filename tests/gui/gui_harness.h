#pragma once

// The tool's own start-up run inside the test process, with TEMP in a folder
// of the test's own; its pages get the messages a user's actions produce.

#include "app/config_application.h"
#include "app/system.h"
#include "base/window_text_win32.h"
#include "tests/support/temp_folder.h"

#include <commctrl.h>
#include <functional>
#include <gtest/gtest.h>
#include <memory>
#include <string>
#include <vector>

namespace gui
{

// Read wide and given in code page 932, whatever the system's code page.
inline std::string ControlText(HWND dialog, int id)
{
    return base::WindowText932(GetDlgItem(dialog, id));
}

// A CBT hook on the test's thread for the scope. A later hook runs first.
struct CbtHook : std::unique_ptr<HHOOK__, BOOL(WINAPI*)(HHOOK)>
{
    explicit CbtHook(HOOKPROC procedure)
        : unique_ptr(SetWindowsHookExA(WH_CBT, procedure, nullptr, GetCurrentThreadId()),
                     UnhookWindowsHookEx)
    {
    }
};

// The caption and text of each message box AnswerMessageBox answered (OK).
inline std::vector<std::pair<std::string, std::string>> messageBoxes;

inline LRESULT CALLBACK AnswerMessageBox(int code, WPARAM wParam, LPARAM lParam)
{
    const HWND box = reinterpret_cast<HWND>(wParam);
    if (code == HCBT_ACTIVATE && GetDlgItem(box, 0xFFFF) != nullptr)
    {
        messageBoxes.push_back({base::WindowText932(box), ControlText(box, 0xFFFF)});
        PostMessageA(box, WM_COMMAND, IDOK, 0);
    }
    return CallNextHookEx(nullptr, code, wParam, lParam);
}

// The application object after its Init, started from a settings file of the
// defaults with `edit` applied. Destroying it closes the dialog and runs Exit.
class RunningTool : public CConfigApplication
{
public:
    explicit RunningTool(const std::function<void(config::CSaveConfig&)>& edit = nullptr)
    {
        config::CSaveConfig record;
        record.ResetAll();
        if (edit)
            edit(record);
        folder_.WriteSettings(record.SaveToBytes());
        SetApplication(this);
        EXPECT_TRUE(Init(GetModuleHandleA(nullptr), AppWindowProc));
    }
    ~RunningTool()
    {
        if (System() != nullptr)
            DestroyWindow(System()->GetHwnd());
        // The quit message it posted would end the next test's modal loops.
        for (MSG message; PeekMessageA(&message, nullptr, 0, 0, PM_REMOVE);)
            continue;
        Exit();
        SetApplication(nullptr);
    }

private:
    testing_support::TempSaveFolder folder_;
};

// A user's click on a tab of the main tab or the key tab.
inline void ClickTab(HWND tab, int index)
{
    SendMessageA(tab, TCM_SETCURSEL, index, 0);
    NMHDR header = {tab, static_cast<UINT_PTR>(GetDlgCtrlID(tab)), TCN_SELCHANGE};
    SendMessageA(GetParent(tab), WM_NOTIFY, header.idFrom, reinterpret_cast<LPARAM>(&header));
}

// What a control tells its page when the user clicks or chooses in it.
inline void Notify(HWND page, int id, int code = BN_CLICKED)
{
    SendMessageA(page, WM_COMMAND, MAKEWPARAM(id, code),
                 reinterpret_cast<LPARAM>(GetDlgItem(page, id)));
}

} // namespace gui
