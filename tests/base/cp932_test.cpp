#include "base/cp932.h"

#include <gtest/gtest.h>

TEST(Cp932, TheLastBackslashIsNeverATrailByte)
{
    const struct
    {
        const char* text;
        int position; // -1: none
    } cases[] = {
        {"C:\\a\\b", 4},  {"C:\\ソ", 2},                 // 0x83 0x5C
        {"C:\\ソ\\x", 5}, {"ソ", -1},    {"a\\\x83", 1}, // a lead byte at the end stands alone
        {"", -1},
    };
    for (const auto& c : cases)
    {
        const char* last = base::FindLastCharacter(c.text, '\\');
        EXPECT_EQ(last == nullptr ? -1 : int(last - c.text), c.position) << c.text;
    }
}
