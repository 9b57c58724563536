#include "cli/timeline_svg.h"

#include <algorithm>
#include <cstdio>

namespace cli
{
namespace
{

constexpr double kWidth = 960.0;
constexpr double kLeft = 60.0;
constexpr double kRight = 40.0;
constexpr double kBarTop = 64.0;
constexpr double kBarHeight = 56.0;
constexpr double kLegendTop = 176.0;
constexpr double kCurveTop = 184.0;
constexpr double kCurveHeight = 96.0;
// Room the loudness curve takes above the legend.
constexpr double kCurveRoom = 136.0;
constexpr double kCurveSpan = 30.0;
constexpr double kLineHeight = 22.0;
constexpr int kMessageLines = 6;

// Low, Normal, Hi, Climax.
constexpr const char* kLevelColours[tension::kTensionLevelCount] = {"#3b7dd8", "#9aa0a6", "#f29d38",
                                                                    "#d93025"};

std::string Number(double value)
{
    char text[32];
    std::snprintf(text, sizeof text, "%.2f", value);
    return text;
}

std::string Seconds(double value)
{
    char text[32];
    std::snprintf(text, sizeof text, "%.3f", value);
    return text;
}

std::string Escaped(const std::string& text)
{
    std::string out;
    for (const char c : text)
    {
        switch (c)
        {
        case '&':
            out += "&amp;";
            break;
        case '<':
            out += "&lt;";
            break;
        case '>':
            out += "&gt;";
            break;
        case '"':
            out += "&quot;";
            break;
        default:
            // XML 1.0 has no form for the other control characters.
            if (static_cast<unsigned char>(c) >= 0x20 || c == '\t')
                out += c;
        }
    }
    return out;
}

std::string Text(double x, double y, const std::string& content, const char* extra = "")
{
    return "<text x=\"" + Number(x) + "\" y=\"" + Number(y) + "\"" + extra + ">" +
           Escaped(content) + "</text>\n";
}

// A tick every 10, 30 or 60 seconds, by the music's length.
double TickStep(double length)
{
    if (length <= 120.0)
        return 10.0;
    return length <= 300.0 ? 30.0 : 60.0;
}

std::vector<std::string> LogLines(const std::string& log)
{
    std::vector<std::string> lines;
    std::size_t start = 0;
    for (std::size_t end; (end = log.find('\n', start)) != std::string::npos; start = end + 1)
        lines.push_back(log.substr(start, end - start));
    if (start < log.size())
        lines.push_back(log.substr(start));
    return lines;
}

// The loudness of each second under the timeline, scaled from its quietest
// to its loudest value, with the finale's window across it.
template <typename Place> std::string LoudnessCurve(const CheckFigures& figures, const Place& x)
{
    const auto extremes = std::minmax_element(figures.loudness.begin(), figures.loudness.end());
    const double lowest = *extremes.first, highest = *extremes.second;
    // A fade to silence would flatten the rest: the scale spans at most
    // kCurveSpan below the loudest value, and quieter seconds lie on its floor.
    const double floor = std::max(lowest, highest - kCurveSpan);
    const double range = highest > floor ? highest - floor : 1.0;
    const auto y = [&](double value)
    { return kCurveTop + kCurveHeight * (highest - std::max(value, floor)) / range; };
    std::string svg = "<g id=\"loudness\">\n";
    svg +=
        Text(kLeft, kCurveTop - 8,
             "short-term loudness, " + Number(lowest) + " to " + Number(highest) + " LUFS; " +
                 (figures.hasFigure ? "rank correlation with the levels " + Number(figures.figure)
                                    : std::string("no rank correlation")),
             " font-size=\"12\"");
    svg += "<rect x=\"" + Number(kLeft) + "\" y=\"" + Number(kCurveTop) + "\" width=\"" +
           Number(x(1.0e9) - kLeft) + "\" height=\"" + Number(kCurveHeight) +
           "\" fill=\"#f4f4f4\"/>\n";
    if (figures.finaleTime != 0.0f)
    {
        const double start = x(figures.finaleTime);
        const double end = x(double(figures.finaleTime) + double(figures.finaleWindow));
        svg += "<rect class=\"finale-window\" x=\"" + Number(start) + "\" y=\"" +
               Number(kCurveTop) + "\" width=\"" + Number(std::max(end - start, 1.0)) +
               "\" height=\"" + Number(kCurveHeight) +
               "\" fill=\"#ffe066\" fill-opacity=\"0.55\" stroke=\"#000000\" "
               "stroke-dasharray=\"4 3\"/>\n";
    }
    svg += "<polyline class=\"loudness\" fill=\"none\" stroke=\"#202124\" "
           "stroke-width=\"1.5\" points=\"";
    for (std::size_t second = 0; second < figures.loudness.size(); ++second)
    {
        if (second != 0)
            svg += ' ';
        svg += Number(x(double(second) + 0.5));
        svg += ',';
        svg += Number(y(figures.loudness[second]));
    }
    svg += "\"/>\n</g>\n";
    return svg;
}

} // namespace

std::string TimelineSvg(tension::MusicCheckResult result, const CheckFigures& figures)
{
    const double length = figures.musicLength > 0.0f ? figures.musicLength : 1.0;
    const double barWidth = kWidth - kLeft - kRight;
    const auto x = [&](double seconds)
    { return kLeft + barWidth * std::clamp(seconds / length, 0.0, 1.0); };

    const bool accepted = result == tension::MusicCheckResult::Accepted;
    const std::vector<std::string> messages =
        accepted ? std::vector<std::string>() : LogLines(figures.log);
    const int shownMessages = std::min<int>(static_cast<int>(messages.size()), kMessageLines);
    const bool curve = !figures.loudness.empty();
    const double legendTop = kLegendTop + (curve ? kCurveRoom : 0.0);
    const double messagesTop = legendTop + kLineHeight * (tension::kTensionLevelCount + 0.5);
    const double height = messagesTop + kLineHeight * (shownMessages + 1);

    std::string svg = "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n";
    svg += "<svg xmlns=\"http://www.w3.org/2000/svg\" width=\"" + Number(kWidth) + "\" height=\"" +
           Number(height) + "\" viewBox=\"0 0 " + Number(kWidth) + " " + Number(height) +
           "\" font-family=\"IPAPGothic, IPAGothic, sans-serif\" font-size=\"13\">\n";
    svg += "<rect x=\"0\" y=\"0\" width=\"" + Number(kWidth) + "\" height=\"" + Number(height) +
           "\" fill=\"#ffffff\"/>\n";
    svg += Text(kLeft, 30,
                figures.name + ": " + Seconds(figures.musicLength) + " s of music, " +
                    (accepted ? "accepted" : "rejected"),
                " font-size=\"16\"");

    svg += "<g id=\"segments\">\n";
    for (const Segment& segment : figures.segments)
    {
        const int level = static_cast<int>(segment.level);
        const std::string name = tension::LevelMessageName(segment.level);
        const char* colour =
            level >= 0 && level < tension::kTensionLevelCount ? kLevelColours[level] : "#000000";
        const double left = x(segment.from);
        svg += "<rect class=\"segment\" data-level=\"" + name + "\" data-from=\"" +
               Seconds(segment.from) + "\" data-to=\"" + Seconds(segment.to) + "\" x=\"" +
               Number(left) + "\" y=\"" + Number(kBarTop) + "\" width=\"" +
               Number(x(segment.to) - left) + "\" height=\"" + Number(kBarHeight) + "\" fill=\"" +
               colour + "\"><title>" + name + " " + Seconds(segment.from) + " - " +
               Seconds(segment.to) + " s</title></rect>\n";
    }
    svg += "</g>\n";

    if (figures.finaleTime != 0.0f)
    {
        const double start = x(figures.finaleTime);
        const double end = x(double(figures.finaleTime) + double(figures.finaleWindow));
        svg += "<g id=\"finale\">\n";
        svg += "<rect class=\"finale-window\" x=\"" + Number(start) + "\" y=\"" +
               Number(kBarTop - 8) + "\" width=\"" + Number(std::max(end - start, 1.0)) +
               "\" height=\"" + Number(kBarHeight + 16) +
               "\" fill=\"#ffe066\" fill-opacity=\"0.55\" stroke=\"#000000\" "
               "stroke-dasharray=\"4 3\"/>\n";
        svg += "<line x1=\"" + Number(start) + "\" y1=\"" + Number(kBarTop - 8) + "\" x2=\"" +
               Number(start) + "\" y2=\"" + Number(kBarTop + kBarHeight + 8) +
               "\" stroke=\"#000000\" stroke-width=\"2\"/>\n";
        svg += Text(start, kBarTop - 12,
                    "finale " + Seconds(figures.finaleTime) + " s, window " +
                        Seconds(figures.finaleWindow) + " s",
                    " text-anchor=\"end\" font-size=\"12\"");
        svg += "</g>\n";
    }

    svg += "<g id=\"axis\" font-size=\"11\">\n";
    const double axisY = kBarTop + kBarHeight + 10;
    svg += "<line x1=\"" + Number(kLeft) + "\" y1=\"" + Number(axisY) + "\" x2=\"" +
           Number(kLeft + barWidth) + "\" y2=\"" + Number(axisY) + "\" stroke=\"#444444\"/>\n";
    const double step = TickStep(length);
    for (double tick = 0.0; tick < length - step * 0.25; tick += step)
    {
        svg += "<line x1=\"" + Number(x(tick)) + "\" y1=\"" + Number(axisY) + "\" x2=\"" +
               Number(x(tick)) + "\" y2=\"" + Number(axisY + 5) + "\" stroke=\"#444444\"/>\n";
        svg += Text(x(tick), axisY + 18, std::to_string(static_cast<int>(tick)),
                    " text-anchor=\"middle\"");
    }
    svg += "<line x1=\"" + Number(x(length)) + "\" y1=\"" + Number(axisY) + "\" x2=\"" +
           Number(x(length)) + "\" y2=\"" + Number(axisY + 5) + "\" stroke=\"#444444\"/>\n";
    svg += Text(x(length), axisY + 18, Seconds(length) + " s", " text-anchor=\"end\"");
    svg += "</g>\n";

    if (curve)
        svg += LoudnessCurve(figures, x);

    svg += "<g id=\"legend\">\n";
    for (int level = 0; level < tension::kTensionLevelCount; ++level)
    {
        const tension::LevelTally& tally = figures.tally.levels[level];
        const double top = legendTop + kLineHeight * level;
        std::string limit = tally.timeLimit == tension::kNoTimeLimit
                                ? std::string(" (no time limit)")
                                : " of at most " + std::to_string(tally.timeLimit) + " s";
        svg += "<rect x=\"" + Number(kLeft) + "\" y=\"" + Number(top) +
               "\" width=\"14\" height=\"14\" fill=\"" + kLevelColours[level] + "\"/>\n";
        svg += Text(kLeft + 22, top + 12,
                    tension::LevelMessageName(static_cast<tension::TensionLevel>(level)) +
                        std::string(": ") + Seconds(tally.totalSeconds) + " s" + limit + ", " +
                        std::to_string(tally.segments) + " of at most " +
                        std::to_string(tally.segmentLimit) + " segments");
    }
    svg += "</g>\n";

    if (shownMessages > 0)
    {
        svg += "<g id=\"messages\" fill=\"#b3261e\">\n";
        for (int i = 0; i < shownMessages; ++i)
            svg += Text(kLeft, messagesTop + kLineHeight * i + 12, messages[std::size_t(i)]);
        svg += "</g>\n";
    }
    svg += "</svg>\n";
    return svg;
}

} // namespace cli
