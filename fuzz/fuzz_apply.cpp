// What `vekcfg apply` takes (JSON) and `vekcfg set` takes ("set\n", then one
// NAME=VALUE a line), over a record: a refusal leaves the record's image as
// it was; an accepted change gives no code to two actions, saves to an image
// that loads back the same, and its own `show --json` over the starting
// record gives it again, byte for byte.
#include "cli/json.h"
#include "cli/settings_change.h"
#include "cli/settings_report.h"
#include "fuzz/fuzz_support.h"

#include <algorithm>
#include <set>

using fuzzing::Require;

namespace
{

bool ReadChanges(std::string_view input, std::vector<cli::SettingChange>* changes)
{
    std::string refusal;
    cli::Json tree;
    if (!input.starts_with("set\n"))
        return cli::ReadJson(input, &tree, &refusal) &&
               cli::ChangesFromJson(tree, changes, &refusal);
    for (input.remove_prefix(4); !input.empty();)
    {
        const std::size_t end = std::min(input.find('\n'), input.size());
        if (!cli::ReadAssignment(std::string(input.substr(0, end)), &changes->emplace_back()))
            return false;
        input.remove_prefix(std::min(end + 1, input.size()));
    }
    return true;
}

config::CSaveConfig Start()
{
    config::CSaveConfig record;
    record.ResetAll();
    const config::IpEntry entry{{"192", "168", "000", "*"}};
    Require(record.AddAllowEntry(entry) && record.AddConnectEntry(entry), "the starting lists");
    return record;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    std::vector<cli::SettingChange> changes;
    if (!ReadChanges(std::string_view(reinterpret_cast<const char*>(data), size), &changes))
        return 0;
    config::CSaveConfig record = Start(), again = Start();
    const std::vector<std::uint8_t> before = record.SaveToBytes();
    std::string refusal;
    if (!cli::ApplyChanges(record, changes, &refusal))
    {
        Require(!refusal.empty() && record.SaveToBytes() == before, "a refusal changed the record");
        return 0;
    }
    const config::ConfigKeys& keys = *record.Keys();
    for (int player = -1; player < config::kPlayerCount; ++player)
    {
        const auto& codes = player < 0 ? keys.keyboardKeys : keys.padConfigs[player].buttons;
        Require(std::set(codes, codes + config::kActionCount).size() == config::kActionCount,
                "one code on two actions");
    }
    const std::vector<std::uint8_t> saved = record.SaveToBytes();
    config::CSaveConfig reloaded;
    Require(reloaded.LoadFromBytes(saved.data(), saved.size()) && reloaded.SaveToBytes() == saved,
            "the saved image loads back to the same bytes");
    std::vector<cli::SettingChange> shown;
    Require(ReadChanges(cli::SettingsJson(cli::DescribeSettings(record, "f", config::kFileVersion)),
                        &shown) &&
                cli::ApplyChanges(again, shown, &refusal) && again.SaveToBytes() == saved,
            "its own show --json over the start does not give it again");
    return 0;
}
