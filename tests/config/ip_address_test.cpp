// What the network and game pages make of the texts and positions they are
// given.
#include "config/ip_address.h"
#include "config/volume.h"

#include <cstring>
#include <gtest/gtest.h>
#include <string>

TEST(IpOctet, TextsAreStoredAsThreeDigitsOrTheWildcardOrRefused)
{
    const std::pair<const char*, const char*> accepted[] = {
        {"1", "001"},  {"001", "001"}, {"abc", "000"}, {"*", "*\0\0"},
        {"**", "000"}, {"255", "255"}, {" +7x", "007"}};
    for (const auto& [text, stored] : accepted)
    {
        char octet[4] = {'9', '9', '9', '9'};
        EXPECT_TRUE(config::ReadOctet(text, octet)) << text;
        EXPECT_EQ(std::string(octet, 4), std::string(stored, 4)) << text;
    }
    for (const char* refused : {"", "256", "-1", "4294967296", "-4294967295"})
    {
        char octet[4] = "123";
        EXPECT_FALSE(config::ReadOctet(refused, octet)) << refused;
        EXPECT_STREQ(octet, "123") << refused;
    }
}

// The port keeps the low 16 bits of what atoi reads.
TEST(Port, KeepsTheLow16Bits)
{
    for (const auto& [text, port] :
         {std::pair{"70000", 4464}, {"-1", 65535}, {"99999999999", 65535}})
        EXPECT_EQ(config::ReadPort(text), port) << text;
}

// The 接続 list shows numbers, the others the octets as stored; an octet
// from a file that fills all four bytes ends before its last. A line of the
// 接続 list stands for a slot: each filled one, and a free one while it
// holds the all-zero address just entered.
TEST(AddressLines, ConnectShowsTheFilledSlotsAsNumbersAndTheOtherListsTheStoredOctets)
{
    config::IpEntry entry{};
    const char* typed[] = {"192", "168", "0", "*"};
    for (int i = 0; i < 4; ++i)
        ASSERT_TRUE(config::ReadOctet(typed[i], entry.octets[i]));
    EXPECT_EQ(config::ConnectLine(entry), "192.168.0.0");
    EXPECT_EQ(config::ListedLine(entry), "192.168.000.*");
    std::memcpy(&entry, "1234567890123456", sizeof entry);
    EXPECT_EQ(config::ConnectLine(entry), "123.567.901.345");
    EXPECT_EQ(config::ListedLine(entry), "123.567.901.345");
    config::ConfigNetwork network{};
    std::memcpy(&network.connectList[2], "001", 4);
    std::memcpy(&network.connectList[5], "002", 4);
    EXPECT_EQ(config::ListedConnectSlots(network, -1), (std::vector<int>{2, 5}));
    EXPECT_EQ(config::ListedConnectSlots(network, 0), (std::vector<int>{0, 2, 5}));
}

TEST(VolumeSlider, OnlyTheLeftEndMeansSilence)
{
    for (const auto& [position, volume] : {std::pair{-3000, -10000}, {-2999, -2999}, {0, 0}})
        EXPECT_EQ(config::VolumeAtSliderPosition(position), volume);
}
