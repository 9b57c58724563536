#include "base/window_text_win32.h"

#include <commctrl.h>
#include <vector>

namespace base
{
namespace
{

constexpr UINT kJapanese = 932;

std::wstring Widen(UINT codePage, std::string_view text)
{
    if (text.empty())
        return {};
    const int size = static_cast<int>(text.size());
    const int length = MultiByteToWideChar(codePage, 0, text.data(), size, nullptr, 0);
    std::wstring wide(static_cast<std::size_t>(length), L'\0');
    MultiByteToWideChar(codePage, 0, text.data(), size, wide.data(), length);
    return wide;
}

// Empty for a text that holds a character the code page cannot (or with
// only a stand-in for it): `held` tells.
std::string Narrow(UINT codePage, std::wstring_view text, bool& held)
{
    held = true;
    if (text.empty())
        return {};
    const int size = static_cast<int>(text.size());
    // A system whose ANSI code page is UTF-8 holds every character; there
    // the conversion only refuses broken surrogates.
    const bool utf8 = codePage == CP_UTF8 || (codePage == CP_ACP && GetACP() == CP_UTF8);
    const DWORD flags = utf8 ? WC_ERR_INVALID_CHARS : WC_NO_BEST_FIT_CHARS;
    BOOL defaulted = FALSE;
    BOOL* const usedDefault = utf8 ? nullptr : &defaulted;
    const int length =
        WideCharToMultiByte(codePage, flags, text.data(), size, nullptr, 0, nullptr, usedDefault);
    std::string narrow(static_cast<std::size_t>(length), '\0');
    WideCharToMultiByte(codePage, flags, text.data(), size, narrow.data(), length, nullptr,
                        usedDefault);
    held = length > 0 && !defaulted;
    return held ? narrow : std::string();
}

std::size_t CharacterLength(std::wstring_view text, std::size_t at)
{
    const bool pair =
        IS_HIGH_SURROGATE(text[at]) && at + 1 < text.size() && IS_LOW_SURROGATE(text[at + 1]);
    return pair ? 2 : 1;
}

// The characters of `text` that code page 932 holds, and how many units were
// left out before `position`.
struct Kept
{
    std::wstring wide;
    std::string narrow;
    std::size_t droppedBefore = 0;
};

Kept KeepCp932(std::wstring_view text, std::size_t position)
{
    Kept kept;
    for (std::size_t at = 0; at < text.size();)
    {
        const std::size_t length = CharacterLength(text, at);
        bool held = false;
        const std::string character = Narrow(kJapanese, text.substr(at, length), held);
        if (held)
        {
            kept.wide.append(text.substr(at, length));
            kept.narrow += character;
        }
        else if (at < position)
        {
            kept.droppedBefore += length;
        }
        at += length;
    }
    return kept;
}

} // namespace

std::wstring WideFrom932(std::string_view text)
{
    return Widen(kJapanese, text);
}

std::string Cp932From(std::wstring_view text)
{
    bool held = false;
    std::string narrow = Narrow(kJapanese, text, held);
    return held ? narrow : KeepCp932(text, 0).narrow;
}

std::wstring WideFromAnsi(std::string_view path)
{
    return Widen(CP_ACP, path);
}

std::optional<std::string> AnsiFrom(std::wstring_view path)
{
    bool held = false;
    std::string narrow = Narrow(CP_ACP, path, held);
    if (!held)
        return std::nullopt;
    return narrow;
}

std::wstring WindowTextWide(HWND window)
{
    const int length = GetWindowTextLengthW(window);
    std::wstring text(static_cast<std::size_t>(length) + 1, L'\0');
    const int copied = GetWindowTextW(window, text.data(), length + 1);
    text.resize(static_cast<std::size_t>(copied > 0 ? copied : 0));
    return text;
}

std::string WindowText932(HWND window)
{
    return Cp932From(WindowTextWide(window));
}

std::string TakeTyped932(HWND edit)
{
    const std::wstring text = WindowTextWide(edit);
    bool held = false;
    std::string narrow = Narrow(kJapanese, text, held);
    if (held)
        return narrow;
    DWORD caret = 0;
    SendMessageW(edit, EM_GETSEL, 0, reinterpret_cast<LPARAM>(&caret));
    const Kept kept = KeepCp932(text, caret);
    // The edit reports the new text at once; that report finds it whole.
    SetWindowTextW(edit, kept.wide.c_str());
    const WPARAM at = caret - kept.droppedBefore;
    SendMessageW(edit, EM_SETSEL, at, static_cast<LPARAM>(at));
    MessageBeep(MB_ICONWARNING);
    return kept.narrow;
}

void SetWindowText932(HWND window, std::string_view text)
{
    SetWindowTextW(window, WideFrom932(text).c_str());
}

void SetItemText932(HWND dialog, int id, std::string_view text)
{
    SetDlgItemTextW(dialog, id, WideFrom932(text).c_str());
}

void SetPathText(HWND window, std::string_view path)
{
    SetWindowTextW(window, WideFromAnsi(path).c_str());
}

void AddComboItem(HWND combo, std::string_view text)
{
    AddComboItem(combo, WideFrom932(text));
}

void AddComboItem(HWND combo, const std::wstring& text)
{
    SendMessageW(combo, CB_ADDSTRING, 0, reinterpret_cast<LPARAM>(text.c_str()));
}

void AddListItem(HWND list, std::string_view text)
{
    SendMessageW(list, LB_ADDSTRING, 0, reinterpret_cast<LPARAM>(WideFrom932(text).c_str()));
}

void InsertTabItem(HWND tab, int index, std::string_view text)
{
    std::wstring caption = WideFrom932(text);
    TCITEMW item = {};
    item.mask = TCIF_TEXT;
    item.pszText = caption.data();
    SendMessageW(tab, TCM_INSERTITEMW, index, reinterpret_cast<LPARAM>(&item));
}

int ShowMessage(HWND owner, const char* text, const char* caption, UINT flags)
{
    return MessageBoxW(owner, WideFrom932(text).c_str(), WideFrom932(caption).c_str(), flags);
}

HWND CreateDialogFromTemplate(HINSTANCE instance, int templateId, HWND parent, DLGPROC procedure)
{
    return CreateDialogParamW(instance, MAKEINTRESOURCEW(templateId), parent, procedure, 0);
}

INT_PTR RunModalDialog(HINSTANCE instance, int templateId, HWND owner, DLGPROC procedure,
                       LPARAM parameter)
{
    return DialogBoxParamW(instance, MAKEINTRESOURCEW(templateId), owner, procedure, parameter);
}

} // namespace base
