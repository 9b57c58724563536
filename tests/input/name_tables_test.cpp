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

// Where a key has several names, the first is shown; codes without a key and
// codes past either table show an empty text.
TEST(NameTables, KeysShowTheirPrimaryNamesAndGapsShowNothing)
{
    const NamedCode cases[] = {
        {0x00, ""},      {0x38, "LMENU"}, {0x3A, "CAPITAL"},     {0x54, ""}, {0x98, ""},
        {0xC9, "PRIOR"}, {0xD1, "NEXT"},  {0xED, "MEDIASELECT"}, {0xEE, ""}, {0xFC, ""},
    };
    for (const NamedCode& c : cases)
        EXPECT_STREQ(KeyName(static_cast<std::uint8_t>(c.code)), c.name) << "code " << c.code;

    int named = 0;
    for (std::size_t code = 0; code < input::kKeyNameCount; ++code)
        named += KeyName(static_cast<std::uint8_t>(code))[0] != '\0' ? 1 : 0;
    EXPECT_EQ(input::kKeyNameCount, 253u);
    EXPECT_EQ(named, 144);
}

TEST(NameTables, PadCodesFrom24CountOnFromButton13AndEndAt63)
{
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
