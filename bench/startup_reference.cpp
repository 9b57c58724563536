// What the tool's start-up costs the system alone: the same dialogs from the
// same templates, created, placed and shown in the same order (main dialog,
// its tab, the seven pages, the key tab's two sub-pages), with empty dialog
// procedures, no record, no sound or input devices and no page filled. Timed
// as the tool is, from the entry to the first pass of the message loop.
#include "base/win32.h"
#include "bench/startup_probe_win32.h"
#include "resources/resource.h"

#include <commctrl.h>

namespace
{

INT_PTR CALLBACK EmptyProcedure(HWND, UINT, WPARAM, LPARAM)
{
    return FALSE;
}

HWND CreatePage(HINSTANCE instance, int templateId, HWND parent)
{
    return CreateDialogParamA(instance, MAKEINTRESOURCEA(templateId), parent, EmptyProcedure, 0);
}

void InsertTabItem(HWND tab, int index, const char* caption)
{
    TCITEMA item = {};
    item.mask = TCIF_TEXT;
    item.pszText = const_cast<char*>(caption);
    SendMessageA(tab, TCM_INSERTITEMA, index, reinterpret_cast<LPARAM>(&item));
}

RECT DisplayArea(HWND tab)
{
    RECT area;
    GetClientRect(tab, &area);
    SendMessageA(tab, TCM_ADJUSTRECT, FALSE, reinterpret_cast<LPARAM>(&area));
    return area;
}

void MoveOnto(HWND page, const RECT& area)
{
    MoveWindow(page, area.left, area.top, area.right - area.left, area.bottom - area.top, FALSE);
}

} // namespace

int WINAPI WinMain(HINSTANCE instance, HINSTANCE, LPSTR, int)
{
    bench::StartClock();

    INITCOMMONCONTROLSEX controls = {sizeof controls, ICC_LISTVIEW_CLASSES | ICC_TAB_CLASSES};
    InitCommonControlsEx(&controls);

    const HWND dialog = CreatePage(instance, IDD_MAIN, nullptr);
    RECT rect;
    GetWindowRect(dialog, &rect);
    SetWindowTextA(dialog, "Dialog");
    const int width = rect.right - rect.left;
    const int height = rect.bottom - rect.top;
    MoveWindow(dialog, (GetSystemMetrics(SM_CXSCREEN) - width) / 2,
               (GetSystemMetrics(SM_CYSCREEN) - height) / 2, width, height, TRUE);
    ShowWindow(dialog, SW_SHOWNORMAL);
    UpdateWindow(dialog);

    const HWND tab = GetDlgItem(dialog, IDC_MAIN_TAB);
    const char* const captions[] = {"グラフィック", "ゲーム",         "ネットワーク",  "リプレイ",
                                    "BGM",          "キーコンフィグ", "ラジオチャット"};
    const int templates[] = {IDD_GRAPHICS_PAGE,  IDD_GAME_PAGE,       IDD_NETWORK_PAGE,
                             IDD_REPLAY_PAGE,    IDD_USER_MUSIC_PAGE, IDD_KEY_CONFIG_PAGE,
                             IDD_RADIO_CHAT_PAGE};
    for (int index = 0; index < 7; ++index)
        InsertTabItem(tab, index, captions[index]);
    const RECT pageArea = DisplayArea(tab);
    HWND pages[7];
    for (int index = 0; index < 7; ++index)
        pages[index] = CreatePage(instance, templates[index], tab);
    const HWND keyConfigPage = pages[5];
    const HWND keyTab = GetDlgItem(keyConfigPage, IDC_KEY_TAB);
    const HWND keyPages[2] = {CreatePage(instance, IDD_KEYBOARD_PAGE, keyConfigPage),
                              CreatePage(instance, IDD_PAD_PAGE, keyConfigPage)};
    for (int index = 0; index < 7; ++index)
    {
        MoveOnto(pages[index], pageArea);
        ShowWindow(pages[index], index == 0 ? SW_SHOW : SW_HIDE);
    }
    InsertTabItem(keyTab, 0, "キーボード");
    InsertTabItem(keyTab, 1, "コントローラー");
    RECT keyArea = DisplayArea(keyTab);
    MapWindowPoints(keyTab, keyConfigPage, reinterpret_cast<POINT*>(&keyArea), 2);
    for (int index = 0; index < 2; ++index)
    {
        MoveOnto(keyPages[index], keyArea);
        ShowWindow(keyPages[index], index == 0 ? SW_SHOW : SW_HIDE);
    }

    MSG message;
    for (;;)
    {
        if (PeekMessageA(&message, nullptr, 0, 0, PM_REMOVE))
        {
            if (message.message == WM_QUIT)
                break;
            TranslateMessage(&message);
            DispatchMessageA(&message);
            continue;
        }
        bench::ReportStartup();
    }
    return 0;
}
