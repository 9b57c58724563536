#pragma once

// What a key or button capture on the key assignment pages changes. The
// pages only show the outcome: the new names in the edit boxes and the focus.

#include "base/input_codes.h"
#include "input/input.h"
#include "input/input_slot.h"

#include <cstdint>

namespace input
{

// The action whose edit box follows each action's after a capture. On the
// shown boxes they give the reading order of the page, wrapping around.
extern const std::int8_t kKeyboardFocusOrder[kActionCount];
extern const std::int8_t kPadFocusOrder[kActionCount];

// The first 32 buttons of a DirectInput controller are the ones a capture
// looks at.
inline constexpr int kCaptureJoyButtons = 32;

struct CodeChange
{
    std::int8_t action;
    std::uint32_t code;
};

// The outcome of one capture attempt.
struct Capture
{
    // False: nothing was captured, everything stays as it is.
    bool happened;
    // The focused action the capture was made for.
    std::int8_t action;
    std::int8_t nextFocus;
    // The actions whose code changes, in the order the page updates them:
    // the action that gives its code away first.
    int changeCount;
    CodeChange changes[2];
};

// Keyboard page. `keys` are the actions' key codes, `wentDown` holds one
// flag per key code for the keys that went down at this poll. A key goes to
// the focused action and the action that had it gets the focused action's
// former key, so no key is left on two actions. ESCAPE and F1..F12 cannot
// be assigned.
Capture DecideKeyCapture(const std::uint32_t (&keys)[kActionCount], std::int8_t focused,
                         const std::uint8_t (&wentDown)[kKeyCodeCount]);
Capture DecideKeyCapture(const std::uint32_t (&keys)[kActionCount], std::int8_t focused,
                         const CDirectInput& input);

// Controller page. `codes` are the player's button codes, `slot` is slot 0
// after its update with the player's codes in its controller maps, and
// `rawButtons` are the first 32 buttons of the slot's DirectInput
// controller (0 or 1). A button that an action already has is recognised
// through the slot and exchanged; any other button of the controller is
// stored on the focused action. Stick directions are never captured.
Capture DecidePadCapture(const std::uint32_t (&codes)[kActionCount], std::int8_t focused,
                         const InputSlot& slot,
                         const std::uint8_t (&rawButtons)[kCaptureJoyButtons]);
Capture DecidePadCapture(const std::uint32_t (&codes)[kActionCount], std::int8_t focused,
                         const CInput& input);

// Store a capture: the codes, and the focus in `focusedAction`.
void ApplyKeyCapture(const Capture& capture, std::uint32_t (&keys)[kActionCount],
                     std::int8_t& focusedAction);
// Also keeps the slot's maps equal to the player's codes, and counts the
// captured button as already down in the slot so that, still held at the
// next update, it does not press the newly focused action too.
void ApplyPadCapture(const Capture& capture, std::uint32_t (&codes)[kActionCount], InputSlot& slot,
                     std::int8_t& focusedAction);

// Makes the slot read the player's controller (its number in enumeration
// order) through the player's codes.
void BindPlayerToSlot(const std::uint32_t (&codes)[kActionCount], std::uint8_t device,
                      InputSlot& slot);

} // namespace input
