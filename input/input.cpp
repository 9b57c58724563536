#include "input/input.h"

namespace input
{
namespace
{
constexpr float kThumbScale = 1.0f / 32767.0f;
constexpr float kJoyAxisScale = 0.001f;
} // namespace

CInput::CInput() : pads{}, xinputCount(0), slots{}, frameTime(0) {}

bool CInput::Init(const InputWindow* window)
{
    if (window == nullptr || !CDirectInput::Init(window))
        return false;
    for (int s = 0; s < kSlotCount; ++s)
        ResetSlot(slots[s], static_cast<std::uint8_t>(s), joysticks[s] != nullptr);
    for (int p = 0; p < kXInputPadCount; ++p)
    {
        if (pads[p].Init(static_cast<std::uint32_t>(p)))
        {
            slots[p].xinputAllowed = 1;
            ++xinputCount;
        }
    }
    return true;
}

void CInput::Update()
{
    PollJoysticks();
    PollKeyboard();
    PollMouse();
    float cursorX = 0.0f;
    float cursorY = 0.0f;
    GetCursorClientPos(&cursorX, &cursorY);
    std::uint32_t xinputIndex = 0;
    for (InputSlot& slot : slots)
        UpdateSlot(slot, cursorX, cursorY, xinputIndex);
}

void CInput::UpdateSlot(InputSlot& slot, float cursorX, float cursorY, std::uint32_t& xinputIndex)
{
    BeginSlotUpdate(slot);
    PadFrame frame = {};
    ReadMouse(slot, mouseState);
    FilterCursor(slot, cursorX, cursorY);

    // Each answering pad serves one slot: a slot reads the first pad that
    // the slots before it did not take.
    bool fromXInput = false;
    if (xinputIndex < kXInputPadCount && slot.xinputAllowed != 0 && pads[xinputIndex].Poll())
    {
        CXInputPad& pad = pads[xinputIndex];
        pad.ToFrame(frame, slot.swapRightAxes != 0, slot.invertRightY != 0, slot.invertRightX != 0);
        if (slot.vibrationLeft == 0 && slot.vibrationRight == 0)
            pad.StopVibration();
        else
            pad.SetVibration(slot.vibrationLeft, slot.vibrationRight);
        const XINPUT_GAMEPAD& gamepad = pad.GetState()->Gamepad;
        slot.leftX = gamepad.sThumbLX * kThumbScale;
        slot.leftY = -gamepad.sThumbLY * kThumbScale;
        slot.rightX = gamepad.sThumbRX * kThumbScale;
        slot.rightY = -gamepad.sThumbRY * kThumbScale;
        slot.analogValid = 1;
        ++xinputIndex;
        fromXInput = true;
    }
    else
    {
        DIJOYSTATE2* joystick = GetJoystickState(slot.joystickIndex);
        if (joystick != nullptr)
            FillFrameFromJoystick(
                *joystick,
                {slot.swapRightAxes != 0, slot.invertRightY != 0, slot.invertRightX != 0}, frame);
        if (slot.analogValid != 0 && joystick != nullptr)
        {
            slot.leftX = joystick->lX * kJoyAxisScale;
            slot.leftY = joystick->lY * kJoyAxisScale;
            slot.rightX = joystick->lZ * kJoyAxisScale;
            slot.rightY = joystick->lRz * kJoyAxisScale;
        }
        else
        {
            slot.analogValid = 0;
        }
    }

    ReadKeyboard(slot, keyCurrent);
    ApplyDigitalOverrides(slot);
    ReadPadFrame(slot, frame, fromXInput);
    FinishSticks(slot);
    DecayVibration(slot, frameTime);
    UpdateButtonEdges(slot, frameTime);
}

} // namespace input
