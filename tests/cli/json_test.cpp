// Where the JSON that vekcfg apply reads stops being JSON.
#include "cli/json.h"

#include <gtest/gtest.h>

namespace
{

TEST(Json, SaysWhereTheTextStopsBeingJson)
{
    const std::pair<std::string, std::string> rows[] = {
        {"{\"a\": 1, \"a\": 2}", "line 1, column 13: the member \"a\" is given twice"},
        {"[\"\\ud83d\"]", "line 1, column 9: a high surrogate without its low one"},
        {"{\n  \"a\": 01\n}", "line 2, column 9: ',' or '}' expected"},
    };
    for (const auto& [text, message] : rows)
    {
        cli::JsonValue root;
        std::string error;
        EXPECT_FALSE(cli::ReadJson(text, &root, &error)) << text;
        EXPECT_EQ(error, message) << text;
    }
}

} // namespace
