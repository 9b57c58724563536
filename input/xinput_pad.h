#pragma once

#include "input/device_types.h"
#include "input/pad_frame.h"

#include <cstdint>

namespace input
{

// One XInput controller. XInput itself is loaded when first needed; on a
// system without it every pad reads as not connected.
class CXInputPad
{
public:
    bool Init(std::uint32_t user);
    // True when the pad answered.
    bool Poll();
    bool SetVibration(std::uint16_t left, std::uint16_t right);
    void StopVibration();
    // Fills entries 0..23 of the frame from the last poll, applying the dead
    // zones and the right stick's options to the stored state.
    void ToFrame(PadFrame& frame, bool swapRightAxes, bool invertRightY, bool invertRightX);
    const XINPUT_STATE* GetState() const { return &state; }

private:
    void SendVibration();

    std::uint32_t userIndex = 0;
    XINPUT_STATE state = {};
    XINPUT_VIBRATION vibration = {};
    std::uint32_t vibrationEnabled = 1;
};

} // namespace input
