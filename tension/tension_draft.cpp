#include "tension/tension_draft.h"

#include "base/cp932.h"
#include "tension/loudness_timeline.h"
#include "tension/tension_file.h"

#include <algorithm>
#include <cerrno>
#include <cstdint>
#include <cstdio>
#include <vector>

namespace tension
{
namespace
{

// The check measures a name of 1 to 40 bytes.
constexpr std::size_t kNameLimit = 40;

constexpr const char* kLevelKeys[kTensionLevelCount] = {"LOW", "NORMAL", "HI", "CLIMAX"};

bool IsTrailByte(std::uint8_t byte)
{
    return byte >= 0x40 && byte <= 0xFC && byte != 0x7F;
}

bool IsMissing(const std::string& path)
{
    errno = 0;
    std::FILE* file = std::fopen(path.c_str(), "rb");
    if (file == nullptr)
        return errno == ENOENT;
    std::fclose(file);
    return false;
}

std::string Figure(double value, const char* format = "%.1f")
{
    char text[32];
    std::snprintf(text, sizeof text, format, value);
    return text;
}

} // namespace

std::string DraftName(std::string_view musicFileName)
{
    const std::size_t slash = musicFileName.find_last_of("/\\");
    std::string_view base =
        slash == std::string_view::npos ? musicFileName : musicFileName.substr(slash + 1);
    const std::size_t dot = base.rfind('.');
    if (dot != std::string_view::npos && dot > 0)
        base = base.substr(0, dot);
    std::vector<std::string> characters;
    for (std::size_t i = 0; i < base.size(); ++i)
    {
        const auto byte = static_cast<std::uint8_t>(base[i]);
        if (base::IsLeadByte(byte) && i + 1 < base.size() &&
            IsTrailByte(static_cast<std::uint8_t>(base[i + 1])))
        {
            characters.emplace_back(base.substr(i++, 2));
            continue;
        }
        const bool unfit = byte < 0x20 || byte == 0x7F || byte == ';' || base::IsLeadByte(byte);
        characters.emplace_back(1, unfit ? '_' : base[i]);
    }
    std::size_t first = 0;
    while (first < characters.size() && characters[first] == " ")
        ++first;
    std::string name;
    for (std::size_t i = first;
         i < characters.size() && name.size() + characters[i].size() <= kNameLimit; ++i)
        name += characters[i];
    // No trail byte is a space.
    while (!name.empty() && name.back() == ' ')
        name.pop_back();
    return name.empty() ? "BGM" : name;
}

std::string DraftTension(const std::string& name, float length, const std::vector<double>& loudness)
{
    const LoudnessTimeline laid = LayTimeline(loudness, length);
    const std::string figure = laid.hasFigure ? Figure(laid.figure, "%.2f") : "";
    std::string entries = "FILENAME:" + name + ";\nCOMMENT:Draft by vekcfg from the loudness\n";
    entries +=
        laid.hasFigure ? "following it at " + figure + " (Spearman);\n" : "which never changes;\n";
    for (const LevelChange& change : laid.changes)
        entries += std::string(kLevelKeys[static_cast<int>(change.level)]) + ":" +
                   std::to_string(change.second) + ";\n";
    entries += "FINALE:" + std::to_string(laid.finaleSecond) + ";\n";

    // The limits and totals as the check itself weighs them.
    CTensionFile weighed;
    weighed.ParseForLength(length, entries.c_str(), ':', ';', nullptr);
    const TimelineTally tally = weighed.TallyTimeline(length);
    std::string text = "// A tension file drafted by vekcfg for " + Figure(length) +
                       " s of music. Its levels follow\n"
                       "// the music's short-term loudness (EBU R128, one value a second),\n"
                       "// laid to agree with it as closely as the check's limits allow.\n";
    text += laid.hasFigure ? "// Spearman's rank correlation of each second's level with its\n"
                             "// loudness: " +
                                 figure + " (1 would follow it perfectly).\n"
                           : "// The loudness never changes (or could not be measured): there is\n"
                             "// nothing to follow, and no figure.\n";
    text += "// What each level has here, against the check's limits for this length:\n";
    for (int level = 0; level < kTensionLevelCount; ++level)
    {
        const LevelTally& measured = tally.levels[level];
        text += "//   " + std::string(LevelMessageName(static_cast<TensionLevel>(level))) + ": " +
                Figure(measured.totalSeconds) + " s";
        if (measured.timeLimit != kNoTimeLimit)
            text += " of at most " + std::to_string(measured.timeLimit) + " s";
        text += ", " + std::to_string(measured.segments) + " of at most " +
                std::to_string(measured.segmentLimit) + " stretches\n";
    }
    text += "// LowTension must last at least as long as HiTension. The finale plays\n"
            "// for " +
            Figure(weighed.GetFinaleWindow()) +
            " s from its time, inside the climax, from its loudest second.\n";
    return text + entries;
}

std::string DraftPathFor(const std::string& musicPath, const std::string& tensionPath,
                         bool musicOpened, float musicLength, std::size_t pathLimit)
{
    if (!musicOpened || !(musicLength >= kShortestMusic && musicLength <= kLongestMusic))
        return "";
    std::string path = tensionPath;
    if (path.empty())
    {
        // A trail byte may be a backslash: the folder ends at the last
        // character that is one.
        const char* slash = base::FindLastCharacter(musicPath.c_str(), '\\');
        const std::size_t folderEnd =
            std::max(slash == nullptr ? 0 : std::size_t(slash - musicPath.c_str()) + 1,
                     musicPath.rfind('/') == std::string::npos ? 0 : musicPath.rfind('/') + 1);
        const std::size_t dot = musicPath.rfind('.');
        path =
            (dot == std::string::npos || dot < folderEnd ? musicPath : musicPath.substr(0, dot)) +
            ".txt";
    }
    return path.size() <= pathLimit && IsMissing(path) ? path : "";
}

} // namespace tension
