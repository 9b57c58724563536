#pragma once

// `vekcfg check`: the user music page's check, and what an author needs to
// see why a tension file fails and by how much. Every figure is read from
// the objects the check itself used, after the check.

#include "tension/music_check.h"
#include "tension/tension_file.h"

#include <cstddef>
#include <string>
#include <vector>

namespace cli
{

struct Segment
{
    float from;
    float to;
    tension::TensionLevel level;
};

struct CheckFigures
{
    bool musicOpened = false;
    float musicLength = 0.0f;
    // False when the tension file could not be read.
    bool hasTimeline = false;
    // The name the file-name rule measured (UTF-8), its length in bytes, and
    // whether the path stood in for it.
    std::string name;
    std::size_t nameBytes = 0;
    bool nameIsPath = false;
    // The whole log of the load (UTF-8); on acceptance, the warnings the
    // page does not show.
    std::string log;
    std::vector<Segment> segments;
    tension::TimelineTally tally{};
    float finaleTime = 0.0f;
    float finaleWindow = 0.0f;
    tension::TensionLevel levelAtFinale = tension::TensionLevel::Normal;
    // When asked for: the music's loudness, one value a second (empty when
    // its format is not measured), and how well the timeline follows it.
    std::vector<double> loudness;
    bool hasFigure = false;
    double figure = 0.0;
};

struct CheckRun
{
    tension::MusicCheckResult result;
    // What the page would show (UTF-8), one message per line.
    std::string message;
    CheckFigures figures;
};

// The check of MUSIC against TENSION, both handed on as given; with
// `measureLoudness`, the loudness of the music the check decoded and the
// timeline's figure against it too.
CheckRun RunCheck(const std::string& musicPath, const std::string& tensionPath,
                  bool measureLoudness = false);

// The figures of a check, read through the inspection of its objects.
CheckFigures ReadFigures(const tension::MusicCheckInspection& inspection,
                         const std::string& tensionPath);

// The --details part that follows the page's message (UTF-8).
std::string DetailsText(tension::MusicCheckResult result, const CheckFigures& figures);

// One line of check-config: "row<TAB>music<TAB>tension<TAB>result", the
// result being the page's message, several messages joined by " / ".
std::string ConfigRowLine(int row, const std::string& music, const std::string& tension,
                          const std::string& message);

} // namespace cli
