#pragma once

// What the benchmarks share: a clock, running a program to its end, the
// music they encode, and the median of their rounds.

#include "tests/support/audio_fixtures.h"

#include <string>
#include <vector>

namespace bench
{

// Seconds on a monotonic clock.
double Now();

struct Spawned
{
    double seconds = 0.0;
    int status = -1;
    std::string output;
    // The process's peak resident set.
    long peakKilobytes = 0;
};

// Runs `arguments` (the program is found on PATH) to its end and times it;
// its standard output is kept when `capture`, else dropped, and its
// standard error is always dropped.
Spawned Run(const std::vector<std::string>& arguments, bool capture);

// Music-like input: a tune of three voices with a broadband layer (a soft noise bed
// and a noise burst on every beat), so that the encoder spends bits as it
// does on real music (about 110 kbit/s at quality 0.3) instead of
// compressing bare tones to almost nothing.
testing_support::SampleSource MusicSource(long sampleRate);

double Median(std::vector<double> values);

} // namespace bench
