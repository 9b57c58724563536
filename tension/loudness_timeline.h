#pragma once

// Tension that follows the music: how well a timeline's levels agree with
// the music's loudness, and the timeline that agrees best within the
// check's limits.

#include "tension/key_frame_list.h"
#include "tension/tension_file.h"

#include <cstddef>
#include <vector>

namespace tension
{

// Spearman's rank correlation of two series of the same length (ties take
// the mean of their ranks). False when it has no value: fewer than two
// items, or a series that never changes.
bool RankCorrelation(const std::vector<double>& a, const std::vector<double>& b, double* figure);

// The level of each of the first `seconds` whole seconds (Low 0, Normal 1,
// Hi 2, Climax 3): the level at the middle of the second.
std::vector<double> LevelsPerSecond(const CKeyFrameList& timeline, std::size_t seconds);

// The figure of a timeline against the loudness of each whole second of
// its music: the rank correlation of each second's level with its
// loudness. False when it has none (see RankCorrelation).
bool FollowFigure(const CKeyFrameList& timeline, const std::vector<double>& loudness,
                  double* figure);

struct LevelChange
{
    TensionLevel level;
    // Whole seconds from the start of the music.
    int second;
};

struct LoudnessTimeline
{
    // In time order; the timeline is Normal before the first.
    std::vector<LevelChange> changes;
    // Inside a climax stretch, its window with it.
    int finaleSecond = 0;
    // Against the loudness it was laid on; none for loudness that never
    // changes.
    bool hasFigure = false;
    double figure = 0.0;
};

// The timeline for music of `length` seconds (60 to 480) whose whole
// seconds have the given loudness (missing seconds take the last value,
// none at all counts as even), laid so that its level follows the
// loudness as closely as the check allows: Hi and Climax within their time
// limits, Low at least as long as Hi, each level within its count of
// stretches, changes on whole seconds, one or two climax stretches long
// enough for the finale's window, and the finale on the loudest second
// where its window fits inside the climax.
LoudnessTimeline LayTimeline(const std::vector<double>& loudness, float length);

} // namespace tension
