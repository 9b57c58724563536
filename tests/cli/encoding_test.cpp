// The conversion every printed text goes through.
#include "cli/encoding.h"
#include "tests/cli/vekcfg_runner.h"

#include <gtest/gtest.h>

namespace
{

using cli_testing::Utf8;

TEST(Utf8FromCp932, MapsTheToolsTextsAndReplacesWhatTheCodePageLacksOneCharacterEach)
{
    const std::pair<std::string, std::string> cases[] = {
        {"表示", Utf8(u8"表示")},              // a trail byte 5C is no backslash
        {"\x81\x60", Utf8(u8"\uFF5E")},        // the tilde of the messages
        {"\x81\x7E", Utf8(u8"×")},             // the resolutions' sign
        {"\xB1\xB2", Utf8(u8"\uFF71\uFF72")},  // half-width katakana
        {"C:\\a~b", "C:\\a~b"},                // ASCII stays ASCII
        {"a\x81", "a" + Utf8(u8"\uFFFD")},     // a lead byte at the end
        {"\x81\"x", Utf8(u8"\uFFFD") + "\"x"}, // a lead byte before a non-trail
        {"\x85\x40z", Utf8(u8"\uFFFD") + "z"}, // an unassigned pair is one character
        {std::string("a\0b", 3), std::string("a\0b", 3)},
    };
    for (const auto& [cp932, utf8] : cases)
        EXPECT_EQ(cli::Utf8FromCp932(cp932), utf8) << utf8;
}

} // namespace
