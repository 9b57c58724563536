#pragma once

// What the user music page decides without a window: which row and which
// control an identifier names.

#include "config/config_sections.h"
#include "resources/resource.h"

#include <optional>

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

} // namespace dialog
