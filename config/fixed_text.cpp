#include "config/fixed_text.h"

#include "base/cp932.h"

#include <cstdint>
#include <cstring>

namespace config
{

std::string FieldText(const char* field, std::size_t capacity)
{
    const std::size_t readable = capacity > 0 ? capacity - 1 : 0;
    const void* end = std::memchr(field, '\0', readable);
    return std::string(field, end != nullptr ? static_cast<const char*>(end) - field : readable);
}

std::size_t KeptTextLength(std::string_view text, std::size_t limit)
{
    // Only a walk from the start tells lead bytes from trail bytes: many
    // trail bytes lie in the lead-byte range.
    std::size_t kept = 0;
    while (kept < text.size() && text[kept] != '\0')
    {
        const bool lead = base::IsLeadByte(static_cast<std::uint8_t>(text[kept]));
        const std::size_t next = kept + (lead ? 2 : 1);
        if (next > text.size() || next > limit || (lead && text[kept + 1] == '\0'))
            break;
        kept = next;
    }
    return kept;
}

void StoreFieldText(char* field, std::size_t capacity, std::size_t limit, std::string_view text)
{
    const std::size_t kept = KeptTextLength(text, limit < capacity ? limit : capacity - 1);
    std::memcpy(field, text.data(), kept);
    std::memset(field + kept, 0, capacity - kept);
}

} // namespace config
