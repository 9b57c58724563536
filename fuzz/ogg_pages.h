#pragma once

// Ogg pages carry a checksum over their bytes; a mutated page whose checksum
// no longer matches is dropped by the decoder before anything else looks at
// it. Repairing the checksums lets the mutations reach the packets.
#include <cstddef>
#include <cstdint>

namespace fuzzing
{

// The checksum of Ogg pages: CRC-32 with the polynomial 0x04C11DB7, not
// reflected, starting from 0, over the page with its checksum field zero.
std::uint32_t OggPageChecksum(const std::uint8_t* page, std::size_t size);

// Rewrites the checksum of every complete page ("OggS", header, segment
// table, body) found in `data`, skipping bytes between pages as the decoder
// does. Returns the number of pages repaired.
std::size_t RepairOggChecksums(std::uint8_t* data, std::size_t size);

} // namespace fuzzing
