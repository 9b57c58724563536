// Captures on the key assignment pages: which codes change and where the
// focus goes.
#include "input/key_assignment.h"
#include "input/name_tables.h"

#include <algorithm>
#include <gtest/gtest.h>
#include <vector>

using namespace input;

namespace
{

constexpr std::uint8_t kZ = 0x2C;
constexpr std::uint8_t kX = 0x2D;

// The keyboard keys of a fresh settings file.
const std::uint32_t kDefaultKeys[kActionCount] = {
    0x50, 0x48, 0x4B, 0x4D, 0xC8, 0xD0, 0xCB, 0xCD, 0x11, 0x4F, 0x51, 0x47,
    0x49, 0x4C, 0x2C, 0x2F, 0x2D, 0x2E, 0x10, 0x1F, 0x1E, 0x20, 0x1C, 0x39,
};

config::ConfigKeys DefaultKeys()
{
    config::ConfigKeys keys = {};
    std::copy(std::begin(kDefaultKeys), std::end(kDefaultKeys), keys.keyboardKeys);
    for (config::PadConfig& player : keys.padConfigs)
    {
        for (int action = 0; action < kActionCount; ++action)
            player.buttons[action] = static_cast<std::uint32_t>(action);
    }
    return keys;
}

struct KeyPress
{
    std::uint8_t wentDown[kKeyCodeCount] = {};
    KeyPress(std::initializer_list<int> keys)
    {
        for (int key : keys)
            wentDown[key] = 1;
    }
};

std::vector<std::pair<int, std::uint32_t>> Changes(const Capture& capture)
{
    std::vector<std::pair<int, std::uint32_t>> changes;
    for (int i = 0; i < capture.changeCount; ++i)
        changes.emplace_back(capture.changes[i].action, capture.changes[i].code);
    return changes;
}

using ChangeList = std::vector<std::pair<int, std::uint32_t>>;

TEST(KeyCapture, AKeyOfAnotherActionIsExchangedAndTheFocusMovesOn)
{
    config::ConfigKeys keys = DefaultKeys();
    std::int8_t focused = 14;
    const Capture capture = DecideKeyCapture(keys.keyboardKeys, focused, KeyPress{kX}.wentDown);
    EXPECT_EQ(Changes(capture), (ChangeList{{16, kZ}, {14, kX}}));

    ApplyKeyCapture(capture, keys, focused);
    EXPECT_STREQ(KeyName(keys.keyboardKeys[14]), "X");
    EXPECT_STREQ(KeyName(keys.keyboardKeys[16]), "Z");
    EXPECT_EQ(focused, 15);
}

TEST(KeyCapture, TheActionsOwnKeyOnlyMovesTheFocus)
{
    config::ConfigKeys keys = DefaultKeys();
    std::int8_t focused = 14;
    const Capture capture = DecideKeyCapture(keys.keyboardKeys, focused, KeyPress{kZ}.wentDown);
    EXPECT_TRUE(capture.happened);
    EXPECT_EQ(capture.changeCount, 0);
    ApplyKeyCapture(capture, keys, focused);
    EXPECT_EQ(focused, 15);
    EXPECT_EQ(keys.keyboardKeys[14], kZ);
}

TEST(KeyCapture, AFreeKeyReplacesTheFocusedActionsKeyAlone)
{
    const Capture capture = DecideKeyCapture(kDefaultKeys, 23, KeyPress{0x30}.wentDown);
    EXPECT_EQ(Changes(capture), (ChangeList{{23, 0x30}}));
    EXPECT_EQ(capture.nextFocus, 22);
}

TEST(KeyCapture, EscapeAndFunctionKeysAreIgnoredEvenWithAnotherKey)
{
    for (int key : {0x01, 0x3B, 0x3C, 0x3D, 0x3E, 0x3F, 0x40, 0x41, 0x42, 0x43, 0x44, 0x57, 0x58})
    {
        EXPECT_FALSE(DecideKeyCapture(kDefaultKeys, 14, KeyPress{key}.wentDown).happened) << key;
        EXPECT_FALSE(DecideKeyCapture(kDefaultKeys, 14, KeyPress{key, 0x60}.wentDown).happened)
            << key;
    }
}

TEST(KeyCapture, OfTwoKeysTheLowerCodeIsTaken)
{
    const Capture capture = DecideKeyCapture(kDefaultKeys, 8, KeyPress{kX, kZ}.wentDown);
    EXPECT_EQ(Changes(capture), (ChangeList{{14, 0x11}, {8, kZ}}));
}

TEST(KeyCapture, BeforeAnyFocusTheKeyGoesToHiddenActionZero)
{
    config::ConfigKeys keys = DefaultKeys();
    std::int8_t focused = 0;
    ApplyKeyCapture(DecideKeyCapture(keys.keyboardKeys, focused, KeyPress{kX}.wentDown), keys,
                    focused);
    EXPECT_EQ(keys.keyboardKeys[0], kX);
    EXPECT_STREQ(KeyName(keys.keyboardKeys[16]), "NUMPAD2");
    EXPECT_EQ(focused, 1);
}

TEST(KeyCapture, NothingHappensWithoutAKeyOrAnAction)
{
    EXPECT_FALSE(DecideKeyCapture(kDefaultKeys, 14, KeyPress{}.wentDown).happened);
    for (std::int8_t focused : {-1, 24, 127})
        EXPECT_FALSE(DecideKeyCapture(kDefaultKeys, focused, KeyPress{kX}.wentDown).happened);

    config::ConfigKeys keys = DefaultKeys();
    std::int8_t focused = 14;
    ApplyKeyCapture(DecideKeyCapture(keys.keyboardKeys, focused, KeyPress{}.wentDown), keys,
                    focused);
    EXPECT_EQ(focused, 14);
}

std::vector<int> ReadingOrder(const std::int8_t (&order)[kActionCount], int first)
{
    std::vector<int> visited = {first};
    for (int action = order[first]; action != first && visited.size() <= kActionCount;
         action = order[action])
        visited.push_back(action);
    return visited;
}

TEST(FocusOrder, ShownBoxesAreVisitedInReadingOrderAndWrapAround)
{
    EXPECT_EQ(ReadingOrder(kKeyboardFocusOrder, 4),
              (std::vector<int>{4, 5, 6, 7, 14, 15, 16, 17, 19, 21, 18, 20, 8, 23, 22}));
    EXPECT_EQ(ReadingOrder(kPadFocusOrder, 14),
              (std::vector<int>{14, 15, 16, 17, 19, 21, 18, 20, 8, 23, 22}));
}

// Slot 0 as the controller page leaves it, with `owner`'s slot button
// pressed at this update when given.
struct PadPage
{
    config::ConfigKeys keys = DefaultKeys();
    InputSlot slot;
    std::uint8_t rawButtons[kCaptureJoyButtons] = {};

    PadPage()
    {
        ResetSlot(slot, 0, true);
        BindPlayerToSlot(keys.padConfigs[0], slot);
    }
    std::uint32_t (&codes())[kActionCount] { return keys.padConfigs[0].buttons; }
    Capture Decide(std::int8_t focused) const
    {
        return DecidePadCapture(keys.padConfigs[0].buttons, focused, slot, rawButtons);
    }
    void Press(int action) { slot.pressed[kFirstVirtualButton + action] = 1; }
};

TEST(PadCapture, StickDirectionsAreNeverCaptured)
{
    for (int direction : {4, 5, 6, 7, 9, 10, 11, 12})
    {
        PadPage page;
        page.Press(direction);
        page.rawButtons[12] = 1;
        EXPECT_FALSE(page.Decide(14).happened) << direction;
    }
}

TEST(PadCapture, TheDpadIsExchangedWithTheHiddenActionThatHadIt)
{
    PadPage page;
    std::int8_t focused = 14;
    page.Press(0);
    const Capture capture = page.Decide(focused);
    ApplyPadCapture(capture, page.keys.padConfigs[0], page.slot, focused);

    EXPECT_STREQ(PadButtonName(static_cast<std::uint8_t>(page.codes()[14])), "DP_UP");
    EXPECT_STREQ(PadButtonName(static_cast<std::uint8_t>(page.codes()[0])), "BUTTON1");
    EXPECT_EQ(page.slot.joyMap[14], 0u);
    EXPECT_EQ(page.slot.xinputMap[14], 0u);
    EXPECT_EQ(page.slot.joyMap[0], 14u);
    EXPECT_EQ(page.slot.xinputMap[0], 14u);
    EXPECT_EQ(page.slot.current[kFirstVirtualButton + 14], 1u);
    EXPECT_EQ(focused, 15);
}

TEST(PadCapture, TheFocusedActionsOwnButtonOnlyMovesTheFocus)
{
    PadPage page;
    page.Press(14);
    std::int8_t focused = 14;
    const Capture capture = page.Decide(focused);
    ApplyPadCapture(capture, page.keys.padConfigs[0], page.slot, focused);
    EXPECT_EQ(capture.changeCount, 0);
    EXPECT_EQ(focused, 15);
    EXPECT_EQ(page.slot.current[kFirstVirtualButton + 14], 0u);
}

TEST(PadCapture, AfterAnExchangeTheFocusSkipsToTheStickPush)
{
    struct Case
    {
        std::int8_t focused;
        int pressed;
        std::int8_t next;
    };
    const Case cases[] = {
        {14, 16, 15},
        {1, 14, 14},
        {2, 14, 8},
        {3, 14, 8},
        {6, 14, 8},
        {9, 14, 13},
        {12, 14, 13},
        {22, 14, 14},
        {0, 14, 1},
        // Without an exchange the table holds as it is.
        {2, 2, 3},
    };
    for (const Case& c : cases)
    {
        PadPage page;
        page.Press(c.pressed);
        EXPECT_EQ(page.Decide(c.focused).nextFocus, c.next)
            << "focused " << int(c.focused) << " pressed " << c.pressed;
    }

    PadPage raw;
    raw.rawButtons[12] = 1;
    EXPECT_EQ(raw.Decide(9).nextFocus, 9);
}

TEST(PadCapture, AnUnassignedRawButtonGivesItsFrameCodeToTheFocusedActionAlone)
{
    const std::pair<int, std::uint32_t> cases[] = {{4, 19}, {6, 18}, {12, 24}, {31, 43}};
    for (const auto& [button, code] : cases)
    {
        PadPage page;
        // Free the codes of the default assignment that the button feeds.
        page.codes()[18] = 40;
        page.codes()[19] = 41;
        page.rawButtons[button] = 1;
        std::int8_t focused = 15;
        const Capture capture = page.Decide(focused);
        EXPECT_EQ(Changes(capture), (ChangeList{{15, code}})) << "button " << button;
        ApplyPadCapture(capture, page.keys.padConfigs[0], page.slot, focused);
        EXPECT_EQ(page.slot.joyMap[15], code);
        EXPECT_EQ(page.slot.current[kFirstVirtualButton + 15], 1u);
        EXPECT_EQ(focused, 16);
    }
}

TEST(PadCapture, AHeldButtonThatAnActionHasStoresNothing)
{
    PadPage page;
    page.rawButtons[0] = 1; // BUTTON1, action 14's
    EXPECT_FALSE(page.Decide(15).happened);

    page.rawButtons[1] = 1; // the lowest held button decides
    page.rawButtons[12] = 1;
    EXPECT_FALSE(page.Decide(15).happened);
}

TEST(PadCapture, APressedSlotButtonComesBeforeRawButtons)
{
    PadPage page;
    page.rawButtons[12] = 1;
    page.Press(16);
    EXPECT_EQ(Changes(page.Decide(14)), (ChangeList{{16, 14}, {14, 16}}));
}

TEST(PadCapture, NothingHappensWithoutAButtonOrAnAction)
{
    PadPage page;
    EXPECT_FALSE(page.Decide(14).happened);
    page.Press(16);
    EXPECT_FALSE(page.Decide(-1).happened);
    EXPECT_FALSE(page.Decide(24).happened);
}

} // namespace
