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
    for (std::size_t i = 0; i < segments && total <= size; ++i)
        total += data[kHeaderBytes + i];
    return total <= size ? total : 0;
}

} // namespace

std::size_t RepairOggChecksums(std::uint8_t* data, std::size_t size)
{
    std::size_t repaired = 0;
    for (std::size_t position = 0, page; position < size; position += page == 0 ? 1 : page)
    {
        page = PageSize(data + position, size - position);
        if (page == 0)
            continue;
        std::uint8_t* checksum = data + position + kChecksumOffset;
        // CRC-32 with the polynomial 0x04C11DB7, not reflected, starting from
        // 0, over the page with its checksum field zero.
        std::memset(checksum, 0, 4);
        std::uint32_t crc = 0;
        for (std::size_t i = 0; i < page; ++i)
        {
            crc ^= std::uint32_t(data[position + i]) << 24;
            for (int bit = 0; bit < 8; ++bit)
                crc = (crc & 0x80000000u) != 0 ? (crc << 1) ^ 0x04C11DB7u : crc << 1;
        }
        for (int i = 0; i < 4; ++i)
            checksum[i] = static_cast<std::uint8_t>(crc >> (8 * i));
        ++repaired;
    }
    return repaired;
}

std::vector<Bytes> SplitOggPages(const Bytes& stream)
{
    std::vector<Bytes> pages;
    for (std::size_t at = 0, size; (size = PageSize(stream.data() + at, stream.size() - at)) != 0;
         at += size)
        pages.emplace_back(stream.begin() + at, stream.begin() + at + size);
    return pages;
}

Bytes JoinOggPages(const std::vector<Bytes>& pages)
{
    Bytes out;
    for (const Bytes& page : pages)
        out.insert(out.end(), page.begin(), page.end());
    return out;
}

} // namespace testing_support
