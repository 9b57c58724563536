#pragma once

#include "input/direct_input.h"
#include "input/input_slot.h"
#include "input/xinput_pad.h"

#include <cstdint>

namespace input
{

inline constexpr int kXInputPadCount = 4;

// The input manager: polls every device once per update and turns what it
// reads into sixteen player slots. The application creates it on the heap
// with `new` and calls Init once the main dialog exists.
class CInput : public CDirectInput
{
public:
    CInput();

    // Fails for a null window and when DirectInput cannot be set up.
    bool Init(const InputWindow* window);
    // One poll of every device and one update of every slot.
    void Update();

    InputSlot& GetSlot(std::uint8_t slot) { return slots[slot]; }
    const InputSlot& GetSlot(std::uint8_t slot) const { return slots[slot]; }
    std::uint32_t IsTriggered(std::uint8_t slot, std::uint8_t button) const
    {
        return slots[slot].pressed[button];
    }

    // The time of one frame in milliseconds, for the hold and idle times and
    // the decay of vibration. A frame clock may publish it; the
    // configuration tool has none, so it stays 0 there.
    void SetFrameTime(std::uint32_t milliseconds) { frameTime = milliseconds; }

private:
    void UpdateSlot(InputSlot& slot, float cursorX, float cursorY, std::uint32_t& xinputIndex);

    CXInputPad pads[kSlotCount];
    std::uint32_t xinputCount;
    InputSlot slots[kSlotCount];
    std::uint32_t frameTime;
};

} // namespace input
