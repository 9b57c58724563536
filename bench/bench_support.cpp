#include "bench/bench_support.h"

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <fcntl.h>
#include <spawn.h>
#include <sys/resource.h>
#include <sys/wait.h>
#include <time.h>
#include <unistd.h>

extern char** environ;

namespace bench
{

double Now()
{
    timespec now{};
    clock_gettime(CLOCK_MONOTONIC, &now);
    return double(now.tv_sec) + double(now.tv_nsec) * 1e-9;
}

Spawned Run(const std::vector<std::string>& arguments, bool capture)
{
    std::vector<char*> argv;
    for (const std::string& argument : arguments)
        argv.push_back(const_cast<char*>(argument.c_str()));
    argv.push_back(nullptr);
    int channel[2] = {-1, -1};
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    if (capture && pipe(channel) == 0)
    {
        posix_spawn_file_actions_adddup2(&actions, channel[1], STDOUT_FILENO);
        posix_spawn_file_actions_addclose(&actions, channel[0]);
    }
    else
    {
        posix_spawn_file_actions_addopen(&actions, STDOUT_FILENO, "/dev/null", O_WRONLY, 0);
    }
    posix_spawn_file_actions_addopen(&actions, STDERR_FILENO, "/dev/null", O_WRONLY, 0);
    Spawned result;
    const double start = Now();
    pid_t child = 0;
    if (posix_spawnp(&child, argv[0], &actions, nullptr, argv.data(), environ) == 0)
    {
        if (capture)
        {
            close(channel[1]);
            char chunk[512];
            for (ssize_t got; (got = read(channel[0], chunk, sizeof chunk)) > 0;)
                result.output.append(chunk, std::size_t(got));
            close(channel[0]);
        }
        rusage usage{};
        wait4(child, &result.status, 0, &usage);
        result.peakKilobytes = usage.ru_maxrss;
    }
    result.seconds = Now() - start;
    posix_spawn_file_actions_destroy(&actions);
    return result;
}

testing_support::SampleSource MusicSource(long sampleRate)
{
    return [sampleRate](float** channels, int channelCount, int count, std::uint64_t first)
    {
        constexpr double kTwoPi = 6.283185307179586;
        static std::uint32_t seed = 12345;
        for (int i = 0; i < count; ++i)
        {
            const std::uint64_t n = first + std::uint64_t(i);
            const double t = double(n) / double(sampleRate);
            // A melody of three voices whose notes change every quarter second.
            const int step = static_cast<int>(t * 4.0);
            const double root = 220.0 * std::pow(2.0, ((step * 5) % 12) / 12.0);
            const double tune = 0.25 * std::sin(kTwoPi * root * t) +
                                0.15 * std::sin(kTwoPi * root * 1.5 * t) +
                                0.10 * std::sin(kTwoPi * root * 2.01 * t);
            const double beat = double(n % std::uint64_t(sampleRate / 2)) / double(sampleRate);
            const double burst = beat < 0.08 ? 0.35 * (1.0 - beat / 0.08) : 0.0;
            for (int c = 0; c < channelCount; ++c)
            {
                seed = seed * 1664525u + 1013904223u;
                const double noise = double(seed >> 8) / double(1u << 24) * 2.0 - 1.0;
                channels[c][i] =
                    static_cast<float>(tune * (c % 2 == 0 ? 1.0 : 0.8) + noise * (0.06 + burst));
            }
        }
    };
}

double Median(std::vector<double> values)
{
    std::sort(values.begin(), values.end());
    const std::size_t middle = values.size() / 2;
    return values.size() % 2 != 0 ? values[middle] : (values[middle - 1] + values[middle]) / 2;
}

} // namespace bench
