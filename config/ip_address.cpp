#include "config/ip_address.h"

#include "base/c_runtime.h"
#include "config/fixed_text.h"
#include "config/save_config.h"

#include <cstdio>
#include <cstring>

namespace config
{

bool ReadOctet(const char* text, char (&octet)[4])
{
    if (text[0] == '\0')
        return false;
    if (std::strcmp(text, "*") == 0)
    {
        std::memset(octet, 0, sizeof octet);
        octet[0] = '*';
        return true;
    }
    const int value = base::ReadLeadingInteger(text);
    if (value < 0 || value > 255)
        return false;
    std::snprintf(octet, sizeof octet, "%3.3d", value);
    return true;
}

int OctetValue(const char (&octet)[4])
{
    return base::ReadLeadingInteger(FieldText(octet).c_str());
}

std::string ConnectLine(const IpEntry& entry)
{
    char line[64];
    std::snprintf(line, sizeof line, "%d.%d.%d.%d", OctetValue(entry.octets[0]),
                  OctetValue(entry.octets[1]), OctetValue(entry.octets[2]),
                  OctetValue(entry.octets[3]));
    return line;
}

std::string ListedLine(const IpEntry& entry)
{
    return FieldText(entry.octets[0]) + "." + FieldText(entry.octets[1]) + "." +
           FieldText(entry.octets[2]) + "." + FieldText(entry.octets[3]);
}

std::uint16_t ReadPort(const char* text)
{
    return static_cast<std::uint16_t>(static_cast<unsigned int>(base::ReadLeadingInteger(text)));
}

int FirstEmptyConnectSlot(const ConfigNetwork& network)
{
    for (int slot = 0; slot < kConnectSlotCount; ++slot)
    {
        if (IsConnectSlotEmpty(network.connectList[slot]))
            return slot;
    }
    return -1;
}

std::vector<int> ListedConnectSlots(const ConfigNetwork& network, int enteredFreeSlot)
{
    std::vector<int> slots;
    for (int slot = 0; slot < kConnectSlotCount; ++slot)
    {
        if (slot == enteredFreeSlot || !IsConnectSlotEmpty(network.connectList[slot]))
            slots.push_back(slot);
    }
    return slots;
}

} // namespace config
