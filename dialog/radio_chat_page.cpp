// The Radio-chat page: the twelve messages of the function keys F1 to F12
// and whether each goes to everyone.
#include "app/config_application.h"
#include "base/window_text_win32.h"
#include "config/fixed_text.h"
#include "dialog/page_controls.h"
#include "resources/resource.h"

#include <string>

namespace
{
constexpr int TextId(int row)
{
    return IDC_RADIO_CHAT_TEXT_FIRST + IDC_RADIO_CHAT_ROW_STEP * row;
}

constexpr int ToAllId(int row)
{
    return IDC_RADIO_CHAT_TO_ALL_FIRST + IDC_RADIO_CHAT_ROW_STEP * row;
}

// Takes the edit's whole text and keeps what the field holds of it.
void KeepMessage(HWND edit, config::RadioChatEntry* entry)
{
    config::StoreFieldText(entry->text, config::kRadioChatTextLimit, base::TakeTyped932(edit));
}
} // namespace

bool CConfigApplication::InitRadioChatPage()
{
    const HWND page = pages_[kRadioChatPageIndex].window;
    config::ConfigRadioChat* radioChat = record_->RadioChat();
    for (int row = 0; row < config::kRadioChatCount; ++row)
    {
        const config::RadioChatEntry& entry = radioChat->entries[row];
        const std::string text = config::FieldText(entry.text);
        // The edit reports the new text at once (EN_UPDATE): the record then
        // holds only what it can keep of it.
        base::SetItemText932(page, TextId(row), text);
        dialog::ShowCheck(page, ToAllId(row), entry.notToAll == 0);
    }
    return true;
}

LRESULT CConfigApplication::OnRadioChatPage(HWND page, UINT message, WPARAM wParam, LPARAM)
{
    if (message != WM_COMMAND)
        return FALSE;
    const int id = LOWORD(wParam);
    const int code = HIWORD(wParam);
    for (int row = 0; row < config::kRadioChatCount; ++row)
    {
        config::RadioChatEntry* entry = &record_->RadioChat()->entries[row];
        if (id == ToAllId(row) && code == BN_CLICKED)
            entry->notToAll = dialog::IsChecked(page, id) ? 0 : 1;
        else if (id == TextId(row) && code == EN_UPDATE)
            KeepMessage(GetDlgItem(page, id), entry);
    }
    return TRUE;
}
