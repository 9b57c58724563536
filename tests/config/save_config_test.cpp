// The record's image, byte for byte, and its list operations.
#include "base/memory.h"
#include "config/save_config.h"

#include <algorithm>
#include <cstring>
#include <gtest/gtest.h>
#include <vector>

using config::CSaveConfig;
using config::IpEntry;

namespace
{

std::uint32_t U32At(const std::vector<std::uint8_t>& image, std::size_t offset)
{
    std::uint32_t value;
    std::memcpy(&value, image.data() + offset, sizeof value);
    return value;
}

IpEntry Entry(const char* a, const char* b, const char* c, const char* d)
{
    IpEntry entry{};
    std::strcpy(entry.octets[0], a);
    std::strcpy(entry.octets[1], b);
    std::strcpy(entry.octets[2], c);
    std::strcpy(entry.octets[3], d);
    return entry;
}

// Builds file images part by part.
struct Image
{
    std::vector<std::uint8_t> bytes;

    Image& U32(std::uint32_t value)
    {
        const auto* p = reinterpret_cast<const std::uint8_t*>(&value);
        bytes.insert(bytes.end(), p, p + 4);
        return *this;
    }
    Image& Fill(std::size_t count, std::uint8_t value)
    {
        bytes.insert(bytes.end(), count, value);
        return *this;
    }
    Image& Section(std::uint32_t length, std::uint8_t value)
    {
        return U32(length).Fill(length, value);
    }
};

CSaveConfig Defaults()
{
    CSaveConfig record;
    record.ResetAll();
    return record;
}

bool Load(CSaveConfig& record, const std::vector<std::uint8_t>& bytes)
{
    return record.LoadFromBytes(bytes.data(), bytes.size());
}

} // namespace

TEST(SaveConfigImage, DefaultsMakeA6876ByteImageWithEveryLengthWordInPlace)
{
    const std::vector<std::uint8_t> image = Defaults().SaveToBytes();
    ASSERT_EQ(image.size(), 6876u);
    EXPECT_EQ(U32At(image, 0), 0x13001000u);
    const std::pair<std::size_t, std::uint32_t> lengths[] = {
        {4, 20}, {28, 40}, {72, 472}, {548, 124}, {676, 5200}, {5880, 496}, {6380, 492}};
    for (auto [offset, length] : lengths)
        EXPECT_EQ(U32At(image, offset), length) << "at " << offset;
    EXPECT_EQ(image[8], 2);                        // screenSize
    EXPECT_EQ(U32At(image, 8 + 8), 1u);            // showMovie
    EXPECT_EQ(U32At(image, 8 + 16), 1u);           // trailQuality
    EXPECT_EQ(image[76] | image[77] << 8, 18000);  // port
    EXPECT_EQ(image[76 + 8], 1);                   // keyResponse
    EXPECT_EQ(U32At(image, 76 + 468), 1u);         // playBgm
    EXPECT_EQ(U32At(image, 552), 1u);              // saveReplays
    EXPECT_EQ(U32At(image, 5884), 0x50u);          // first keyboard key
    EXPECT_EQ(U32At(image, 5884 + 23 * 4), 0x39u); // last keyboard key
    for (int player = 0; player < 4; ++player)
    {
        EXPECT_EQ(U32At(image, 5884 + 96 + 100 * player + 4 * 7), 7u);
        EXPECT_EQ(image[5884 + 192 + 100 * player], player);
    }
}

TEST(SaveConfigImage, SavingTwoAllowEntriesPutsReplayLengthAt580)
{
    CSaveConfig record = Defaults();
    ASSERT_TRUE(record.AddAllowEntry(Entry("192", "168", "000", "001")));
    ASSERT_TRUE(record.AddAllowEntry(Entry("*", "*", "*", "*")));
    const std::vector<std::uint8_t> image = record.SaveToBytes();
    ASSERT_EQ(image.size(), 6908u);
    EXPECT_EQ(std::memcmp(image.data() + 548,
                          "192\0"
                          "168\0"
                          "000\0"
                          "001\0",
                          16),
              0);
    EXPECT_EQ(std::memcmp(image.data() + 564, "*\0\0\0*\0\0\0*\0\0\0*\0\0\0", 16), 0);
    EXPECT_EQ(U32At(image, 580), 124u);
}

TEST(SaveConfigImage, ImageRoundTripsEverySectionListAndPaddingByte)
{
    CSaveConfig record = Defaults();
    record.Graphics()->padding1[1] = 0xAB;
    record.Network()->padding459[0] = 0xCD;
    record.Keys()->padConfigs[3].padding97[2] = 0xEF;
    std::strcpy(record.UserBgm()->rows[9].tensionPath, "C:\\music\\表.txt");
    record.AddAllowEntry(Entry("001", "002", "003", "004"));
    record.AddDenyEntry(Entry("010", "*", "030", "040"));
    record.AddDenyEntry(Entry("050", "060", "070", "080"));
    const std::vector<std::uint8_t> image = record.SaveToBytes();

    CSaveConfig loaded;
    ASSERT_TRUE(Load(loaded, image));
    EXPECT_EQ(loaded.SaveToBytes(), image);
    EXPECT_EQ(loaded.Network()->denyCount, 2u);
    EXPECT_STREQ(loaded.GetDenyEntry(1)->octets[3], "080");
}

TEST(SaveConfigImage, VersionRules)
{
    const std::vector<std::uint8_t> current = Defaults().SaveToBytes();
    struct Case
    {
        std::uint32_t version;
        bool loads;
    } cases[] = {{0x13001000, true},
                 {0x12000000, true},
                 {0x10001000, true},
                 {0x13001001, false},
                 {0xFFFFFFFF, false}};
    for (const Case& c : cases)
    {
        std::vector<std::uint8_t> image = current;
        std::memcpy(image.data(), &c.version, 4);
        CSaveConfig record = Defaults();
        record.Graphics()->screenSize = 9;
        EXPECT_EQ(Load(record, image), c.loads) << std::hex << c.version;
        if (!c.loads)
        {
            EXPECT_EQ(record.Graphics()->screenSize, 9) << "a refused file leaves the record alone";
        }
    }
}

TEST(SaveConfigImage, FirstVersionDiscardsNetworkReplayRadioChatAndBothLists)
{
    CSaveConfig record = Defaults();
    record.Graphics()->screenSize = 7;
    record.Game()->bgmVolume = -1234;
    record.Network()->port = 1;
    record.AddAllowEntry(Entry("001", "002", "003", "004"));
    record.Replay()->replayLock[3] = 1;
    std::strcpy(record.UserBgm()->rows[0].musicPath, "a.ogg");
    record.Keys()->keyboardKeys[0] = 0x2D;
    record.RadioChat()->entries[0].notToAll = 1;
    std::vector<std::uint8_t> image = record.SaveToBytes();
    const std::uint32_t first = 0x10001000;
    std::memcpy(image.data(), &first, 4);

    CSaveConfig loaded;
    ASSERT_TRUE(Load(loaded, image));
    EXPECT_EQ(loaded.Graphics()->screenSize, 7);
    EXPECT_EQ(loaded.Game()->bgmVolume, -1234);
    EXPECT_STREQ(loaded.UserBgm()->rows[0].musicPath, "a.ogg");
    EXPECT_EQ(loaded.Keys()->keyboardKeys[0], 0x2Du);
    EXPECT_EQ(loaded.Network()->port, 18000);
    EXPECT_EQ(loaded.Network()->allowCount, 0u);
    EXPECT_EQ(loaded.Replay()->replayLock[3], 0u);
    EXPECT_EQ(loaded.RadioChat()->entries[0].notToAll, 0);
}

TEST(SaveConfigImage, ShortSectionsKeepDefaultsBeyondTheStoredBytes)
{
    // Every section two bytes long, holding 0x07 0x07.
    Image image;
    image.U32(0x13001000);
    for (int section = 0; section < 7; ++section)
        image.Section(2, 0x07);
    CSaveConfig record;
    ASSERT_TRUE(Load(record, image.bytes));
    EXPECT_EQ(record.Graphics()->screenSize, 7);
    EXPECT_EQ(record.Graphics()->showMovie, 1u);
    EXPECT_EQ(record.Game()->screenShake, 0x0707u);
    EXPECT_EQ(record.Network()->port, 0x0707);
    EXPECT_EQ(record.Network()->playBgm, 1u);
    EXPECT_EQ(record.Keys()->keyboardKeys[0], 0x0707u);
    EXPECT_EQ(record.Keys()->keyboardKeys[1], 0x48u);
    EXPECT_EQ(record.RadioChat()->entries[0].notToAll, 7);
}

TEST(SaveConfigImage, LongerSectionsAreCutToOursAndTheRestIsPassedOver)
{
    Image image;
    image.U32(0x13001000).Section(30, 0x01).Section(40, 0x02);
    CSaveConfig record;
    ASSERT_TRUE(Load(record, image.bytes));
    EXPECT_EQ(record.Graphics()->trailQuality, 0x01010101u);
    EXPECT_EQ(record.Game()->screenShake, 0x02020202u)
        << "the next section starts after the excess";
    EXPECT_EQ(record.Network()->port, 18000) << "an absent section keeps its defaults";
}

TEST(SaveConfigImage, TruncationKeepsWhatIsPresentAndDefaultsTheRest)
{
    CSaveConfig record = Defaults();
    std::strcpy(record.UserBgm()->rows[0].musicPath, "first.wav");
    std::strcpy(record.UserBgm()->rows[9].musicPath, "last.wav");
    record.Keys()->keyboardKeys[5] = 1;
    record.RadioChat()->entries[2].text[0] = 'x';
    const std::vector<std::uint8_t> full = record.SaveToBytes();

    // Cut inside the user-music section, after row 0, before row 9.
    std::vector<std::uint8_t> cut(full.begin(), full.begin() + 680 + 600);
    CSaveConfig loaded;
    ASSERT_TRUE(Load(loaded, cut));
    EXPECT_STREQ(loaded.UserBgm()->rows[0].musicPath, "first.wav");
    EXPECT_STREQ(loaded.UserBgm()->rows[9].musicPath, "");
    EXPECT_EQ(loaded.Keys()->keyboardKeys[5], 0xD0u);
    EXPECT_EQ(loaded.RadioChat()->entries[2].text[0], 0);

    // Cut at every boundary and inside every length word: never refused.
    for (std::size_t size = 4; size < full.size(); size += 1 + size / 7)
    {
        CSaveConfig partial;
        EXPECT_TRUE(Load(partial, std::vector<std::uint8_t>(full.begin(), full.begin() + size)))
            << size;
    }
}

TEST(SaveConfigImage, ListsThatRunPastTheEndMakeTheFileBad)
{
    CSaveConfig record = Defaults();
    record.AddAllowEntry(Entry("001", "002", "003", "004"));
    record.AddDenyEntry(Entry("005", "006", "007", "008"));
    const std::vector<std::uint8_t> image = record.SaveToBytes();

    struct Case
    {
        const char* name;
        std::size_t size;
        std::uint32_t allowCount;
    } cases[] = {
        {"cut inside the allow list", 548 + 8, 1},
        {"cut inside the deny list", 548 + 16 + 8, 1},
        {"a count beyond the file", image.size(), 1000},
        {"a count whose bytes overflow 32 bits", image.size(), 0x10000001},
        {"the largest count", image.size(), 0xFFFFFFFF},
    };
    for (const Case& c : cases)
    {
        std::vector<std::uint8_t> bad(image.begin(), image.begin() + c.size);
        std::memcpy(bad.data() + 76 + 460, &c.allowCount, 4);
        CSaveConfig target = Defaults();
        target.Graphics()->screenSize = 11;
        EXPECT_FALSE(Load(target, bad)) << c.name;
        EXPECT_EQ(target.Graphics()->screenSize, 11) << c.name;
    }
}

TEST(SaveConfigImage, AListThatCannotBeAllocatedMakesTheFileBad)
{
    CSaveConfig record = Defaults();
    record.AddAllowEntry(Entry("001", "002", "003", "004"));
    const std::vector<std::uint8_t> image = record.SaveToBytes();
    CSaveConfig target;
    base::ScopedAllocationFailure failure(0);
    EXPECT_FALSE(Load(target, image));
}

TEST(SaveConfigImage, ImageShorterThanItsVersionWordIsNotAFile)
{
    CSaveConfig record;
    EXPECT_FALSE(Load(record, {0x00, 0x10, 0x00}));
}

TEST(SaveConfigLists, AllowAndDenyListsGrowAndShrinkInOrder)
{
    CSaveConfig record = Defaults();
    for (int i = 0; i < 5; ++i)
    {
        const std::string octet = std::to_string(i);
        ASSERT_TRUE(record.AddAllowEntry(Entry(octet.c_str(), "0", "0", "0")));
    }
    EXPECT_FALSE(record.RemoveAllowEntry(-1));
    EXPECT_FALSE(record.RemoveAllowEntry(5));
    ASSERT_TRUE(record.RemoveAllowEntry(2));
    ASSERT_EQ(record.Network()->allowCount, 4u);
    const char* expected[] = {"0", "1", "3", "4"};
    for (std::uint32_t i = 0; i < 4; ++i)
        EXPECT_STREQ(record.GetAllowEntry(i)->octets[0], expected[i]);

    ASSERT_TRUE(record.AddDenyEntry(Entry("9", "9", "9", "9")));
    ASSERT_TRUE(record.RemoveDenyEntry(0));
    EXPECT_EQ(record.Network()->denyCount, 0u);
    EXPECT_EQ(record.SaveToBytes().size(), 6876u + 4 * 16) << "an emptied list writes no bytes";
}

TEST(SaveConfigLists, FailedAllocationLeavesTheListUnchanged)
{
    CSaveConfig record = Defaults();
    record.AddAllowEntry(Entry("1", "1", "1", "1"));
    record.AddAllowEntry(Entry("2", "2", "2", "2"));
    base::ScopedAllocationFailure failure(0);
    EXPECT_FALSE(record.AddAllowEntry(Entry("3", "3", "3", "3")));
    EXPECT_FALSE(record.RemoveAllowEntry(0));
    ASSERT_EQ(record.Network()->allowCount, 2u);
    EXPECT_STREQ(record.GetAllowEntry(0)->octets[0], "1");
    EXPECT_STREQ(record.GetAllowEntry(1)->octets[0], "2");
}

TEST(SaveConfigLists, ConnectSlotsFillTheFirstEmptyAndShiftOnRemoval)
{
    CSaveConfig record = Defaults();
    for (int i = 1; i <= 24; ++i)
        ASSERT_TRUE(record.AddConnectEntry(Entry(std::to_string(i).c_str(), "0", "0", "0")));
    EXPECT_FALSE(record.AddConnectEntry(Entry("99", "0", "0", "0")));
    ASSERT_TRUE(record.RemoveConnectEntry(0));
    EXPECT_STREQ(record.Network()->connectList[0].octets[0], "2");
    EXPECT_TRUE(config::IsConnectSlotEmpty(record.Network()->connectList[23]));
    EXPECT_FALSE(record.RemoveConnectEntry(-1));
    EXPECT_FALSE(record.RemoveConnectEntry(24));
    ASSERT_TRUE(record.AddConnectEntry(Entry("77", "0", "0", "0")));
    EXPECT_STREQ(record.Network()->connectList[23].octets[0], "77");
}

TEST(SaveConfigLists, ConnectSlotEmptinessFollowsAtoi)
{
    struct Case
    {
        IpEntry entry;
        bool empty;
    } cases[] = {
        {Entry("", "", "", ""), true},        {Entry("000", "000", "000", "000"), true},
        {Entry("*", "*", "*", "*"), true},    {Entry("000", "000", "000", "001"), false},
        {Entry("*", "*", "*", "010"), false}, {Entry("abc", "0", "x", "0"), true},
    };
    for (const Case& c : cases)
        EXPECT_EQ(config::IsConnectSlotEmpty(c.entry), c.empty)
            << c.entry.octets[0] << "." << c.entry.octets[3];
}

TEST(SaveConfigObject, ClonesAreDeepAndIdentifyThemselves)
{
    CSaveConfig record = Defaults();
    record.AddAllowEntry(Entry("1", "2", "3", "4"));
    CSaveConfig* clone = record.Clone();
    ASSERT_NE(clone, nullptr);
    EXPECT_NE(clone->GetAllowEntry(0), record.GetAllowEntry(0));
    EXPECT_EQ(clone->SaveToBytes(), record.SaveToBytes());
    record.RemoveAllowEntry(0);
    EXPECT_STREQ(clone->GetAllowEntry(0)->octets[0], "1");
    EXPECT_STREQ(clone->GetClassName(), "CSaveConfig");
    EXPECT_EQ(clone->GetClassSize(), sizeof(CSaveConfig));
    EXPECT_EQ(reinterpret_cast<std::uintptr_t>(clone) % 16, 0u);
    delete clone;
}

TEST(SaveConfigObject, ResetsTouchOnlyTheirFields)
{
    CSaveConfig record;
    record.Graphics()->padding13[0] = 0x5A;
    record.Keys()->padConfigs[2].buttons[4] = 99;
    record.Keys()->padConfigs[1].device = 3;
    record.ResetGraphics();
    EXPECT_EQ(record.Graphics()->padding13[0], 0x5A);
    record.ResetPadButtons(2);
    EXPECT_EQ(record.Keys()->padConfigs[2].buttons[4], 4u);
    EXPECT_EQ(record.Keys()->padConfigs[2].device, 2);
    EXPECT_EQ(record.Keys()->padConfigs[1].device, 3) << "other players keep their pad";
    EXPECT_FALSE(record.ResetPadButtons(4));
}

namespace
{

// A record with a value of its own in every section, to tell loaded
// sections from defaults.
CSaveConfig Marked()
{
    CSaveConfig record = Defaults();
    record.Graphics()->screenSize = 7;
    record.Game()->bgmVolume = -1234;
    record.Network()->port = 1;
    record.Replay()->replayLock[29] = 1;
    record.UserBgm()->rows[9].tensionPath[259] = 'x';
    record.Keys()->padConfigs[3].device = 0;
    record.RadioChat()->entries[11].text[39] = 'x';
    return record;
}

// Which sections of `record` hold the marks of Marked(), in file order.
std::vector<bool> MarkedSections(CSaveConfig& record)
{
    return {record.Graphics()->screenSize == 7,
            record.Game()->bgmVolume == -1234,
            record.Network()->port == 1,
            record.Replay()->replayLock[29] == 1,
            record.UserBgm()->rows[9].tensionPath[259] == 'x',
            record.Keys()->padConfigs[3].device == 0,
            record.RadioChat()->entries[11].text[39] == 'x'};
}

} // namespace

// A file cut at a section's length word, inside it or right after it keeps
// every section before and the defaults of that one and every later one.
TEST(SaveConfigImage, ACutAtEverySectionBoundaryKeepsTheSectionsBeforeIt)
{
    const std::vector<std::uint8_t> image = Marked().SaveToBytes();
    const std::size_t lengthWords[] = {4, 28, 72, 548, 676, 5880, 6380};
    for (std::size_t section = 0; section < 7; ++section)
    {
        for (const std::size_t cut :
             {lengthWords[section], lengthWords[section] + 2, lengthWords[section] + 4})
        {
            CSaveConfig loaded;
            ASSERT_TRUE(Load(loaded, std::vector<std::uint8_t>(image.begin(), image.begin() + cut)))
                << cut;
            std::vector<bool> expected(7, false);
            std::fill(expected.begin(), expected.begin() + static_cast<long>(section), true);
            EXPECT_EQ(MarkedSections(loaded), expected) << "cut at " << cut;
        }
    }
    CSaveConfig whole;
    ASSERT_TRUE(Load(whole, image));
    EXPECT_EQ(MarkedSections(whole), std::vector<bool>(7, true));
}

TEST(SaveConfigImage, HugeAndEmptySectionLengthsNeverReadPastTheFile)
{
    const std::vector<std::uint8_t> image = Marked().SaveToBytes();
    auto withLength = [&image](std::size_t offset, std::uint32_t length)
    {
        std::vector<std::uint8_t> changed = image;
        std::memcpy(changed.data() + offset, &length, 4);
        return changed;
    };
    struct Case
    {
        const char* what;
        std::vector<std::uint8_t> file;
        std::vector<bool> marked;
    };
    const Case cases[] = {
        {"graphics claiming 4 GiB - 1: the rest of the file is its excess",
         withLength(4, 0xFFFFFFFF),
         {true, false, false, false, false, false, false}},
        {"user music claiming 4 GiB - 1",
         withLength(676, 0xFFFFFFFF),
         {true, true, true, true, true, false, false}},
        {"radio chat claiming 4 GiB - 1",
         withLength(6380, 0xFFFFFFFF),
         {true, true, true, true, true, true, true}},
    };
    for (const Case& c : cases)
    {
        CSaveConfig loaded;
        ASSERT_TRUE(Load(loaded, c.file)) << c.what;
        EXPECT_EQ(MarkedSections(loaded), c.marked) << c.what;
    }

    Image empty;
    empty.U32(0x13001000).U32(0).Section(40, 0x02);
    CSaveConfig loaded;
    ASSERT_TRUE(Load(loaded, empty.bytes));
    EXPECT_EQ(loaded.Graphics()->screenSize, 2) << "a section of length 0 keeps its defaults";
    EXPECT_EQ(loaded.Game()->screenShake, 0x02020202u) << "and the next follows its length word";
}
