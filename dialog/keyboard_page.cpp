// The keyboard sub-page: one key per action, taken from the keyboard while
// the page is in view.
#include "app/config_application.h"
#include "dialog/key_pages.h"
#include "input/input.h"
#include "resources/resource.h"

void CConfigApplication::FillKeyboardPage()
{
    dialog::ShowActions(keyPages_[kKeyboardPageIndex].window, IDC_KEYBOARD_LABEL_FIRST,
                        IDC_KEYBOARD_EDIT_FIRST, record_->Keys()->keyboardKeys,
                        input::CDirectInput::GetKeyName);
}

LRESULT CConfigApplication::OnKeyboardPage(HWND, UINT message, WPARAM wParam, LPARAM)
{
    if (message != WM_COMMAND)
        return FALSE;
    if (LOWORD(wParam) == IDC_KEYBOARD_RESET && HIWORD(wParam) == BN_CLICKED)
    {
        record_->ResetKeyboardKeys();
        FillKeyboardPage();
    }
    else
    {
        dialog::TakeEditFocus(wParam, IDC_KEYBOARD_EDIT_FIRST, focusedAction_);
    }
    return TRUE;
}

void CConfigApplication::CaptureKey()
{
    config::ConfigKeys& keys = *record_->Keys();
    const input::Capture capture =
        input::DecideKeyCapture(keys.keyboardKeys, focusedAction_, *input_);
    input::ApplyKeyCapture(capture, keys.keyboardKeys, focusedAction_);
    dialog::ShowCapture(keyPages_[kKeyboardPageIndex].window, IDC_KEYBOARD_EDIT_FIRST, capture,
                        input::CDirectInput::GetKeyName);
}
