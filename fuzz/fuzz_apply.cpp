// Everything a user can hand to `vekcfg apply` and `vekcfg set`, over a
// settings record: bytes → JSON → changes → record. An input that begins
// with "set\n" is instead one NAME=VALUE argument a line. Besides never
// crashing:
// - a refused input leaves the record's image as it was;
// - an accepted one never gives one key or button to two actions;
// - the saved image loads back to the same bytes;
// - applying the result's own `show --json` changes nothing.
#include "cli/json.h"
#include "cli/settings_change.h"
#include "cli/settings_report.h"
#include "config/save_config.h"
#include "fuzz/fuzz_support.h"

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

using fuzzing::Require;

namespace
{

bool Distinct(const std::uint32_t (&codes)[config::kActionCount])
{
    std::vector<std::uint32_t> sorted(codes, codes + config::kActionCount);
    std::sort(sorted.begin(), sorted.end());
    return std::adjacent_find(sorted.begin(), sorted.end()) == sorted.end();
}

// The changes the input asks for; false when it is refused before any
// change is made.
bool ReadChanges(std::string_view input, std::vector<cli::SettingChange>* changes)
{
    std::string refusal;
    const std::string_view setPrefix = "set\n";
    if (input.substr(0, setPrefix.size()) != setPrefix)
    {
        cli::Json tree;
        return cli::ReadJson(input, &tree, &refusal) &&
               cli::ChangesFromJson(tree, changes, &refusal);
    }
    input.remove_prefix(setPrefix.size());
    while (!input.empty())
    {
        const std::size_t end = std::min(input.find('\n'), input.size());
        cli::SettingChange change;
        if (!cli::ReadAssignment(std::string(input.substr(0, end)), &change))
            return false;
        changes->push_back(std::move(change));
        input.remove_prefix(std::min(end + 1, input.size()));
    }
    return true;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    std::vector<cli::SettingChange> changes;
    if (!ReadChanges(std::string_view(reinterpret_cast<const char*>(data), size), &changes))
        return 0;

    config::CSaveConfig record;
    record.ResetAll();
    const config::IpEntry entry{{"192", "168", "000", "*"}};
    Require(record.AddAllowEntry(entry) && record.AddConnectEntry(entry), "the starting lists");
    const std::vector<std::uint8_t> before = record.SaveToBytes();
    std::string refusal;
    if (!cli::ApplyChanges(record, changes, &refusal))
    {
        Require(!refusal.empty(), "a refusal says why");
        Require(record.SaveToBytes() == before, "a refused change left the record changed");
        return 0;
    }

    const config::ConfigKeys& keys = *record.Keys();
    Require(Distinct(keys.keyboardKeys), "one key on two actions");
    for (const config::PadConfig& player : keys.padConfigs)
        Require(Distinct(player.buttons), "one button on two actions");

    const std::vector<std::uint8_t> saved = record.SaveToBytes();
    config::CSaveConfig reloaded;
    Require(reloaded.LoadFromBytes(saved.data(), saved.size()) && reloaded.SaveToBytes() == saved,
            "the saved image loads back to the same bytes");

    const std::string shown =
        cli::SettingsJson(cli::DescribeSettings(record, "GameConfig.dat", config::kFileVersion));
    std::vector<cli::SettingChange> again;
    Require(ReadChanges(shown, &again), "show --json reads back");
    Require(cli::ApplyChanges(record, again, &refusal), "show --json applies");
    Require(record.SaveToBytes() == saved, "applying show --json changed the record");
    return 0;
}
