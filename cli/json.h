#pragma once

// JSON as vekcfg reads and writes it, through nlohmann-json: members keep
// their order, and what is printed is ASCII, every other character as a
// \u escape, so that it passes any console and pipe unchanged.

#include <cstddef>
#include <nlohmann/json.hpp>
#include <string>
#include <string_view>

namespace cli
{

using Json = nlohmann::ordered_json;

// The largest settings tree apply takes: far beyond what show prints for a
// settings file of the largest size vekcfg reads.
inline constexpr std::size_t kMaxJsonBytes = std::size_t(64) << 20;
// As deep as show's tree goes: the root, a section, a list, its element,
// a list in it and a value with its meaning.
inline constexpr int kMaxJsonDepth = 6;

// One JSON value in UTF-8, with white space around it. Refused, with the
// reason: anything larger than kMaxJsonBytes or nested deeper than
// kMaxJsonDepth, invalid UTF-8, a lone surrogate, and a member named twice
// in one object.
bool ReadJson(std::string_view text, Json* value, std::string* error);

// Two spaces of indent, ASCII only.
std::string WriteJson(const Json& value);

} // namespace cli
