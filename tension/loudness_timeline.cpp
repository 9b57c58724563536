#include "tension/loudness_timeline.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <limits>
#include <numeric>

namespace tension
{
namespace
{

constexpr int kLow = static_cast<int>(TensionLevel::Low);
constexpr int kNormal = static_cast<int>(TensionLevel::Normal);
constexpr int kHi = static_cast<int>(TensionLevel::Hi);
constexpr int kClimax = static_cast<int>(TensionLevel::Climax);
constexpr int kLevels = kTensionLevelCount;

// Ranks from 1, ties taking the mean of the ranks they span.
std::vector<double> Ranks(const std::vector<double>& values)
{
    std::vector<std::size_t> order(values.size());
    std::iota(order.begin(), order.end(), std::size_t{0});
    std::stable_sort(order.begin(), order.end(),
                     [&values](std::size_t x, std::size_t y) { return values[x] < values[y]; });
    std::vector<double> ranks(values.size());
    for (std::size_t first = 0; first < order.size();)
    {
        std::size_t last = first;
        while (last + 1 < order.size() && values[order[last + 1]] == values[order[first]])
            ++last;
        for (std::size_t i = first; i <= last; ++i)
            ranks[order[i]] = static_cast<double>(first + last) / 2.0 + 1.0;
        first = last + 1;
    }
    return ranks;
}

// What the check allows music of one length, read from the check itself.
struct Limits
{
    double hiSeconds;
    double climaxSeconds;
    int stretches[kLevels];
    double finaleWindow;
};

Limits LimitsFor(float length)
{
    CTensionFile probe;
    probe.ParseForLength(length, "", ':', ';', nullptr);
    const TimelineTally tally = probe.TallyTimeline(length);
    Limits limits{};
    limits.hiSeconds = tally.levels[kHi].timeLimit;
    limits.climaxSeconds = tally.levels[kClimax].timeLimit;
    for (int level = 0; level < kLevels; ++level)
        limits.stretches[level] = tally.levels[level].segmentLimit;
    limits.finaleWindow = probe.GetFinaleWindow();
    return limits;
}

// The stretches of Low, Hi and Climax begun so far: the dynamic
// programme's count state. Normal's own count needs no state: every Normal
// stretch after the first follows another level's stretch, so that at most
// one Normal stretch fewer than allowed of the others keeps Normal within
// its count too.
struct Counts
{
    int low;
    int hi;
    int climax;
};

class TimelineSolver
{
public:
    TimelineSolver(const std::vector<double>& loudness, float length)
        : length_(length), units_(static_cast<int>(length)), limits_(LimitsFor(length))
    {
        loudness_ = loudness.empty() ? std::vector<double>(1, 0.0) : loudness;
        loudness_.resize(static_cast<std::size_t>(units_), loudness_.back());
        const std::vector<double> ranks = Ranks(loudness_);
        const double middle = (units_ + 1) / 2.0;
        for (const double rank : ranks)
            centred_.push_back((rank - middle) / units_);
        climaxUnits_ = static_cast<int>(std::ceil(limits_.finaleWindow)) + 1;

        const int others = limits_.stretches[kNormal] - 1;
        std::vector<Counts> counts;
        for (int low = 0; low <= limits_.stretches[kLow]; ++low)
            for (int hi = 0; hi <= limits_.stretches[kHi]; ++hi)
                for (int climax = 0; climax <= limits_.stretches[kClimax]; ++climax)
                {
                    if (low + hi + climax <= others)
                        counts.push_back({low, hi, climax});
                }
        states_ = static_cast<int>(counts.size());
        const auto find = [&counts](Counts wanted)
        {
            for (std::size_t i = 0; i < counts.size(); ++i)
            {
                if (counts[i].low == wanted.low && counts[i].hi == wanted.hi &&
                    counts[i].climax == wanted.climax)
                    return static_cast<int>(i);
            }
            return -1;
        };
        for (const Counts& state : counts)
        {
            begun_[kLow].push_back(state.low > 0);
            begun_[kNormal].push_back(true);
            begun_[kHi].push_back(state.hi > 0);
            begun_[kClimax].push_back(state.climax > 0);
            before_[kLow].push_back(find({state.low - 1, state.hi, state.climax}));
            before_[kNormal].push_back(find(state));
            before_[kHi].push_back(find({state.low, state.hi - 1, state.climax}));
            before_[kClimax].push_back(find({state.low, state.hi, state.climax - 1}));
        }
        start_ = find({0, 0, 0});
        const std::size_t cells = std::size_t(units_) * kLevels * std::size_t(states_);
        value_.resize(cells);
        from_.resize(cells);
    }

    LoudnessTimeline Lay();

private:
    static constexpr std::uint8_t kStayed = 0xFF;

    std::size_t Cell(int unit, int level, int state) const
    {
        return (std::size_t(unit) * kLevels + std::size_t(level)) * std::size_t(states_) +
               std::size_t(state);
    }

    // The levels of each whole second that earn the most when each second
    // at a level earns weight[level] × its centred loudness rank + offset.
    std::vector<int> Solve(const double weight[kLevels], const double offset[kLevels]);
    void Totals(const std::vector<int>& levels, double totals[kLevels]) const;
    bool Fits(const double totals[kLevels]) const
    {
        return totals[kHi] <= limits_.hiSeconds && totals[kClimax] <= limits_.climaxSeconds &&
               totals[kLow] >= totals[kHi];
    }
    std::vector<int> Constrained(const double weight[kLevels]);
    LoudnessTimeline Timeline(const std::vector<int>& levels) const;

    float length_;
    int units_;
    Limits limits_;
    std::vector<double> loudness_;
    std::vector<double> centred_;
    int climaxUnits_;
    // The count states: for each level, whether the state has begun a
    // stretch of it, and the state before that stretch began (-1: none).
    int states_ = 0;
    int start_ = 0;
    std::vector<bool> begun_[kLevels];
    std::vector<int> before_[kLevels];
    std::vector<double> value_;
    std::vector<std::uint8_t> from_;
};

std::vector<int> TimelineSolver::Solve(const double weight[kLevels], const double offset[kLevels])
{
    constexpr double kNever = -std::numeric_limits<double>::infinity();
    std::vector<double> gain[kLevels];
    for (int level = 0; level < kLevels; ++level)
    {
        for (const double rank : centred_)
            gain[level].push_back(weight[level] * rank + offset[level]);
    }
    // Climax gains from the start, for a stretch entered at its least length.
    std::vector<double> climaxSum(std::size_t(units_) + 1, 0.0);
    for (std::size_t unit = 0; unit < std::size_t(units_); ++unit)
        climaxSum[unit + 1] = climaxSum[unit] + gain[kClimax][unit];

    std::fill(value_.begin(), value_.end(), kNever);
    std::fill(from_.begin(), from_.end(), kStayed);
    value_[Cell(0, kNormal, start_)] = gain[kNormal][0];
    for (int unit = 1; unit < units_; ++unit)
    {
        for (int level = 0; level < kLevels; ++level)
        {
            const double here = gain[level][std::size_t(unit)];
            const int entry = level == kClimax ? unit - climaxUnits_ : unit - 1;
            const double entered =
                level != kClimax ? here
                : entry < 0      ? 0.0
                            : climaxSum[std::size_t(unit) + 1] - climaxSum[std::size_t(entry) + 1];
            for (int state = 0; state < states_; ++state)
            {
                if (!begun_[level][std::size_t(state)])
                    continue;
                double best = value_[Cell(unit - 1, level, state)] + here;
                std::uint8_t came = kStayed;
                const int before = before_[level][std::size_t(state)];
                for (int previous = 0; previous < kLevels && entry >= 0 && before >= 0; ++previous)
                {
                    const double reached = value_[Cell(entry, previous, before)] + entered;
                    if (previous != level && reached > best)
                    {
                        best = reached;
                        came = static_cast<std::uint8_t>(previous);
                    }
                }
                value_[Cell(unit, level, state)] = best;
                from_[Cell(unit, level, state)] = came;
            }
        }
    }

    // The best end with a climax stretch.
    int level = kNormal, state = start_;
    double best = kNever;
    for (int end = 0; end < states_; ++end)
    {
        for (int last = 0; last < kLevels && begun_[kClimax][std::size_t(end)]; ++last)
        {
            if (value_[Cell(units_ - 1, last, end)] > best)
            {
                best = value_[Cell(units_ - 1, last, end)];
                level = last;
                state = end;
            }
        }
    }
    std::vector<int> levels(std::size_t(units_), kNormal);
    for (int unit = units_ - 1; unit > 0;)
    {
        const std::uint8_t came = from_[Cell(unit, level, state)];
        const int entry = came == kStayed    ? unit - 1
                          : level == kClimax ? unit - climaxUnits_
                                             : unit - 1;
        for (int covered = unit; covered > entry; --covered)
            levels[std::size_t(covered)] = level;
        if (came != kStayed)
        {
            state = before_[level][std::size_t(state)];
            level = came;
        }
        unit = entry;
    }
    return levels;
}

void TimelineSolver::Totals(const std::vector<int>& levels, double totals[kLevels]) const
{
    std::fill(totals, totals + kLevels, 0.0);
    for (int unit = 0; unit + 1 < units_; ++unit)
        totals[levels[std::size_t(unit)]] += 1.0;
    // The last second's level lasts to the end of the music.
    totals[levels.back()] += static_cast<double>(length_) - (units_ - 1);
}

// The best levels within the time limits: each limit has its price per
// second of the level it holds down (Climax, Hi, and Hi against Low), and
// each price that a limit needs rises, found by halving, only as far as
// that limit needs, the others as they stand; prices never fall, and the
// round repeats while a later price undoes what an earlier one held down.
// A price of 1 exceeds what any second can earn, so that the level then
// keeps only what it must (no Hi; one climax stretch of the least length),
// which every limit allows: the last resort.
std::vector<int> TimelineSolver::Constrained(const double weight[kLevels])
{
    constexpr double kHighest = 1.0;
    constexpr int kHalvings = 8;
    constexpr int kRounds = 4;
    double prices[3] = {0.0, 0.0, 0.0};
    const auto solve = [&](double totals[kLevels])
    {
        const double prices4[kLevels] = {prices[2], 0.0, -prices[1] - prices[2],
                                         -prices[0] - prices[1] - prices[2]};
        double twice[kLevels], offset[kLevels];
        for (int level = 0; level < kLevels; ++level)
        {
            twice[level] = 2.0 * weight[level];
            offset[level] = prices4[level] - weight[level] * weight[level];
        }
        std::vector<int> levels = Solve(twice, offset);
        Totals(levels, totals);
        return levels;
    };
    const auto holds = [this](int limit, const double totals[kLevels])
    {
        if (limit == 0)
            return totals[kClimax] <= limits_.climaxSeconds;
        if (limit == 1)
            return totals[kHi] <= limits_.hiSeconds;
        return totals[kLow] >= totals[kHi];
    };
    double totals[kLevels];
    std::vector<int> levels = solve(totals);
    for (int round = 0; round < kRounds && !Fits(totals); ++round)
    {
        for (int limit = 0; limit < 3; ++limit)
        {
            if (holds(limit, totals))
                continue;
            double low = prices[limit], high = kHighest;
            for (int i = 0; i < kHalvings; ++i)
            {
                prices[limit] = (low + high) / 2.0;
                solve(totals);
                (holds(limit, totals) ? high : low) = prices[limit];
            }
            prices[limit] = high;
            levels = solve(totals);
        }
    }
    while (!Fits(totals))
    {
        for (int limit = 0; limit < 3; ++limit)
        {
            if (!holds(limit, totals))
                prices[limit] = kHighest;
        }
        levels = solve(totals);
    }
    return levels;
}

LoudnessTimeline TimelineSolver::Timeline(const std::vector<int>& levels) const
{
    LoudnessTimeline timeline;
    for (int unit = 1; unit < units_; ++unit)
    {
        if (levels[std::size_t(unit)] != levels[std::size_t(unit) - 1])
            timeline.changes.push_back(
                {static_cast<TensionLevel>(levels[std::size_t(unit)]), unit});
    }
    // The finale on the loudest second whose window ends inside its climax
    // stretch.
    double loudest = -std::numeric_limits<double>::infinity();
    for (int unit = 0; unit < units_; ++unit)
    {
        if (levels[std::size_t(unit)] != kClimax)
            continue;
        int end = unit;
        while (end < units_ && levels[std::size_t(end)] == kClimax)
            ++end;
        const double stretchEnd = end == units_ ? static_cast<double>(length_) : end;
        if (unit + limits_.finaleWindow < stretchEnd && loudness_[std::size_t(unit)] > loudest)
        {
            loudest = loudness_[std::size_t(unit)];
            timeline.finaleSecond = unit;
        }
    }
    std::vector<double> asNumbers(levels.begin(), levels.end());
    timeline.hasFigure = RankCorrelation(asNumbers, loudness_, &timeline.figure);
    return timeline;
}

LoudnessTimeline TimelineSolver::Lay()
{
    // The weight of each level is the mean rank its seconds take among all
    // levels' (centred), as the figure ranks them: first for stretches of
    // the largest Hi and Climax and an even share of Low and Normal, then
    // for the stretches each timeline laid.
    double shares[kLevels];
    shares[kHi] = limits_.hiSeconds / units_;
    shares[kClimax] = limits_.climaxSeconds / units_;
    shares[kLow] = shares[kNormal] = (1.0 - shares[kHi] - shares[kClimax]) / 2.0;
    LoudnessTimeline best;
    bool laid = false;
    for (int round = 0; round < 3; ++round)
    {
        double weight[kLevels];
        double below = 0.0;
        for (int level = 0; level < kLevels; ++level)
        {
            weight[level] = below + shares[level] / 2.0 - 0.5;
            below += shares[level];
        }
        const std::vector<int> levels = Constrained(weight);
        LoudnessTimeline timeline = Timeline(levels);
        if (!laid || (timeline.hasFigure && (!best.hasFigure || timeline.figure > best.figure)))
            best = timeline;
        laid = true;
        double totals[kLevels];
        Totals(levels, totals);
        for (int level = 0; level < kLevels; ++level)
            shares[level] = totals[level] / static_cast<double>(length_);
    }
    return best;
}

} // namespace

bool RankCorrelation(const std::vector<double>& a, const std::vector<double>& b, double* figure)
{
    if (a.size() != b.size() || a.size() < 2)
        return false;
    const std::vector<double> rankA = Ranks(a), rankB = Ranks(b);
    const double middle = (static_cast<double>(a.size()) + 1.0) / 2.0;
    double product = 0.0, squaresA = 0.0, squaresB = 0.0;
    for (std::size_t i = 0; i < a.size(); ++i)
    {
        const double x = rankA[i] - middle, y = rankB[i] - middle;
        product += x * y;
        squaresA += x * x;
        squaresB += y * y;
    }
    if (squaresA == 0.0 || squaresB == 0.0)
        return false;
    *figure = product / std::sqrt(squaresA * squaresB);
    return true;
}

std::vector<double> LevelsPerSecond(const CKeyFrameList& timeline, std::size_t seconds)
{
    std::vector<double> levels;
    for (std::size_t second = 0; second < seconds; ++second)
    {
        std::int32_t value = kNormal;
        if (!timeline.Evaluate(static_cast<float>(second) + 0.5f, &value))
            value = kNormal;
        levels.push_back(value);
    }
    return levels;
}

bool FollowFigure(const CKeyFrameList& timeline, const std::vector<double>& loudness,
                  double* figure)
{
    return RankCorrelation(LevelsPerSecond(timeline, loudness.size()), loudness, figure);
}

LoudnessTimeline LayTimeline(const std::vector<double>& loudness, float length)
{
    if (!(length >= kShortestMusic && length <= kLongestMusic))
        return {};
    TimelineSolver solver(loudness, length);
    return solver.Lay();
}

} // namespace tension
