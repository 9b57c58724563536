#pragma once

// What the tests of the value pages share: reading controls back, moving a
// slider as a user does, where a control lies in its page's dialog units,
// and settings files made from a record.

#include "base/win32.h"
#include "config/save_config.h"

#include <commctrl.h>
#include <cstdint>
#include <cstdio>
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

// The static of a page that shows `text`.
inline HWND FindStatic(HWND page, const std::string& text)
{
    struct Search
    {
        const std::string* text;
        HWND found;
    } search = {&text, nullptr};
    EnumChildWindows(
        page,
        [](HWND child, LPARAM data) -> BOOL
        {
            auto* search = reinterpret_cast<Search*>(data);
            char className[16] = {};
            char caption[64] = {};
            GetClassNameA(child, className, sizeof className);
            GetWindowTextA(child, caption, sizeof caption);
            if (_stricmp(className, "Static") != 0 || *search->text != caption)
                return TRUE;
            search->found = child;
            return FALSE;
        },
        reinterpret_cast<LPARAM>(&search));
    return search.found;
}

struct Placement
{
    int x, y, width, height;
};

// Whether a control lies where the template puts it, in its page's dialog
// units.
inline ::testing::AssertionResult LiesAt(HWND page, HWND control, const Placement& expected)
{
    if (control == nullptr)
        return ::testing::AssertionFailure() << "no such control";
    RECT origin = {expected.x, expected.y, expected.x, expected.y};
    RECT size = {0, 0, expected.width, expected.height};
    MapDialogRect(page, &origin);
    MapDialogRect(page, &size);

    RECT actual;
    GetWindowRect(control, &actual);
    MapWindowPoints(nullptr, page, reinterpret_cast<POINT*>(&actual), 2);
    if (actual.left == origin.left && actual.top == origin.top &&
        actual.right - actual.left == size.right && actual.bottom - actual.top == size.bottom)
        return ::testing::AssertionSuccess();
    return ::testing::AssertionFailure()
           << "at " << actual.left << "," << actual.top << " size " << actual.right - actual.left
           << "x" << actual.bottom - actual.top << " instead of " << origin.left << ","
           << origin.top << " size " << size.right << "x" << size.bottom << " pixels";
}

// Whether a control is of the class and its style bits under `mask` are
// `style` (the mask defaults to the style's own bits).
inline ::testing::AssertionResult IsControl(HWND control, const char* className, DWORD style,
                                            DWORD mask = 0)
{
    char actualClass[32] = {};
    GetClassNameA(control, actualClass, sizeof actualClass);
    const DWORD actualStyle = static_cast<DWORD>(GetWindowLongA(control, GWL_STYLE));
    if (_stricmp(actualClass, className) == 0 && (actualStyle & (mask | style)) == style)
        return ::testing::AssertionSuccess();
    char shown[16];
    std::snprintf(shown, sizeof shown, "0x%08lX", actualStyle);
    return ::testing::AssertionFailure() << actualClass << " with style " << shown;
}

inline ::testing::AssertionResult IsCheckBox(HWND control)
{
    return IsControl(control, "Button", BS_AUTOCHECKBOX, BS_TYPEMASK);
}

inline ::testing::AssertionResult IsDropDownList(HWND control)
{
    return IsControl(control, "ComboBox", CBS_DROPDOWNLIST, CBS_DROPDOWNLIST | CBS_DROPDOWN);
}

// Whether a drop-down list's open list can scroll to options it has no room
// for. The combo box hands its WS_VSCROLL on to that list, which keeps it
// only while it has more options than room.
inline ::testing::AssertionResult ListScrolls(HWND control)
{
    COMBOBOXINFO info = {};
    info.cbSize = sizeof info;
    GetComboBoxInfo(control, &info);
    return IsControl(info.hwndList, "ComboLBox", WS_VSCROLL);
}

} // namespace gui
