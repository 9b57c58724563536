#include "dialog/page_controls.h"

#include "base/window_text_win32.h"

namespace dialog
{
namespace
{
void Fill(HWND page, int id, std::span<const char* const> options, WPARAM selection)
{
    // Looked up once: under Wine every lookup is a call to its server.
    const HWND list = GetDlgItem(page, id);
    for (const char* option : options)
        base::AddComboItem(list, option);
    SendMessageW(list, CB_SETCURSEL, selection, 0);
}

LRESULT Selection(HWND page, int id)
{
    return SendDlgItemMessageW(page, id, CB_GETCURSEL, 0, 0);
}
} // namespace

void ShowCheck(HWND page, int id, bool checked)
{
    SendDlgItemMessageW(page, id, BM_SETCHECK, checked ? BST_CHECKED : BST_UNCHECKED, 0);
}

bool IsChecked(HWND page, int id)
{
    return SendDlgItemMessageW(page, id, BM_GETCHECK, 0, 0) == BST_CHECKED;
}

std::uint32_t CheckValue(HWND page, int id)
{
    return IsChecked(page, id) ? 1 : 0;
}

void FillChoices(HWND page, int id, std::span<const char* const> options, std::uint8_t value)
{
    Fill(page, id, options, static_cast<WPARAM>(static_cast<std::int8_t>(value)));
}

void FillChoices(HWND page, int id, std::span<const char* const> options, std::uint32_t value)
{
    Fill(page, id, options, value);
}

void StoreChoice(HWND page, int id, std::uint8_t* field)
{
    *field = static_cast<std::uint8_t>(Selection(page, id));
}

void StoreChoice(HWND page, int id, std::uint32_t* field)
{
    *field = static_cast<std::uint32_t>(Selection(page, id));
}

} // namespace dialog
