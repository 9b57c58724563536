// Captures on the key assignment pages: which codes change and where the
// focus goes.
#include "config/save_config.h"
#include "input/key_assignment.h"

#include <gtest/gtest.h>
#include <tuple>
#include <vector>

using namespace input;
using Changes = std::vector<std::pair<int, std::uint32_t>>;

namespace
{

constexpr int kZ = 0x2C;
constexpr int kX = 0x2D;

config::ConfigKeys DefaultKeys()
{
    config::CSaveConfig record;
    record.ResetKeys();
    return *record.Keys();
}

// The changes in the order the page makes them, and the next focus (-1 when
// nothing was captured).
std::pair<Changes, int> Outcome(const Capture& capture)
{
    Changes changes;
    for (int i = 0; i < capture.changeCount; ++i)
        changes.emplace_back(capture.changes[i].action, capture.changes[i].code);
    return {changes, capture.happened ? capture.nextFocus : -1};
}

} // namespace

TEST(KeyCapture, AKeyGoesToTheFocusedActionAndItsOwnerGetsTheFormerKey)
{
    const config::ConfigKeys keys = DefaultKeys();
    // The focused action, the keys that went down, what changes, the next focus.
    const std::tuple<std::int8_t, std::vector<int>, Changes, int> rows[] = {
        {14, {kX}, {{16, kZ}, {14, kX}}, 15}, // X was action 16's
        {14, {kZ}, {}, 15},                   // its own key only moves the focus
        {23, {0x30}, {{23, 0x30}}, 22},       // a key no action has
        {17, {0x30}, {{17, 0x30}}, 19},       // the focus goes on by the table
        {10, {0x30}, {{10, 0x30}}, 11},
        {8, {kX, kZ}, {{14, 0x11}, {8, kZ}}, 23}, // the lower code of two
        {0, {kX}, {{16, 0x50}, {0, kX}}, 1},      // before any focus: hidden action 0
        {14, {0x01, 0x60}, {}, -1},               // ESCAPE, also with another key
        {14, {0x3B}, {}, -1},                     // F1 to F12
        {14, {0x44}, {}, -1},
        {14, {0x57}, {}, -1},
        {14, {0x58}, {}, -1},
        {14, {}, {}, -1},
        {24, {kX}, {}, -1},
        {-1, {kX}, {}, -1}};
    for (const auto& [focused, keysDown, changes, next] : rows)
    {
        std::uint8_t down[kKeyCodeCount] = {};
        for (int key : keysDown)
            down[key] = 1;
        const Capture capture = DecideKeyCapture(keys.keyboardKeys, focused, down);
        EXPECT_EQ(Outcome(capture), std::make_pair(changes, next)) << "focused " << int(focused);
        config::ConfigKeys stored = keys;
        std::int8_t focus = focused;
        ApplyKeyCapture(capture, stored.keyboardKeys, focus);
        for (const auto& [action, code] : changes)
            EXPECT_EQ(stored.keyboardKeys[action], code);
        EXPECT_EQ(focus, next < 0 ? focused : next);
    }
}

// Slot 0 holds the player's codes in its maps, so the slot button of the
// action that has a button goes down with it; other buttons are read raw.
TEST(PadCapture, AButtonIsExchangedWithItsActionOrStoredAloneAndSticksAreNever)
{
    const config::ConfigKeys keys = DefaultKeys();
    // The focused action, the action whose slot button went down (-1 none),
    // the raw buttons held, what changes, the next focus.
    const std::tuple<std::int8_t, int, std::vector<int>, Changes, int> rows[] = {
        {14, 0, {}, {{0, 14}, {14, 0}}, 15},      // the d-pad, hidden action 0's
        {14, 14, {}, {}, 15},                     // its own button only moves the focus
        {14, 16, {12}, {{16, 14}, {14, 16}}, 15}, // a slot button before a raw one
        {2, 2, {}, {}, 3},                        // the focus goes on by the table...
        {1, 14, {}, {{14, 1}, {1, 14}}, 14},      // ...and after an exchange it skips
        {2, 14, {}, {{14, 2}, {2, 14}}, 8},       // to the stick's push
        {9, 14, {}, {{14, 9}, {9, 14}}, 13},
        {12, 14, {}, {{14, 12}, {12, 14}}, 13},
        {9, -1, {12}, {{9, 24}}, 9}, // raw button 12 is BUTTON13
        {6, -1, {12}, {{6, 24}}, 7}, // stored alone, no skip to the push
        {4, -1, {12}, {{4, 24}}, 5},
        {15, -1, {0}, {}, -1},     // held, but action 14 has it
        {15, -1, {1, 12}, {}, -1}, // the lowest held button decides
        {14, 4, {12}, {}, -1},     // stick directions
        {14, 12, {12}, {}, -1},
        {14, -1, {}, {}, -1},
        {24, 16, {}, {}, -1},
        {-1, 16, {}, {}, -1}};
    for (const auto& [focused, pressed, held, changes, next] : rows)
    {
        InputSlot slot;
        ResetSlot(slot, 0, true);
        BindPlayerToSlot(keys.padConfigs[0].buttons, keys.padConfigs[0].device, slot);
        if (pressed >= 0)
            slot.pressed[kFirstVirtualButton + pressed] = 1;
        std::uint8_t raw[kCaptureJoyButtons] = {};
        for (int button : held)
            raw[button] = 1;
        const Capture capture = DecidePadCapture(keys.padConfigs[0].buttons, focused, slot, raw);
        EXPECT_EQ(Outcome(capture), std::make_pair(changes, next))
            << "focused " << int(focused) << " pressed " << pressed;

        // Stored, slot 0's maps follow the codes, and the captured button
        // counts as already down: held on, it presses no further action.
        config::PadConfig player = keys.padConfigs[0];
        std::int8_t focus = focused;
        ApplyPadCapture(capture, player.buttons, slot, focus);
        for (const auto& [action, code] : changes)
            EXPECT_EQ(std::make_pair(slot.joyMap[action], slot.xinputMap[action]),
                      std::make_pair(code, player.buttons[action]));
        EXPECT_EQ(focus, next < 0 ? focused : next);
        EXPECT_EQ(slot.current[kFirstVirtualButton + focused], changes.empty() ? 0u : 1u);
    }
}
