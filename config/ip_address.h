#pragma once

// What the network page decides about the texts it is given: octets of an
// address and the port, and how an address reads in each list.

#include "config/config_sections.h"

#include <cstdint>
#include <string>
#include <vector>

namespace config
{

// The text of one field of the IP entry dialog as a stored octet: "*" exactly
// is any value; any other text is its leading integer, accepted within 0..255
// and stored as three zero-padded digits, the rest of the octet zero. False
// for an empty text or a value out of range; `octet` is then unchanged.
bool ReadOctet(const char* text, char (&octet)[4]);

// The number a stored octet stands for ("*" and other text read as 0).
int OctetValue(const char (&octet)[4]);

// The 接続 list shows the numbers: 192.168.000.001 as 192.168.0.1, "*" as 0.
std::string ConnectLine(const IpEntry& entry);
// The 許可 and 拒否 lists show the octets as stored: 192.168.000.001, "*".
std::string ListedLine(const IpEntry& entry);

// The PORT text as a port: the low 16 bits of its leading integer, so 70000
// is 4464 and -1 is 65535.
std::uint16_t ReadPort(const char* text);

// The slot the next 接続 address goes to; -1 when all are taken.
int FirstEmptyConnectSlot(const ConfigNetwork& network);

// The slots the 接続 list shows, a line each in slot order: every filled slot
// and, while it stays free, the slot an all-zero address was last entered
// into (`enteredFreeSlot`, -1 for none). A line finds its slot here, also in a
// file written with free slots between filled ones.
std::vector<int> ListedConnectSlots(const ConfigNetwork& network, int enteredFreeSlot);

} // namespace config
