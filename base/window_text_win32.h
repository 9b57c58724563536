#pragma once

// Where the tool's text meets Windows. Inside, every text is code page 932
// bytes, as the game keeps it, and every path is in the system's ANSI code
// page, as the game opens it. The windows are Unicode windows, so that the
// tool reads the same whatever code page the system has; every text crosses
// here, converted explicitly, never through the system's code page by
// accident and never with best-fit stand-ins.

#include "base/win32.h"

#include <optional>
#include <string>
#include <string_view>

namespace base
{

std::wstring WideFrom932(std::string_view text);
// The text without the characters code page 932 cannot hold.
std::string Cp932From(std::wstring_view text);

std::wstring WideFromAnsi(std::string_view path);
// None when a character cannot be held in the system's ANSI code page: the
// game could not open such a path.
std::optional<std::string> AnsiFrom(std::wstring_view path);

std::wstring WindowTextWide(HWND window);
// What a control holds, in code page 932 (characters it cannot hold are
// left out): for numbers and other texts that are read, not kept.
std::string WindowText932(HWND window);
// What the player typed into an edit whose text the game keeps in code page
// 932. A character that code page cannot hold is refused as it arrives: it
// is taken out of the edit again, with the warning beep, so that the edit
// always shows what is kept.
std::string TakeTyped932(HWND edit);

void SetWindowText932(HWND window, std::string_view text);
void SetItemText932(HWND dialog, int id, std::string_view text);
void SetPathText(HWND window, std::string_view path);

void AddComboItem(HWND combo, std::string_view text);
void AddComboItem(HWND combo, const std::wstring& text);
void AddListItem(HWND list, std::string_view text);
void InsertTabItem(HWND tab, int index, std::string_view text);

// A message box of the tool's own texts; returns the button pressed
// (IDOK, IDYES, ...), as MessageBox does.
int ShowMessage(HWND owner, const char* text, const char* caption, UINT flags);

// The tool's dialogs, from their templates (whose texts are UTF-16 already).
HWND CreateDialogFromTemplate(HINSTANCE instance, int templateId, HWND parent, DLGPROC procedure);
INT_PTR RunModalDialog(HINSTANCE instance, int templateId, HWND owner, DLGPROC procedure,
                       LPARAM parameter);

} // namespace base
