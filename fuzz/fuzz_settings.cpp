// The settings-file loader over any bytes. Besides never crashing:
// - a refused file leaves the record as it was (nothing of the user's is lost);
// - an accepted file gives a record that saves to an image of the exact
//   length, which loads back to the same record, and whose clone is equal.
#include "config/save_config.h"
#include "fuzz/fuzz_support.h"

#include <cstddef>
#include <cstdint>
#include <vector>

using fuzzing::Require;

namespace
{

// A record that is not all defaults, so that a change by a refused load shows.
const config::CSaveConfig& Previous()
{
    static const config::CSaveConfig record = []
    {
        config::CSaveConfig made;
        made.ResetAll();
        const config::IpEntry entry{{"192", "168", "000", "*"}};
        made.AddAllowEntry(entry);
        made.AddDenyEntry(entry);
        made.Graphics()->screenSize = 7;
        return made;
    }();
    return record;
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    const std::vector<std::uint8_t> before = Previous().SaveToBytes();
    config::CSaveConfig* record = Previous().Clone();
    Require(record != nullptr, "clone of the previous record");
    if (!record->LoadFromBytes(data, size))
    {
        Require(record->SaveToBytes() == before, "a refused file changed the record");
        delete record;
        return 0;
    }

    const std::vector<std::uint8_t> saved = record->SaveToBytes();
    const config::ConfigNetwork& network = *record->Network();
    Require(saved.size() == 6876 + 16 * (std::size_t(network.allowCount) + network.denyCount),
            "the saved image has the length its counts give");
    config::CSaveConfig reloaded;
    Require(reloaded.LoadFromBytes(saved.data(), saved.size()), "the saved image loads");
    Require(reloaded.SaveToBytes() == saved, "the saved image loads to the same record");
    config::CSaveConfig* clone = record->Clone();
    Require(clone != nullptr && clone->SaveToBytes() == saved, "a clone is equal");
    delete clone;
    delete record;
    return 0;
}
