#include "input/key_assignment.h"

#include "base/input_codes.h"

namespace input
{
namespace
{

// Actions 4..7 and 9..12 take the sticks' directions. They are not
// offered for assignment: a stick drifting through a direction would
// otherwise be captured.
bool IsStickDirection(int action)
{
    return (action >= 4 && action <= 7) || (action >= 9 && action <= 12);
}

// After an exchange the focus does not stop on the hidden boxes before a
// stick's push: it goes on to the push.
std::int8_t SkipToStickPush(std::int8_t action)
{
    if (action >= 9 && action <= 12)
        return 13;
    if (action >= 2 && action <= 7)
        return 8;
    return action;
}

bool IsAction(std::int8_t action)
{
    return action >= 0 && action < kActionCount;
}

Capture FocusOnly(std::int8_t action, std::int8_t next)
{
    return {true, action, next, 0, {}};
}

} // namespace

const std::int8_t kKeyboardFocusOrder[kActionCount] = {
    1, 4, 3, 4, 5, 6, 7, 14, 23, 10, 11, 12, 14, 23, 15, 16, 17, 19, 20, 21, 8, 18, 4, 22,
};

const std::int8_t kPadFocusOrder[kActionCount] = {
    1, 14, 3, 4, 5, 6, 7, 14, 23, 9, 10, 11, 12, 23, 15, 16, 17, 19, 20, 21, 8, 18, 14, 22,
};

Capture DecideKeyCapture(const std::uint32_t (&keys)[kActionCount], std::int8_t focused,
                         const std::uint8_t (&wentDown)[kKeyCodeCount])
{
    if (!IsAction(focused))
        return {};
    int key = 0;
    while (key < kKeyCodeCount && wentDown[key] == 0)
        ++key;
    // Other keys that went down at the same poll are not looked at.
    if (key == kKeyCodeCount || IsReservedKey(key))
        return {};

    Capture capture = FocusOnly(focused, kKeyboardFocusOrder[focused]);
    for (std::int8_t owner = 0; owner < kActionCount; ++owner)
    {
        if (keys[owner] != static_cast<std::uint32_t>(key))
            continue;
        if (owner == focused)
            return capture;
        capture.changes[capture.changeCount++] = {owner, keys[focused]};
        break;
    }
    capture.changes[capture.changeCount++] = {focused, static_cast<std::uint32_t>(key)};
    return capture;
}

Capture DecideKeyCapture(const std::uint32_t (&keys)[kActionCount], std::int8_t focused,
                         const CDirectInput& input)
{
    std::uint8_t wentDown[kKeyCodeCount];
    for (int code = 0; code < kKeyCodeCount; ++code)
        wentDown[code] = input.IsKeyTriggered(static_cast<std::uint8_t>(code));
    return DecideKeyCapture(keys, focused, wentDown);
}

Capture DecidePadCapture(const std::uint32_t (&codes)[kActionCount], std::int8_t focused,
                         const InputSlot& slot,
                         const std::uint8_t (&rawButtons)[kCaptureJoyButtons])
{
    if (!IsAction(focused))
        return {};

    // A button some action has: the slot's maps hold the player's codes, so
    // that action's slot button went down.
    for (std::int8_t owner = 0; owner < kActionCount; ++owner)
    {
        if (slot.pressed[kFirstVirtualButton + owner] == 0)
            continue;
        if (IsStickDirection(owner))
            return {};
        if (owner == focused)
            return FocusOnly(focused, kPadFocusOrder[focused]);
        Capture capture = FocusOnly(focused, SkipToStickPush(kPadFocusOrder[focused]));
        capture.changeCount = 2;
        capture.changes[0] = {owner, codes[focused]};
        capture.changes[1] = {focused, codes[owner] & 0xFF};
        return capture;
    }

    // Any other button of the controller, held down, not only newly pressed.
    for (int button = 0; button < kCaptureJoyButtons; ++button)
    {
        if (rawButtons[button] == 0)
            continue;
        const std::uint8_t code = JoyButtonCode(button);
        for (std::uint32_t assigned : codes)
        {
            // Held since an earlier capture: its action's slot button did
            // not go down now.
            if (assigned == code)
                return {};
        }
        Capture capture = FocusOnly(focused, kPadFocusOrder[focused]);
        capture.changeCount = 1;
        capture.changes[0] = {focused, code};
        return capture;
    }
    return {};
}

Capture DecidePadCapture(const std::uint32_t (&codes)[kActionCount], std::int8_t focused,
                         const CInput& input)
{
    const InputSlot& slot = input.GetSlot(0);
    std::uint8_t rawButtons[kCaptureJoyButtons];
    for (int button = 0; button < kCaptureJoyButtons; ++button)
        rawButtons[button] =
            input.GetJoyButton(slot.joystickIndex, static_cast<std::uint8_t>(button));
    return DecidePadCapture(codes, focused, slot, rawButtons);
}

void ApplyKeyCapture(const Capture& capture, std::uint32_t (&keys)[kActionCount],
                     std::int8_t& focusedAction)
{
    if (!capture.happened)
        return;
    for (int i = 0; i < capture.changeCount; ++i)
        keys[capture.changes[i].action] = capture.changes[i].code;
    focusedAction = capture.nextFocus;
}

void ApplyPadCapture(const Capture& capture, std::uint32_t (&codes)[kActionCount], InputSlot& slot,
                     std::int8_t& focusedAction)
{
    if (!capture.happened)
        return;
    for (int i = 0; i < capture.changeCount; ++i)
    {
        const CodeChange& change = capture.changes[i];
        codes[change.action] = change.code;
        slot.joyMap[change.action] = change.code;
        slot.xinputMap[change.action] = change.code;
    }
    if (capture.changeCount > 0)
        slot.current[kFirstVirtualButton + capture.action] = 1;
    focusedAction = capture.nextFocus;
}

void BindPlayerToSlot(const std::uint32_t (&codes)[kActionCount], std::uint8_t device,
                      InputSlot& slot)
{
    for (int action = 0; action < kActionCount; ++action)
    {
        slot.joyMap[action] = codes[action];
        slot.xinputMap[action] = codes[action];
    }
    slot.joystickIndex = device;
}

} // namespace input
