#pragma once

// The control operations the value pages share: check boxes and drop-down
// lists bound to record fields.

#include "base/win32.h"

#include <cstdint>
#include <span>

namespace dialog
{

void ShowCheck(HWND page, int id, bool checked);
bool IsChecked(HWND page, int id);
// 1 for a checked box, 0 otherwise: what the record stores for it.
std::uint32_t CheckValue(HWND page, int id);

// Adds the options in order and selects the field's value. A one-byte field
// is passed sign-extended, so 128 and above, like any value past the list,
// select nothing and the field keeps its value until the user chooses.
void FillChoices(HWND page, int id, std::span<const char* const> options, std::uint8_t value);
void FillChoices(HWND page, int id, std::span<const char* const> options, std::uint32_t value);

// Stores the list's selection in a field (its low byte for one-byte fields).
void StoreChoice(HWND page, int id, std::uint8_t* field);
void StoreChoice(HWND page, int id, std::uint32_t* field);

} // namespace dialog
