#pragma once

// What `vekcfg show` prints: every setting of a record by the name the field
// table gives it, with its value and what the value means to the tool (the
// texts of the choices, volumes in decibels, key and button names per
// action; addresses as stored, and for the 接続 list as the page lists them).

#include "config/save_config.h"

#include <cstdint>
#include <string>
#include <vector>

namespace cli
{

struct Setting
{
    enum class Kind
    {
        Group,
        List,
        Number,
        Text,
    };

    Kind kind = Kind::Group;
    // Empty for the elements of a list.
    std::string name;
    long long number = 0;
    // UTF-8, as is the meaning.
    std::string text;
    std::string meaning;
    std::vector<Setting> children;
};

// The whole record as a tree; `path` (as the command line gave it) and the
// file's version word come first.
Setting DescribeSettings(const config::CSaveConfig& record, const std::string& path,
                         std::uint32_t version);

// One line per setting: "graphics.screenSize = 2 (1024×768)". Texts are
// quoted, control characters written as escapes; an empty list reads
// "(none)".
std::string SettingsText(const Setting& root);

// The same tree as JSON (UTF-8): groups are objects, lists arrays, and a
// value with a meaning an object {"value": ..., "meaning": "..."}.
std::string SettingsJson(const Setting& root);

} // namespace cli
