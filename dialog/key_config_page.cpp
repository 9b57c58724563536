// The key-config page: its two sub-pages filled at start-up, and what they
// share.
#include "app/config_application.h"
#include "base/window_text_win32.h"
#include "config/field_table.h"
#include "dialog/key_pages.h"
#include "resources/resource.h"

namespace dialog
{
void ShowActions(HWND page, int firstLabel, int firstEdit,
                 const std::uint32_t (&codes)[config::kActionCount], CodeName name)
{
    for (int action = 0; action < config::kActionCount; ++action)
    {
        base::SetItemText932(page, firstLabel + action, config::kActionLabels[action]);
        // A settings file may hold any value; only the low byte names it.
        base::SetItemText932(page, firstEdit + action,
                             name(static_cast<std::uint8_t>(codes[action])));
    }
}

void ShowCapture(HWND page, int firstEdit, const input::Capture& capture, CodeName name)
{
    if (!capture.happened)
        return;
    for (int i = 0; i < capture.changeCount; ++i)
    {
        const input::CodeChange& change = capture.changes[i];
        base::SetItemText932(page, firstEdit + change.action,
                             name(static_cast<std::uint8_t>(change.code)));
    }
    SetFocus(GetDlgItem(page, firstEdit + capture.nextFocus));
}

void TakeEditFocus(WPARAM wParam, int firstEdit, std::int8_t& focusedAction)
{
    const int action = LOWORD(wParam) - firstEdit;
    if (HIWORD(wParam) == EN_SETFOCUS && action >= 0 && action < config::kActionCount)
        focusedAction = static_cast<std::int8_t>(action);
}

} // namespace dialog

bool CConfigApplication::InitKeyConfigPage()
{
    FillKeyboardPage();
    FillPadPage();
    const HWND players = GetDlgItem(keyPages_[kPadPageIndex].window, IDC_PAD_PLAYER);
    SendMessageW(players, CB_RESETCONTENT, 0, 0);
    for (const char* player : {"1P", "2P", "3P", "4P"})
        base::AddComboItem(players, player);
    SendMessageW(players, CB_SETCURSEL, 0, 0);
    return true;
}
