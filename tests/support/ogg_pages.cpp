#include "tests/support/ogg_pages.h"

#include <cstring>

namespace testing_support
{
namespace
{

constexpr std::size_t kHeaderBytes = 27;
constexpr std::size_t kChecksumOffset = 22;

// The page's whole size when a complete page starts at `data`, else 0.
std::size_t PageSize(const std::uint8_t* data, std::size_t size)
{
    if (size < kHeaderBytes || std::memcmp(data, "OggS", 4) != 0)
        return 0;
    const std::size_t segments = data[26];
    std::size_t total = kHeaderBytes + segments;
    if (total > size)
        return 0;
    for (std::size_t i = 0; i < segments; ++i)
        total += data[kHeaderBytes + i];
    return total <= size ? total : 0;
}

// CRC-32 with the polynomial 0x04C11DB7, not reflected, starting from 0,
// over the page with its checksum field zero.
std::uint32_t OggPageChecksum(const std::uint8_t* page, std::size_t size)
{
    std::uint32_t crc = 0;
    for (std::size_t i = 0; i < size; ++i)
    {
        const bool inChecksum = i >= kChecksumOffset && i < kChecksumOffset + 4;
        crc ^= std::uint32_t(inChecksum ? 0 : page[i]) << 24;
        for (int bit = 0; bit < 8; ++bit)
            crc = (crc & 0x80000000u) != 0 ? (crc << 1) ^ 0x04C11DB7u : crc << 1;
    }
    return crc;
}

} // namespace

std::size_t RepairOggChecksums(std::uint8_t* data, std::size_t size)
{
    std::size_t repaired = 0;
    std::size_t position = 0;
    while (position < size)
    {
        const std::size_t page = PageSize(data + position, size - position);
        if (page == 0)
        {
            ++position;
            continue;
        }
        const std::uint32_t crc = OggPageChecksum(data + position, page);
        for (int i = 0; i < 4; ++i)
            data[position + kChecksumOffset + i] = static_cast<std::uint8_t>(crc >> (8 * i));
        ++repaired;
        position += page;
    }
    return repaired;
}

} // namespace testing_support
