#pragma once

// Ogg pages carry a checksum over their bytes, and a page whose checksum does
// not match is dropped before anything else looks at it. A test that changes
// a field of a page, and the fuzz mutator, repair the checksums afterwards so
// that the change reaches the decoder.
#include <cstddef>
#include <cstdint>
#include <vector>

namespace testing_support
{

using Bytes = std::vector<std::uint8_t>;

// Rewrites the checksum of every complete page ("OggS", header, segment
// table, body) found in `data`, skipping bytes between pages as the decoder
// does. Returns the number of pages repaired.
std::size_t RepairOggChecksums(std::uint8_t* data, std::size_t size);

// The pages at the start of an Ogg stream, each a complete page with its header.
std::vector<Bytes> SplitOggPages(const Bytes& stream);
Bytes JoinOggPages(const std::vector<Bytes>& pages);

} // namespace testing_support
