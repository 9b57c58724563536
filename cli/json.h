#pragma once

// A small, strict reader of JSON (UTF-8) for the settings trees that
// `vekcfg apply` takes: one value with white space around it; no comments,
// no trailing commas, no duplicate member names, no lone surrogates.

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

namespace cli
{

struct JsonMember;

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
    // A number without fraction or exponent that fits is whole.
    bool whole = false;
    std::int64_t integer = 0;
    // The number as written, for messages.
    std::string number;
    std::string string;
    std::vector<JsonValue> items;
    std::vector<JsonMember> members;

    // Null when there is no such member.
    const JsonValue* Member(std::string_view name) const;
};

struct JsonMember
{
    std::string name;
    JsonValue value;
};

// False with the reason ("line 3, column 7: ...") when `text` is not one
// JSON value.
bool ReadJson(std::string_view text, JsonValue* value, std::string* error);

} // namespace cli
