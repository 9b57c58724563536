#include "base/cp932.h"

#include <gtest/gtest.h>

// ソ is 0x83 0x5C; a lead byte at the end stands alone.
TEST(Cp932, TheLastBackslashIsNeverATrailByte)
{
    const std::pair<const char*, int> cases[] = {{"C:\\a\\b", 4}, {"C:\\ソ", 2},  {"C:\\ソ\\x", 5},
                                                 {"ソ", -1},      {"a\\\x83", 1}, {"", -1}};
    for (const auto& [text, position] : cases)
    {
        const char* last = base::FindLastCharacter(text, '\\');
        EXPECT_EQ(last == nullptr ? -1 : int(last - text), position) << text;
    }
}
