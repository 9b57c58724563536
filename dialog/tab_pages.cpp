// The two tab controls, their pages, and the routing of every message of the
// tool to the handler of the window it belongs to.
#include "app/config_application.h"
#include "app/system.h"
#include "base/window_text_win32.h"
#include "resources/resource.h"

#include <algorithm>
#include <commctrl.h>
#include <initializer_list>

namespace
{

struct PageEntry
{
    const char* caption;
    std::uint32_t templateId;
    CConfigApplication::PageHandler handler;
};

// In tab order. A page without a handler has no controls of its own yet.
const PageEntry kPages[kPageCount] = {
    {"グラフィック", IDD_GRAPHICS_PAGE, &CConfigApplication::OnGraphicsPage},
    {"ゲーム", IDD_GAME_PAGE, &CConfigApplication::OnGamePage},
    {"ネットワーク", IDD_NETWORK_PAGE, &CConfigApplication::OnNetworkPage},
    {"リプレイ", IDD_REPLAY_PAGE, &CConfigApplication::OnReplayPage},
    {"BGM", IDD_USER_MUSIC_PAGE, &CConfigApplication::OnUserMusicPage},
    {"キーコンフィグ", IDD_KEY_CONFIG_PAGE, nullptr},
    {"ラジオチャット", IDD_RADIO_CHAT_PAGE, &CConfigApplication::OnRadioChatPage},
};

const PageEntry kKeyPages[kKeyPageCount] = {
    {"キーボード", IDD_KEYBOARD_PAGE, &CConfigApplication::OnKeyboardPage},
    {"コントローラー", IDD_PAD_PAGE, &CConfigApplication::OnPadPage},
};

// The tab's client area less its tabs, in the tab's client coordinates.
RECT DisplayArea(HWND tab)
{
    RECT area;
    GetClientRect(tab, &area);
    SendMessageW(tab, TCM_ADJUSTRECT, FALSE, reinterpret_cast<LPARAM>(&area));
    return area;
}

void MoveOnto(HWND page, const RECT& area)
{
    MoveWindow(page, area.left, area.top, area.right - area.left, area.bottom - area.top, FALSE);
}

SIZE WindowSize(HWND window)
{
    RECT rect = {};
    GetWindowRect(window, &rect);
    return {rect.right - rect.left, rect.bottom - rect.top};
}

// How much wider and taller `area` must be to hold the largest window.
SIZE Shortfall(const RECT& area, std::initializer_list<SIZE> sizes)
{
    SIZE shortfall = {0, 0};
    for (const SIZE& size : sizes)
    {
        shortfall.cx = std::max(shortfall.cx, size.cx - (area.right - area.left));
        shortfall.cy = std::max(shortfall.cy, size.cy - (area.bottom - area.top));
    }
    return shortfall;
}

void Grow(HWND window, SIZE by)
{
    const SIZE size = WindowSize(window);
    SetWindowPos(window, nullptr, 0, 0, size.cx + by.cx, size.cy + by.cy,
                 SWP_NOMOVE | SWP_NOZORDER | SWP_NOACTIVATE);
}

void Shift(HWND control, SIZE by)
{
    RECT rect = {};
    GetWindowRect(control, &rect);
    MapWindowPoints(nullptr, GetParent(control), reinterpret_cast<POINT*>(&rect), 2);
    SetWindowPos(control, nullptr, rect.left + by.cx, rect.top + by.cy, 0, 0,
                 SWP_NOSIZE | SWP_NOZORDER | SWP_NOACTIVATE);
}

// Shows the page at `index` and makes it `current`; hides every other one.
// Out of range, all are hidden and `current` stays.
template <std::size_t Count> void ShowOnly(const PageSlot (&pages)[Count], int index, HWND& current)
{
    for (int position = 0; position < static_cast<int>(Count); ++position)
    {
        ShowWindow(pages[position].window, position == index ? SW_SHOW : SW_HIDE);
        if (position == index)
            current = pages[position].window;
    }
}

bool IsSelectionChange(LPARAM lParam, HWND tab)
{
    const auto* header = reinterpret_cast<const NMHDR*>(lParam);
    return header->code == static_cast<UINT>(TCN_SELCHANGE) && header->hwndFrom == tab;
}

} // namespace

void CConfigApplication::CreatePages(HINSTANCE instance)
{
    const HWND mainDialog = system_->GetHwnd();
    const auto dialogProcedure = reinterpret_cast<DLGPROC>(procedure_);

    mainTab_ = GetDlgItem(mainDialog, IDC_MAIN_TAB);
    for (int index = 0; index < kPageCount; ++index)
        base::InsertTabItem(mainTab_, index, kPages[index].caption);
    RECT pageArea = DisplayArea(mainTab_);
    for (int index = 0; index < kPageCount; ++index)
    {
        pages_[index].templateId = kPages[index].templateId;
        pages_[index].window = base::CreateDialogFromTemplate(
            instance, static_cast<int>(kPages[index].templateId), mainTab_, dialogProcedure);
    }

    const HWND keyConfigPage = pages_[kKeyConfigPageIndex].window;
    keyTab_ = GetDlgItem(keyConfigPage, IDC_KEY_TAB);
    for (int index = 0; index < kKeyPageCount; ++index)
    {
        keyPages_[index].templateId = kKeyPages[index].templateId;
        keyPages_[index].window =
            base::CreateDialogFromTemplate(instance, static_cast<int>(kKeyPages[index].templateId),
                                           keyConfigPage, dialogProcedure);
    }

    // The pages are laid out in a larger font than the main dialog, so at
    // their template sizes their lower rows would lie below the tabs' display
    // areas, out of reach. Where a page does not fit, its tab grows by the
    // difference, and the dialog and its buttons with it; nothing else moves.
    const SIZE keyShortfall = Shortfall(
        DisplayArea(keyTab_), {WindowSize(keyPages_[0].window), WindowSize(keyPages_[1].window)});
    Grow(keyTab_, keyShortfall);
    SIZE keyConfigSize = WindowSize(keyConfigPage);
    keyConfigSize.cx += keyShortfall.cx;
    keyConfigSize.cy += keyShortfall.cy;
    const SIZE shortfall = Shortfall(
        pageArea, {WindowSize(pages_[0].window), WindowSize(pages_[1].window),
                   WindowSize(pages_[2].window), WindowSize(pages_[3].window),
                   WindowSize(pages_[4].window), keyConfigSize, WindowSize(pages_[6].window)});
    if (shortfall.cx > 0 || shortfall.cy > 0)
    {
        Grow(mainTab_, shortfall);
        Shift(GetDlgItem(mainDialog, IDOK), shortfall);
        Shift(GetDlgItem(mainDialog, IDCANCEL), shortfall);
        system_->GrowWindow(shortfall.cx, shortfall.cy);
        pageArea = DisplayArea(mainTab_);
    }

    for (const PageSlot& page : pages_)
        MoveOnto(page.window, pageArea);
    SelectPage(0);

    for (int index = 0; index < kKeyPageCount; ++index)
        base::InsertTabItem(keyTab_, index, kKeyPages[index].caption);
    // The sub-pages are children of the page, not of its tab control.
    RECT keyArea = DisplayArea(keyTab_);
    MapWindowPoints(keyTab_, keyConfigPage, reinterpret_cast<POINT*>(&keyArea), 2);
    for (const PageSlot& page : keyPages_)
        MoveOnto(page.window, keyArea);
    SelectKeyPage(0);
}

bool CConfigApplication::SelectPage(int index)
{
    ShowOnly(pages_, index, currentPage_);
    return true;
}

bool CConfigApplication::SelectKeyPage(int index)
{
    ShowOnly(keyPages_, index, currentKeyPage_);
    return true;
}

LRESULT CConfigApplication::WindowProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam)
{
    for (int index = 0; index < kPageCount; ++index)
    {
        if (window != pages_[index].window)
            continue;
        if (index == kKeyConfigPageIndex)
            return OnKeyConfigPage(window, message, wParam, lParam);
        const PageHandler handler = kPages[index].handler;
        return handler != nullptr ? (this->*handler)(window, message, wParam, lParam) : FALSE;
    }
    for (int index = 0; index < kKeyPageCount; ++index)
    {
        if (window != keyPages_[index].window)
            continue;
        const PageHandler handler = kKeyPages[index].handler;
        return handler != nullptr ? (this->*handler)(window, message, wParam, lParam) : FALSE;
    }
    for (int row = 0; row < config::kUserBgmRowCount; ++row)
    {
        if (window == musicEdits_[row].window || window == tensionEdits_[row].window)
            return OnUserMusicEdit(window, message, wParam, lParam);
    }
    return OnMainDialog(window, message, wParam, lParam);
}

LRESULT CConfigApplication::OnKeyConfigPage(HWND, UINT message, WPARAM, LPARAM lParam)
{
    if (message != WM_NOTIFY)
        return FALSE;
    if (IsSelectionChange(lParam, keyTab_))
        SelectKeyPage(static_cast<int>(SendMessageW(keyTab_, TCM_GETCURSEL, 0, 0)));
    return TRUE;
}

LRESULT CConfigApplication::OnMainTabNotify(LPARAM lParam)
{
    if (IsSelectionChange(lParam, mainTab_))
        SelectPage(static_cast<int>(SendMessageW(mainTab_, TCM_GETCURSEL, 0, 0)));
    return TRUE;
}
