// The controller sub-page: one button per action for each of the four
// players, and the controller each player uses. Slot 0 of the input manager
// reads the shown player's controller through that player's buttons, so a
// press of an assigned button shows as its action's button going down.
#include "app/config_application.h"
#include "base/window_text_win32.h"
#include "dialog/key_pages.h"
#include "input/input.h"
#include "resources/resource.h"

void CConfigApplication::FillPadPage()
{
    const HWND page = keyPages_[kPadPageIndex].window;
    const config::PadConfig& player = record_->Keys()->padConfigs[selectedPlayer_];
    dialog::ShowActions(page, IDC_PAD_LABEL_FIRST, IDC_PAD_EDIT_FIRST, player.buttons,
                        input::CDirectInput::GetPadButtonName);
    input::BindPlayerToSlot(player.buttons, player.device, input_->GetSlot(0));

    const HWND devices = GetDlgItem(page, IDC_PAD_DEVICE);
    SendMessageW(devices, CB_RESETCONTENT, 0, 0);
    const int count = input_->GetJoystickCount();
    for (int index = 0; index < count; ++index)
    {
        // A controller whose set-up failed keeps its place with an empty
        // name, so that list positions stay controller numbers. DirectInput's
        // ANSI interface names it in the system's code page.
        const DIDEVICEINSTANCEA* info = input_->GetJoystickInfo(static_cast<std::uint8_t>(index));
        base::AddComboItem(devices,
                           base::WideFromAnsi(info != nullptr ? info->tszInstanceName : ""));
    }
    // A controller that is not attached now selects nothing.
    SendMessageW(devices, CB_SETCURSEL, player.device < count ? player.device : -1, 0);
}

LRESULT CConfigApplication::OnPadPage(HWND page, UINT message, WPARAM wParam, LPARAM)
{
    if (message != WM_COMMAND)
        return FALSE;
    const int id = LOWORD(wParam);
    const int notification = HIWORD(wParam);
    config::PadConfig& player = record_->Keys()->padConfigs[selectedPlayer_];
    if (id == IDC_PAD_RESET && notification == BN_CLICKED)
    {
        record_->ResetPadButtons(static_cast<std::uint8_t>(selectedPlayer_));
        FillPadPage();
    }
    else if (notification == CBN_SELCHANGE && (id == IDC_PAD_DEVICE || id == IDC_PAD_PLAYER))
    {
        const LRESULT selection = SendDlgItemMessageW(page, id, CB_GETCURSEL, 0, 0);
        // Nothing selected: the player and the device stay as they are.
        if (selection == CB_ERR)
            return TRUE;
        if (id == IDC_PAD_DEVICE)
        {
            player.device = static_cast<std::uint8_t>(selection);
            input_->GetSlot(0).joystickIndex = player.device;
        }
        else
        {
            selectedPlayer_ = static_cast<std::uint32_t>(selection);
            FillPadPage();
        }
    }
    else
    {
        dialog::TakeEditFocus(wParam, IDC_PAD_EDIT_FIRST, focusedAction_);
    }
    return TRUE;
}

void CConfigApplication::CapturePadButton()
{
    config::PadConfig& player = record_->Keys()->padConfigs[selectedPlayer_];
    const input::Capture capture = input::DecidePadCapture(player.buttons, focusedAction_, *input_);
    input::ApplyPadCapture(capture, player.buttons, input_->GetSlot(0), focusedAction_);
    dialog::ShowCapture(keyPages_[kPadPageIndex].window, IDC_PAD_EDIT_FIRST, capture,
                        input::CDirectInput::GetPadButtonName);
}
