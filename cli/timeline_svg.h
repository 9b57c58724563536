#pragma once

#include "cli/check_report.h"

#include <string>

namespace cli
{

// A picture of a checked timeline (SVG, UTF-8): one band per segment along
// the music's length, coloured by level; the finale and its window marked;
// under them the music's loudness, when the figures hold it; a legend with each level's total and
// count against its limits; and the messages of a rejected file. Only for figures with a timeline.
std::string TimelineSvg(tension::MusicCheckResult result, const CheckFigures& figures);

} // namespace cli
