// The JSON that vekcfg apply reads: its escapes, and where it says a text
// stops being JSON.
#include "cli/json.h"

#include <gtest/gtest.h>

namespace
{

TEST(Json, ReadsEscapesAndSaysWhereTheTextStopsBeingJson)
{
    cli::JsonValue root;
    std::string error;
    ASSERT_TRUE(
        cli::ReadJson("{\"a\": [-20, 2.5], \"b\": \"\\u00d7\\ud83d\\ude00\\n\"}", &root, &error))
        << error;
    EXPECT_EQ(root.Member("a")->items[0].integer, -20);
    EXPECT_FALSE(root.Member("a")->items[1].whole);
    EXPECT_EQ(root.Member("b")->string, "\xC3\x97\xF0\x9F\x98\x80\n");

    const std::pair<std::string, std::string> rows[] = {
        {"{\"a\": 1, \"a\": 2}", "line 1, column 13: the member \"a\" is given twice"},
        {"[\"\\ud83d\"]", "line 1, column 9: a high surrogate without its low one"},
        {"{\n  \"a\": 01\n}", "line 2, column 9: ',' or '}' expected"},
        {"[1] [2]", "line 1, column 5: more text after the value"},
    };
    for (const auto& [text, message] : rows)
    {
        EXPECT_FALSE(cli::ReadJson(text, &root, &error)) << text;
        EXPECT_EQ(error, message) << text;
    }
}

} // namespace
