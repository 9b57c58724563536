#pragma once

// What the user music page decides without a window: which row and which
// control an identifier names, and how a path goes into and out of its
// record field.

#include "config/config_sections.h"
#include "resources/resource.h"

#include <cstring>
#include <optional>
#include <string>

namespace dialog
{

// The four controls of a row, in the order of their identifiers.
enum class MusicColumn
{
    MusicPath,
    TensionPath,
    Browse,
    Check,
};

struct MusicControl
{
    int row;
    MusicColumn column;
};

// The row (0 to 9) and control of an identifier of the page; none for an
// identifier outside 7001..7040.
constexpr std::optional<MusicControl> MusicControlOf(int id)
{
    const int offset = id - IDC_MUSIC_PATH_FIRST;
    if (offset < 0 || offset >= config::kUserBgmRowCount * IDC_MUSIC_ROW_STEP)
        return std::nullopt;
    return MusicControl{offset / IDC_MUSIC_ROW_STEP,
                        static_cast<MusicColumn>(offset % IDC_MUSIC_ROW_STEP)};
}

// The text of a path field. One from a file need not be terminated: it ends
// at the field's last byte.
inline std::string PathText(const char (&field)[config::kPathCapacity])
{
    const void* end = std::memchr(field, '\0', sizeof field);
    return std::string(field,
                       end != nullptr ? static_cast<const char*>(end) - field : sizeof field - 1);
}

// Puts a path into its field: at most 259 bytes and the terminator, zeros
// after it, so that a shorter path leaves nothing of a longer one behind.
inline void StorePath(char (&field)[config::kPathCapacity], const char* text)
{
    std::size_t length = 0;
    while (length < sizeof field - 1 && text[length] != '\0')
        ++length;
    std::memcpy(field, text, length);
    std::memset(field + length, 0, sizeof field - length);
}

} // namespace dialog
