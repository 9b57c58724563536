#pragma once

// Just enough JSON to read vekcfg's own output back.

#include <string>
#include <utility>
#include <vector>

namespace cli_testing
{

struct JsonValue
{
    enum class Kind
    {
        Null,
        Boolean,
        Number,
        String,
        Array,
        Object,
    };

    Kind kind = Kind::Null;
    bool boolean = false;
    double number = 0.0;
    std::string string; // UTF-8
    std::vector<JsonValue> items;
    std::vector<std::pair<std::string, JsonValue>> members;

    // Null when there is no such member.
    const JsonValue* Member(const std::string& name) const;
};

// False unless `text` is exactly one JSON value (white space around it).
bool ParseJson(const std::string& text, JsonValue* value);

} // namespace cli_testing
