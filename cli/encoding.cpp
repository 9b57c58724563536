#include "cli/encoding.h"

#include "base/cp932.h"

#include <cstdint>

namespace cli
{
namespace
{

bool IsTrailByte(std::uint8_t byte)
{
    return byte >= 0x40 && byte <= 0xFC && byte != 0x7F;
}

} // namespace

std::size_t Cp932CharacterSize(std::string_view text)
{
    if (text.empty())
        return 0;
    const auto first = static_cast<std::uint8_t>(text[0]);
    if (base::IsLeadByte(first) && text.size() >= 2 &&
        IsTrailByte(static_cast<std::uint8_t>(text[1])))
        return 2;
    return 1;
}

} // namespace cli
