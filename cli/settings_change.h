#pragma once

// What `vekcfg set` and `vekcfg apply` change in a record, checked against
// the record's field table before anything is written.

#include "cli/json.h"
#include "config/save_config.h"

#include <cstdint>
#include <string>
#include <vector>

namespace cli
{

struct SettingChange
{
    enum class Operation
    {
        Set,
        Add,
        Remove,
        ReplaceList,
    };

    // As given: "keys.padConfigs[1].buttons[14]".
    std::string name;
    Operation operation = Operation::Set;
    // A JSON number; otherwise `text` (UTF-8): a number, what a value means,
    // a field's text or an address.
    bool hasNumber = false;
    std::int64_t number = 0;
    std::string text;
    // ReplaceList: the addresses (UTF-8).
    std::vector<std::string> items;
};

// "NAME=VALUE", "NAME+=VALUE" or "NAME-=VALUE" (UTF-8). False without "=".
bool ReadAssignment(const std::string& argument, SettingChange* change);

// The changes a settings tree as `show --json` prints it makes, whole or
// in part: a value is a number, a text, or an object whose "value" counts
// (its "meaning" is only read past); a list replaces the whole list; an
// array of settings sets its first elements. "file" and "version" at the
// top are read past. False with the refusal (UTF-8).
bool ChangesFromJson(const Json& root, std::vector<SettingChange>* changes, std::string* refusal);

// Makes the changes in order on the record itself. False with the refusal
// (UTF-8), which names the setting and the values it allows; the record's
// image is then put back as it was.
bool ApplyChanges(config::CSaveConfig& record, const std::vector<SettingChange>& changes,
                  std::string* refusal);

} // namespace cli
