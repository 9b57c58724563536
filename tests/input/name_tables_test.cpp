// The texts shown for key codes and controller button codes.
#include "input/name_tables.h"
#include "input/pad_frame.h"

#include <gtest/gtest.h>
#include <string>

using input::KeyName;
using input::PadButtonName;

namespace
{

struct NamedCode
{
    int code;
    const char* name;
};

TEST(NameTables, KeyCodesShowTheirPrimaryNamesAndGapsShowNothing)
{
    const NamedCode cases[] = {
        {0x00, ""},
        {0x01, "ESCAPE"},
        {0x0B, "0"},
        {0x0E, "BACK"},
        {0x38, "LMENU"},
        {0x3A, "CAPITAL"},
        {0x44, "F10"},
        {0x4A, "SUBTRACT"},
        {0x4E, "ADD"},
        {0x53, "DECIMAL"},
        {0x54, ""},
        {0x56, "OEM_102"},
        {0x57, "F11"},
        {0x59, ""},
        {0x66, "F15"},
        {0x70, "KANA"},
        {0x8D, "NUMPADEQUALS"},
        {0x90, "PREVTRACK"},
        {0x97, "UNLABELED"},
        {0x98, ""},
        {0x9C, "NUMPADENTER"},
        {0xB5, "DIVIDE"},
        {0xB7, "SYSRQ"},
        {0xB8, "RMENU"},
        {0xC9, "PRIOR"},
        {0xD1, "NEXT"},
        {0xDD, "APPS"},
        {0xE3, "WAKE"},
        {0xE4, ""},
        {0xED, "MEDIASELECT"},
        {0xEE, ""},
        {0xFC, ""},
    };
    for (const NamedCode& c : cases)
        EXPECT_STREQ(KeyName(static_cast<std::uint8_t>(c.code)), c.name) << "code " << c.code;
}

TEST(NameTables, Names144KeysAmong253Codes)
{
    int named = 0;
    for (std::size_t code = 0; code < input::kKeyNameCount; ++code)
        named += KeyName(static_cast<std::uint8_t>(code))[0] != '\0' ? 1 : 0;
    EXPECT_EQ(input::kKeyNameCount, 253u);
    EXPECT_EQ(named, 144);
}

TEST(NameTables, PadCodesFrom24CountOnFromButton13AndEndAt63)
{
    const char* first24[] = {"DP_UP",    "DP_DOWN",  "DP_LEFT", "DP_RIGHT", "LS_UP",   "LS_DOWN",
                             "LS_LEFT",  "LS_RIGHT", "LS_PUSH", "RS_UP",    "RS_DOWN", "RS_LEFT",
                             "RS_RIGHT", "RS_PUSH",  "BUTTON1", "BUTTON2",  "BUTTON3", "BUTTON4",
                             "BUTTON7",  "BUTTON5",  "BUTTON8", "BUTTON6",  "BUTTON9", "BUTTON10"};
    for (int code = 0; code < 24; ++code)
        EXPECT_STREQ(PadButtonName(static_cast<std::uint8_t>(code)), first24[code]);
    for (int n = 0; n < 40; ++n)
        EXPECT_EQ(PadButtonName(static_cast<std::uint8_t>(24 + n)),
                  "BUTTON" + std::to_string(13 + n));
    for (int code : {64, 100, 255})
        EXPECT_STREQ(PadButtonName(static_cast<std::uint8_t>(code)), "");
}

// A DirectInput button b reaches the frame entry named after it ("BUTTON"
// b + 1), except the stick pushes on buttons 10 and 11.
TEST(NameTables, EveryDirectInputButtonShowsItsOwnNumber)
{
    for (int button = 0; button < input::kJoyFrameButtons; ++button)
    {
        const std::string expected = button == 10   ? "LS_PUSH"
                                     : button == 11 ? "RS_PUSH"
                                                    : "BUTTON" + std::to_string(button + 1);
        EXPECT_EQ(PadButtonName(input::JoyButtonCode(button)), expected) << "button " << button;
    }
}

} // namespace
