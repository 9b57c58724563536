// What the network page makes of the texts it is given.
#include "config/ip_address.h"

#include <climits>
#include <cstring>
#include <gtest/gtest.h>
#include <string>

using config::IpEntry;

namespace
{

// Octets as they lie in the record: four bytes each, zero after the text.
IpEntry Entry(const char* a, const char* b, const char* c, const char* d)
{
    IpEntry entry{};
    const char* texts[] = {a, b, c, d};
    for (int i = 0; i < 4; ++i)
        std::memcpy(entry.octets[i], texts[i], std::strlen(texts[i]));
    return entry;
}

std::string Bytes(const char* data, std::size_t size)
{
    return std::string(data, size);
}

} // namespace

TEST(IpOctet, AcceptedTextsAreStoredAsThreeDigitsOrTheWildcard)
{
    const std::pair<const char*, std::string> cases[] = {
        {"1", Bytes("001", 4)},   {"01", Bytes("001", 4)},  {"001", Bytes("001", 4)},
        {"abc", Bytes("000", 4)}, {"*", Bytes("*\0\0", 4)}, {"**", Bytes("000", 4)},
        {"0", Bytes("000", 4)},   {"255", Bytes("255", 4)}, {" +7x", Bytes("007", 4)},
    };
    for (const auto& [text, stored] : cases)
    {
        char octet[4] = {'9', '9', '9', '9'};
        EXPECT_TRUE(config::ReadOctet(text, octet)) << text;
        EXPECT_EQ(Bytes(octet, 4), stored) << text;
    }
}

TEST(IpOctet, EmptyAndOutOfRangeTextsAreRefusedAndLeaveTheOctet)
{
    for (const char* text : {"", "256", "-1", "999", "4294967296", "-4294967295"})
    {
        char octet[4] = {'1', '2', '3', '\0'};
        EXPECT_FALSE(config::ReadOctet(text, octet)) << text;
        EXPECT_STREQ(octet, "123") << text;
    }
}

TEST(LeadingInteger, ReadsAsAtoiAndSaturatesWhereAtoiWouldOverflow)
{
    const std::pair<const char*, int> cases[] = {
        {"", 0},
        {"-", 0},
        {" \t+12x", 12},
        {"-0", 0},
        {"x12", 0},
        {"2147483647", INT_MAX},
        {"2147483648", INT_MAX},
        {"-2147483648", INT_MIN},
        {"-2147483649", INT_MIN},
        {"99999999999999999999999", INT_MAX},
    };
    for (const auto& [text, value] : cases)
        EXPECT_EQ(config::ReadLeadingInteger(text), value) << text;
}

TEST(Port, IsTheLow16BitsOfTheLeadingInteger)
{
    const std::pair<const char*, int> cases[] = {
        {"70000", 4464}, {"-1", 65535}, {"", 0},         {"18000", 18000},
        {"abc", 0},      {"65536", 0},  {"8080x", 8080}, {"99999999999", 65535},
    };
    for (const auto& [text, port] : cases)
        EXPECT_EQ(config::ReadPort(text), port) << text;
}

TEST(AddressLines, ConnectShowsNumbersAndTheOtherListsTheStoredOctets)
{
    const struct
    {
        IpEntry entry;
        const char* connect;
        const char* listed;
    } cases[] = {
        {Entry("192", "168", "000", "001"), "192.168.0.1", "192.168.000.001"},
        {Entry("*", "010", "*", "255"), "0.10.0.255", "*.010.*.255"},
        {Entry("000", "000", "000", "000"), "0.0.0.0", "000.000.000.000"},
        // An octet from a file that fills all four bytes ends before its last.
        {Entry("1234", "5678", "9012", "3456"), "123.567.901.345", "123.567.901.345"},
    };
    for (const auto& c : cases)
    {
        EXPECT_EQ(config::ConnectLine(c.entry), c.connect);
        EXPECT_EQ(config::ListedLine(c.entry), c.listed);
    }
}

TEST(ConnectSlots, TheNextAddressTakesTheFirstSlotThatReadsAsAllZero)
{
    config::ConfigNetwork network{};
    EXPECT_EQ(config::FirstEmptyConnectSlot(network), 0);
    network.connectList[0] = Entry("010", "000", "000", "001");
    network.connectList[1] = Entry("*", "*", "*", "*");
    network.connectList[2] = Entry("000", "000", "000", "002");
    EXPECT_EQ(config::FirstEmptyConnectSlot(network), 1);
    for (IpEntry& slot : network.connectList)
        slot = Entry("001", "*", "*", "*");
    EXPECT_EQ(config::FirstEmptyConnectSlot(network), -1);
}
