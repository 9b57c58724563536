// The JSON that vekcfg apply reads: what it takes, and where it says a text
// stops being JSON.
#include "cli/json.h"

#include <gtest/gtest.h>

namespace
{

std::string Utf8(const char8_t* text)
{
    return reinterpret_cast<const char*>(text);
}

TEST(Json, ReadsASettingsTreeWithItsEscapes)
{
    cli::JsonValue root;
    std::string error;
    ASSERT_TRUE(cli::ReadJson("{\"a\": [1, -20, 2.5, true, null],\n \"b\": {\"value\": "
                              "\"1280\\u00d7960 \\ud83d\\ude00\\n\"}}",
                              &root, &error))
        << error;
    const cli::JsonValue& list = *root.Member("a");
    ASSERT_EQ(list.items.size(), 5u);
    EXPECT_TRUE(list.items[1].whole);
    EXPECT_EQ(list.items[1].integer, -20);
    EXPECT_FALSE(list.items[2].whole);
    EXPECT_EQ(root.Member("b")->Member("value")->string,
              Utf8(u8"1280×960 ") + "\xF0\x9F\x98\x80\n");
}

TEST(Json, SaysWhereTheTextStopsBeingJson)
{
    const std::pair<std::string, std::string> cases[] = {
        {"{\"a\": 1,}", "line 1, column 9: a member name expected"},
        {"{\"a\": 1, \"a\": 2}", "line 1, column 13: the member \"a\" is given twice"},
        {"[\"\\ud83d\"]", "line 1, column 9: a high surrogate without its low one"},
        {"{\n  \"a\": 01\n}", "line 2, column 9: ',' or '}' expected"},
        {"[1] [2]", "line 1, column 5: more text after the value"},
        {"\"open", "line 1, column 6: the text ends inside a string"},
        {"", "line 1, column 1: the text ends where a value should be"},
    };
    for (const auto& [text, message] : cases)
    {
        cli::JsonValue value;
        std::string error;
        EXPECT_FALSE(cli::ReadJson(text, &value, &error)) << text;
        EXPECT_EQ(error, message) << text;
    }
}

} // namespace
