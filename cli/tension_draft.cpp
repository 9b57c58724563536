#include "cli/tension_draft.h"

#include "config/fixed_text.h"
#include "tension/tension_file.h"

#include <cmath>
#include <cstdio>

namespace cli
{
namespace
{

// The check measures a name of 1 to 40 bytes.
constexpr std::size_t kNameLimit = 40;

struct Entry
{
    const char* key;
    // Where the entry stands, as a share of the music's length.
    double share;
};

// Calm, a first rise, calm again, a second rise and the climax at the end:
// Hi takes 18 % of the music, Climax 8 % and Low 51 %, within the limits of
// 20 %, 10 % and Hi's own time with a second or more to spare from 60 s on.
// Every entry lies 6 % or more from the next, far from the check's nearness
// limit.
constexpr Entry kTimeline[] = {
    {"LOW", 0.10}, {"HI", 0.30},  {"NORMAL", 0.42}, {"LOW", 0.55},
    {"HI", 0.70},  {"LOW", 0.76}, {"CLIMAX", 0.92},
};
// Inside the climax, with its window (2 % of the music) before the end.
constexpr Entry kFinale = {"FINALE", 0.94};

bool IsBlank(char c)
{
    return c == ' ' || c == '\t' || c == '\r' || c == '\n' || c == '\v';
}

std::string Trimmed(std::string text)
{
    while (!text.empty() && IsBlank(text.back()))
        text.pop_back();
    std::size_t start = 0;
    while (start < text.size() && IsBlank(text[start]))
        ++start;
    return text.substr(start);
}

// Tenths of a second, rounded down: an entry never moves later than its
// share (but 0.7 of 180 s, which doubles hold as 125.99999..., is 126).
std::string Seconds(double seconds)
{
    char text[32];
    std::snprintf(text, sizeof text, "%.1f", std::floor(seconds * 10.0 + 1e-6) / 10.0);
    return text;
}

std::string Figure(double value)
{
    char text[32];
    std::snprintf(text, sizeof text, "%.1f", value);
    return text;
}

} // namespace

std::string DraftName(std::string_view musicFileName)
{
    const std::size_t slash = musicFileName.find_last_of("/\\");
    std::string name(slash == std::string_view::npos ? musicFileName
                                                     : musicFileName.substr(slash + 1));
    const std::size_t dot = name.rfind('.');
    if (dot != std::string::npos && dot > 0)
        name.resize(dot);
    // The terminator would end the entry early, and a control character has
    // no place in a name.
    for (char& c : name)
    {
        if (c == ';' || (static_cast<unsigned char>(c) < 0x20 && !IsBlank(c)))
            c = '_';
    }
    name = Trimmed(name);
    name = Trimmed(name.substr(0, config::KeptTextLength(name, kNameLimit)));
    return name.empty() ? "BGM" : name;
}

std::string DraftTension(const std::string& name, float length)
{
    const double music = length;
    std::string entries = "FILENAME:" + name + ";\nCOMMENT:Draft by vekcfg: adjust the times;\n";
    for (const Entry& entry : kTimeline)
        entries += std::string(entry.key) + ":" + Seconds(entry.share * music) + ";\n";
    entries += std::string(kFinale.key) + ":" + Seconds(kFinale.share * music) + ";\n";

    // The limits and totals as the check itself weighs them.
    tension::CTensionFile weighed;
    weighed.ParseForLength(length, entries.c_str(), ':', ';', nullptr);
    const tension::TimelineTally tally = weighed.TallyTimeline(length);
    std::string text = "// A tension file drafted for " + Figure(music) +
                       " s of music. What each level has here, against the\n"
                       "// check's limits for this length:\n";
    for (int level = 0; level < tension::kTensionLevelCount; ++level)
    {
        const tension::LevelTally& measured = tally.levels[level];
        text += "//   " +
                std::string(tension::LevelMessageName(static_cast<tension::TensionLevel>(level))) +
                ": " + Figure(measured.totalSeconds) + " s";
        if (measured.timeLimit != tension::kNoTimeLimit)
            text += " of at most " + std::to_string(measured.timeLimit) + " s";
        text += ", " + std::to_string(measured.segments) + " of at most " +
                std::to_string(measured.segmentLimit) + " stretches\n";
    }
    text += "// LowTension must last at least as long as HiTension. The finale plays\n"
            "// for " +
            Figure(weighed.GetFinaleWindow()) +
            " s from its time and must lie inside the climax.\n";
    return text + entries;
}

} // namespace cli
