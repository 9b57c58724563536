#include "cli/check_report.h"

#include "cli/encoding.h"
#include "sound/loudness.h"
#include "sound/sound_buffer.h"
#include "tension/loudness_timeline.h"

#include <cstdio>

namespace cli
{
namespace
{

std::string Format(const char* format, double value)
{
    char text[64];
    std::snprintf(text, sizeof text, format, value);
    return text;
}

std::string Seconds(float value)
{
    return Format("%.3f", static_cast<double>(value));
}

std::vector<Segment> SegmentsOf(const tension::CKeyFrameList& timeline)
{
    std::vector<Segment> segments;
    for (std::uint32_t i = 0; i + 1 < timeline.GetKeyCount(); ++i)
    {
        const tension::KeyFrame* key = timeline.GetKey(i);
        const tension::KeyFrame* next = timeline.GetKey(i + 1);
        segments.push_back({key->time, next->time, static_cast<tension::TensionLevel>(key->value)});
    }
    return segments;
}

std::string LevelName(int level)
{
    return tension::LevelMessageName(static_cast<tension::TensionLevel>(level));
}

std::string Padded(std::string text, std::size_t width)
{
    if (text.size() < width)
        text.append(width - text.size(), ' ');
    return text;
}

// Measured from the decoded music the check itself holds.
std::vector<double> LoudnessOf(const sound::CSoundBuffer& music)
{
    const sound::BufferInfo& info = music.GetInfo();
    std::vector<std::uint8_t> pcm(info.dataBytes);
    if (info.format == nullptr ||
        !sound::device::ReadBack(music.GetMasterBuffer(), pcm.data(), info.dataBytes))
        return {};
    return sound::MeasureLoudness(*info.format, pcm.data(), pcm.size());
}

} // namespace

CheckFigures ReadFigures(const tension::MusicCheckInspection& inspection,
                         const std::string& tensionPath)
{
    CheckFigures figures;
    figures.log = Utf8FromCp932(inspection.log->CStr());
    if (inspection.music == nullptr)
        return figures;
    figures.musicOpened = true;
    figures.musicLength = inspection.music->GetLength();

    tension::CTensionFile& file = *inspection.tensionFile;
    const tension::CKeyFrameList* timeline = file.GetTimeline();
    if (timeline == nullptr)
        return figures;
    figures.hasTimeline = true;
    const tension::CTextString& name = file.GetName();
    figures.nameBytes = name.Length();
    figures.nameIsPath = tensionPath == name.CStr();
    figures.name = figures.nameIsPath ? Utf8FromNative(name.CStr()) : Utf8FromCp932(name.CStr());
    figures.segments = SegmentsOf(*timeline);
    figures.tally = file.TallyTimeline(figures.musicLength);
    figures.finaleTime = file.GetFinaleTime();
    figures.finaleWindow = file.GetFinaleWindow();
    figures.levelAtFinale = file.GetTension(figures.finaleTime);
    return figures;
}

CheckRun RunCheck(const std::string& musicPath, const std::string& tensionPath,
                  bool measureLoudness)
{
    CheckRun run{};
    tension::CTextString message;
    const auto inspect = [&](const tension::MusicCheckInspection& seen)
    {
        run.figures = ReadFigures(seen, tensionPath);
        if (!measureLoudness || seen.music == nullptr)
            return;
        CheckFigures& figures = run.figures;
        figures.loudness = LoudnessOf(*seen.music);
        if (figures.hasTimeline)
            figures.hasFigure = tension::FollowFigure(*seen.tensionFile->GetTimeline(),
                                                      figures.loudness, &figures.figure);
    };
    run.result = tension::CheckMusicRow(musicPath.c_str(), tensionPath.c_str(), &message, inspect);
    run.message = Utf8FromCp932(message.CStr());
    if (!run.message.empty() && run.message.back() != '\n')
        run.message += '\n';
    return run;
}

std::string DetailsText(tension::MusicCheckResult result, const CheckFigures& figures)
{
    std::string out = "\n";
    if (!figures.musicOpened)
        return out + "music: cannot be opened or decoded\n";
    out += "music length: " + Seconds(figures.musicLength) + " s\n";
    if (!figures.hasTimeline)
        return out + "timeline: none, the tension file could not be read\n";

    out += "name: \"" + figures.name + "\" (" + std::to_string(figures.nameBytes) + " bytes; " +
           (figures.nameIsPath ? "the path stands in, the file has no file-name entry"
                               : "from its file-name entry") +
           ")\n";
    if (result == tension::MusicCheckResult::Accepted)
    {
        out += "warnings not shown by the page:";
        if (figures.log.empty())
            out += " none\n";
        else
        {
            out += "\n";
            std::size_t start = 0;
            for (std::size_t end; (end = figures.log.find('\n', start)) != std::string::npos;
                 start = end + 1)
                out += "  " + figures.log.substr(start, end - start) + "\n";
        }
    }

    out += "segments (from, to, level):\n";
    for (const Segment& segment : figures.segments)
    {
        out += Format("%10.3f", static_cast<double>(segment.from)) +
               Format("%10.3f", static_cast<double>(segment.to)) + "  " +
               tension::LevelMessageName(segment.level) + "\n";
    }

    out += "levels (total time against its limit, segments against their maximum):\n";
    for (int level = 0; level < tension::kTensionLevelCount; ++level)
    {
        const tension::LevelTally& tally = figures.tally.levels[level];
        std::string time = Format("%8.3f s", static_cast<double>(tally.totalSeconds));
        time += tally.timeLimit == tension::kNoTimeLimit
                    ? " (no limit)"
                    : " of " + std::to_string(tally.timeLimit) + " s";
        out += "  " + Padded(LevelName(level), 14) + Padded(time, 24) +
               std::to_string(tally.segments) + " of " + std::to_string(tally.segmentLimit) +
               " segments\n";
    }

    out += "follows the loudness: ";
    if (figures.hasFigure)
        out += Format("%.2f", figures.figure) +
               " (rank correlation of each second's level with its short-term loudness)\n";
    else
        out += figures.loudness.empty()
                   ? "no figure (the loudness of music of this format is not measured)\n"
                   : "no figure (the level or the loudness never changes)\n";

    const std::string window = Seconds(figures.finaleWindow);
    if (figures.finaleTime == 0.0f)
        return out + "finale: none (its window would be " + window + " s)\n";
    return out + "finale: " + Seconds(figures.finaleTime) + " s, window " + window + " s (to " +
           Seconds(figures.finaleTime + figures.finaleWindow) + " s), " +
           tension::LevelMessageName(figures.levelAtFinale) + " there\n";
}

std::string ConfigRowLine(int row, const std::string& music, const std::string& tension,
                          const std::string& message)
{
    std::string result;
    std::size_t start = 0;
    while (start < message.size())
    {
        std::size_t end = message.find('\n', start);
        if (end == std::string::npos)
            end = message.size();
        if (end > start)
            result += (result.empty() ? "" : " / ") + message.substr(start, end - start);
        start = end + 1;
    }
    return std::to_string(row) + "\t" + music + "\t" + tension + "\t" + result + "\n";
}

} // namespace cli
