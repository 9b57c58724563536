// The record's file image and its list operations.
#include "base/memory.h"
#include "config/ip_address.h"
#include "config/save_config.h"

#include <cstring>
#include <gtest/gtest.h>
#include <memory>
#include <string>
#include <tuple>

using config::CSaveConfig;
using config::IpEntry;
using Bytes = std::vector<std::uint8_t>;

namespace
{

// An address with the given first and last octets, the middle ones unset.
IpEntry Entry(const char* first, const char* last = "")
{
    IpEntry entry{};
    std::memcpy(entry.octets[0], first, std::strlen(first));
    std::memcpy(entry.octets[3], last, std::strlen(last));
    return entry;
}

CSaveConfig Defaults()
{
    CSaveConfig record;
    record.ResetAll();
    return record;
}

// A value of its own in every section, in padding and in both lists.
CSaveConfig Marked()
{
    CSaveConfig record = Defaults();
    record.Graphics()->padding1[1] = 0xAB;
    record.Game()->bgmVolume = -1234;
    record.Network()->port = 1;
    record.AddAllowEntry(Entry("001", "004"));
    record.AddDenyEntry(Entry("*", "*"));
    record.AddDenyEntry(Entry("050"));
    record.Replay()->replayLock[29] = 1;
    std::strcpy(record.UserBgm()->rows[0].musicPath, "first.wav");
    std::strcpy(record.UserBgm()->rows[9].tensionPath, "C:\\music\\表.txt");
    record.Keys()->padConfigs[3].padding97[2] = 0xEF;
    record.RadioChat()->entries[11].text[39] = 'x';
    return record;
}

std::uint32_t U32At(const Bytes& image, std::size_t offset)
{
    std::uint32_t value;
    std::memcpy(&value, image.data() + offset, sizeof value);
    return value;
}

} // namespace

TEST(SaveConfigImage, TheGameFindsEverySectionWhereItLooks)
{
    const Bytes image = Defaults().SaveToBytes();
    ASSERT_EQ(image.size(), 6876u);
    const std::pair<std::size_t, std::uint32_t> words[] = {{0, 0x13001000}, {4, 20},    {28, 40},
                                                           {72, 472},       {548, 124}, {676, 5200},
                                                           {5880, 496},     {6380, 492}};
    for (auto [offset, value] : words)
        EXPECT_EQ(U32At(image, offset), value) << "at " << offset;

    const CSaveConfig marked = Marked(); // one allow and two deny entries
    const Bytes listed = marked.SaveToBytes();
    EXPECT_EQ(std::memcmp(listed.data() + 548, marked.GetAllowEntry(0), 16), 0);
    EXPECT_EQ(std::memcmp(listed.data() + 564, marked.GetDenyEntry(0), 32), 0);
    EXPECT_EQ(U32At(listed, 596), 124u);
}

// A file loads to the record it saves back as; a refused one (no record
// given) leaves the record as it was.
TEST(SaveConfigImage, LoadingKeepsWhatTheFileHoldsAndDefaultsTheRest)
{
    const Bytes marked = Marked().SaveToBytes();
    const auto with = [&marked](std::size_t offset, std::uint32_t value)
    {
        Bytes changed = marked;
        std::memcpy(changed.data() + offset, &value, 4);
        return changed;
    };
    const auto cut = [&marked](std::size_t size)
    { return Bytes(marked.begin(), marked.begin() + size); };
    // Graphics longer than ours (30 bytes of 1), the game section shorter
    // (2 bytes of 2), and the end of the file.
    Bytes odd{0x00, 0x10, 0x00, 0x13, 30, 0, 0, 0};
    odd.insert(odd.end(), 30, 1);
    odd.insert(odd.end(), {2, 0, 0, 0, 2, 2});

    CSaveConfig firstVersion = Marked(), oddLoaded = Defaults(), cutInMusic = Marked();
    firstVersion.ResetNetwork();
    firstVersion.ResetReplay();
    firstVersion.ResetRadioChat();
    std::memset(oddLoaded.Graphics(), 1, 20);
    std::memset(oddLoaded.Game(), 2, 2);
    std::memset(&cutInMusic.UserBgm()->rows[1], 0, 9 * sizeof(config::UserBgmRow));
    *cutInMusic.Keys() = *Defaults().Keys();
    *cutInMusic.RadioChat() = {};

    // What the file is, its bytes and the record loaded from it (none: refused).
    const std::tuple<const char*, Bytes, Bytes> rows[] = {
        {"the current version", marked, marked},
        {"the first version drops network, replay, radio chat and lists", with(0, 0x10001000),
         firstVersion.SaveToBytes()},
        {"long sections are cut, short ones keep the defaults beyond", odd,
         oddLoaded.SaveToBytes()},
        {"a cut inside the user music keeps the rows before it", cut(680 + 48 + 600),
         cutInMusic.SaveToBytes()},
        {"a newer version", with(0, 0x13001001), {}},
        {"a list that runs past the end", cut(548 + 8), {}},
        {"a list count whose bytes overflow 32 bits", with(76 + 460, 0x10000001), {}},
        {"shorter than its version word", Bytes{0x00, 0x10, 0x00}, {}}};
    for (const auto& [what, file, loaded] : rows)
    {
        CSaveConfig record = Marked();
        record.Graphics()->screenSize = 11;
        const Bytes before = record.SaveToBytes();
        EXPECT_EQ(record.LoadFromBytes(file.data(), file.size()), !loaded.empty()) << what;
        EXPECT_EQ(record.SaveToBytes(), loaded.empty() ? before : loaded) << what;
    }
}

// Allow and deny lists keep their order; connect slots fill the first empty
// one and shift on removal.
TEST(SaveConfigLists, EntriesComeAndGoInOrderOrNotAtAll)
{
    CSaveConfig record = Defaults();
    for (const char* octet : {"0", "1", "2", "3"})
        ASSERT_TRUE(record.AddAllowEntry(Entry(octet)));
    for (int i = 1; i <= 24; ++i)
        ASSERT_TRUE(record.AddConnectEntry(Entry(std::to_string(i).c_str())));
    EXPECT_FALSE(record.AddConnectEntry(Entry("99")));
    EXPECT_EQ(config::FirstEmptyConnectSlot(*record.Network()), -1);
    EXPECT_FALSE(record.RemoveAllowEntry(-1) || record.RemoveAllowEntry(4) ||
                 record.RemoveConnectEntry(-1) || record.RemoveConnectEntry(24));
    ASSERT_TRUE(record.RemoveAllowEntry(1) && record.RemoveConnectEntry(0));
    ASSERT_EQ(record.Network()->allowCount, 3u);
    EXPECT_STREQ(record.GetAllowEntry(1)->octets[0], "2");
    EXPECT_STREQ(record.GetAllowEntry(2)->octets[0], "3");
    EXPECT_STREQ(record.Network()->connectList[0].octets[0], "2");
    EXPECT_EQ(config::FirstEmptyConnectSlot(*record.Network()), 23);
    for (const IpEntry& empty : {Entry("000", "000"), Entry("*", "*"), Entry("abc", "x")})
        EXPECT_TRUE(config::IsConnectSlotEmpty(empty)) << config::ListedLine(empty);
    EXPECT_FALSE(config::IsConnectSlotEmpty(Entry("*", "010")));
    ASSERT_TRUE(record.AddDenyEntry(Entry("9")) && record.RemoveDenyEntry(0));
    EXPECT_EQ(record.SaveToBytes().size(), 6876u + 3 * 16) << "an emptied list writes nothing";

    const Bytes before = record.SaveToBytes();
    base::ScopedAllocationFailure failure(0);
    EXPECT_FALSE(record.AddAllowEntry(Entry("4")) || record.RemoveAllowEntry(0));
    EXPECT_FALSE(record.LoadFromBytes(before.data(), before.size()));
    EXPECT_EQ(record.SaveToBytes(), before) << "a failed allocation changes nothing";
}

TEST(SaveConfigObject, ClonesAreDeepAndResetsTouchOnlyTheirFields)
{
    CSaveConfig record = Marked();
    const std::unique_ptr<CSaveConfig> clone(record.Clone());
    ASSERT_NE(clone, nullptr);
    EXPECT_EQ(clone->SaveToBytes(), record.SaveToBytes());
    record.RemoveAllowEntry(0);
    EXPECT_STREQ(clone->GetAllowEntry(0)->octets[0], "001");

    record.Keys()->padConfigs[1].device = 3;
    record.Keys()->padConfigs[2].buttons[4] = 99;
    EXPECT_TRUE(record.ResetPadButtons(2));
    EXPECT_EQ(record.Keys()->padConfigs[2].buttons[4], 4u);
    EXPECT_EQ(record.Keys()->padConfigs[2].device, 2);
    EXPECT_EQ(record.Keys()->padConfigs[1].device, 3) << "other players keep their pad";
    EXPECT_FALSE(record.ResetPadButtons(4));
    EXPECT_TRUE(record.ResetGame() && record.ResetUserBgm() && record.ResetRadioChat());
    CSaveConfig reset = Marked();
    reset.ResetAll();
    EXPECT_EQ(reset.RadioChat()->entries[11].text[39], 0) << "a reset empties the texts";
}
