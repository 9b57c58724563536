#pragma once

// What the tests of the value pages share: reading controls back, moving a
// slider as a user does, and settings files made from a record.

#include "base/win32.h"
#include "config/save_config.h"

#include <commctrl.h>
#include <cstdint>
#include <cstring>
#include <functional>
#include <gtest/gtest.h>
#include <string>
#include <vector>

namespace gui
{

// Where each section's bytes lie in "GameConfig.dat" while both address
// lists are empty.
inline constexpr std::size_t kGraphicsInFile = 8;
inline constexpr std::size_t kGameInFile = 32;
inline constexpr std::size_t kReplayInFile = 552;
inline constexpr std::size_t kRadioChatInFile = 6384;

// A settings file holding the defaults with `edit` applied.
inline std::vector<std::uint8_t> SettingsWith(const std::function<void(config::CSaveConfig&)>& edit)
{
    config::CSaveConfig record;
    record.ResetGraphics();
    record.ResetGame();
    record.ResetNetwork();
    record.ResetReplay();
    record.ResetUserBgm();
    record.ResetKeys();
    record.ResetRadioChat();
    edit(record);
    return record.SaveToBytes();
}

inline std::int32_t LittleEndianAt(const std::vector<std::uint8_t>& bytes, std::size_t offset)
{
    std::int32_t value = 0;
    std::memcpy(&value, bytes.data() + offset, sizeof value);
    return value;
}

inline bool IsChecked(HWND page, int id)
{
    return SendDlgItemMessageA(page, id, BM_GETCHECK, 0, 0) == BST_CHECKED;
}

inline LRESULT Selection(HWND page, int id)
{
    return SendDlgItemMessageA(page, id, CB_GETCURSEL, 0, 0);
}

inline LRESULT ItemCount(HWND page, int id)
{
    return SendDlgItemMessageA(page, id, CB_GETCOUNT, 0, 0);
}

inline std::string ItemText(HWND page, int id, int index)
{
    char text[64] = {};
    SendDlgItemMessageA(page, id, CB_GETLBTEXT, index, reinterpret_cast<LPARAM>(text));
    return text;
}

inline LRESULT SliderPosition(HWND page, int id)
{
    return SendDlgItemMessageA(page, id, TBM_GETPOS, 0, 0);
}

// A user's drag of a slider: the slider moves, then tells its page.
inline void Slide(HWND page, int id, int position)
{
    const HWND slider = GetDlgItem(page, id);
    SendMessageA(slider, TBM_SETPOS, TRUE, position);
    SendMessageA(page, WM_HSCROLL, MAKEWPARAM(TB_THUMBPOSITION, static_cast<WORD>(position)),
                 reinterpret_cast<LPARAM>(slider));
}

} // namespace gui
