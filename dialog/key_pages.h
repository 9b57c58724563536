#pragma once

// What the keyboard and controller sub-pages of the key-config page share:
// the actions' labels, how the codes show and how a capture shows.

#include "base/win32.h"
#include "config/config_sections.h"
#include "input/key_assignment.h"

#include <cstdint>

namespace dialog
{

using CodeName = const char* (*)(std::uint8_t code);

// Every action's label, and the name of its code in its edit.
void ShowActions(HWND page, int firstLabel, int firstEdit,
                 const std::uint32_t (&codes)[config::kActionCount], CodeName name);

// The new names of the actions a capture changed, and the focus on the
// action that follows.
void ShowCapture(HWND page, int firstEdit, const input::Capture& capture, CodeName name);

// The action whose edit reports that it took the focus; the focus stays as
// it was for any other notification.
void TakeEditFocus(WPARAM wParam, int firstEdit, std::int8_t& focusedAction);

} // namespace dialog
