// `vekcfg check-config -j N` on a settings file with ten rows of 240-second
// Ogg Vorbis music, against ten sequential `oggdec` runs of the same files.
//
// The benchmark makes its own input: 240 seconds of stereo 44.1 kHz music
// encoded with libvorbisenc at quality 0.3 (oggenc's default -q 3), written
// under ten names, each with a tension file the check accepts, and a
// settings file whose ten rows name them. Each round times, alternately,
// one `vekcfg check-config -j N` process (all ten checks, N at once; N is 2
// unless --jobs says otherwise) and ten `oggdec -Q -o /dev/null` processes
// one after the other; the medians of the rounds are compared. The last
// line is `ratio R`, R = vekcfg's time / oggdec's time. Target on two
// cores: at most 0.60 (two cores cannot go below 0.5). The peak resident
// set of check-config is given against one row's PCM: at most N rows may be
// decoded at once.
#include "bench/bench_support.h"
#include "config/save_config.h"
#include "tests/support/audio_fixtures.h"

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <fcntl.h>
#include <spawn.h>
#include <string>
#include <sys/wait.h>
#include <time.h>
#include <unistd.h>
#include <vector>

extern char** environ;

namespace
{

constexpr int kRows = 10;
constexpr long kSampleRate = 44100;
constexpr std::uint64_t kSeconds = 240;

bool WriteFile(const std::string& path, const void* data, std::size_t size)
{
    std::FILE* out = std::fopen(path.c_str(), "wb");
    const bool written = out != nullptr && std::fwrite(data, 1, size, out) == size;
    return out != nullptr && std::fclose(out) == 0 && written;
}

std::string BesideSelf(const char* name)
{
    char path[4096];
    const ssize_t length = readlink("/proc/self/exe", path, sizeof path - 1);
    const std::string self(path, length > 0 ? std::size_t(length) : 0);
    return self.substr(0, self.find_last_of('/') + 1) + name;
}

} // namespace

int main(int argc, char** argv)
{
    int rounds = 5;
    int jobs = 2;
    for (int i = 1; i + 1 < argc; i += 2)
    {
        if (std::strcmp(argv[i], "--runs") == 0)
            rounds = std::max(1, std::atoi(argv[i + 1]));
        else if (std::strcmp(argv[i], "--jobs") == 0)
            jobs = std::max(1, std::atoi(argv[i + 1]));
    }

#if defined(__SANITIZE_ADDRESS__)
    std::printf("note: this build has AddressSanitizer: its figures say little; measure a\n"
                "      Release build without sanitizers (see docs/performance.md)\n");
#endif
    const std::string vekcfg = BesideSelf("vekcfg");
    if (bench::Run({"oggdec", "-Q", "--help"}, false).status != 0)
    {
        std::fprintf(stderr, "oggdec is missing: apt-get install -y vorbis-tools\n");
        return 2;
    }
    if (access(vekcfg.c_str(), X_OK) != 0)
    {
        std::fprintf(stderr, "%s is missing: build the vekcfg target\n", vekcfg.c_str());
        return 2;
    }

    char folder[] = "/tmp/vek-bench-XXXXXX";
    if (mkdtemp(folder) == nullptr)
        return 2;
    testing_support::OggFixture fixture;
    fixture.channels = 2;
    fixture.sampleRate = kSampleRate;
    fixture.samplesPerChannel = kSeconds * kSampleRate;
    fixture.quality = 0.3f;
    const double encodeStart = bench::Now();
    const testing_support::Bytes ogg =
        testing_support::EncodeOggVorbis(fixture, bench::MusicSource(kSampleRate));
    const double encodeSeconds = bench::Now() - encodeStart;

    // Limits for 240 s: Hi at most 48 s, Climax at most 24 s.
    const char tension[] = "FILENAME:Bench;\nLOW:30;\nHI:60;\nLOW:100;\nCLIMAX:220;\n"
                           "FINALE:230;\n";
    config::CSaveConfig record;
    record.ResetAll();
    std::vector<std::string> music;
    std::vector<std::string> created;
    for (int row = 0; row < kRows; ++row)
    {
        const std::string base = std::string(folder) + "/row" + std::to_string(row + 1);
        music.push_back(base + ".ogg");
        const std::string tensionPath = base + ".txt";
        if (!WriteFile(music.back(), ogg.data(), ogg.size()) ||
            !WriteFile(tensionPath, tension, sizeof tension - 1))
        {
            std::fprintf(stderr, "cannot write into %s\n", folder);
            return 2;
        }
        created.push_back(music.back());
        created.push_back(tensionPath);
        config::UserBgmRow& stored = record.UserBgm()->rows[row];
        std::snprintf(stored.musicPath, sizeof stored.musicPath, "%s", music.back().c_str());
        std::snprintf(stored.tensionPath, sizeof stored.tensionPath, "%s", tensionPath.c_str());
    }
    const std::string settings = std::string(folder) + "/GameConfig.dat";
    if (!record.SaveToPath(settings.c_str()))
        return 2;
    created.push_back(settings);
    std::printf("input: %d rows of %llu s stereo %ld Hz Ogg Vorbis at quality 0.3, %zu bytes "
                "each (encoded in %.1f s); PCM %.0f bytes each\n",
                kRows, static_cast<unsigned long long>(kSeconds), kSampleRate, ogg.size(),
                encodeSeconds, double(fixture.samplesPerChannel) * 2 * 2);

    std::vector<double> ours, theirs;
    long peakKilobytes = 0;
    for (int round = 0; round < rounds; ++round)
    {
        double start = bench::Now();
        for (const std::string& path : music)
        {
            if (bench::Run({"oggdec", "-Q", "-o", "/dev/null", path}, false).status != 0)
            {
                std::fprintf(stderr, "oggdec failed on %s\n", path.c_str());
                return 1;
            }
        }
        theirs.push_back(bench::Now() - start);

        start = bench::Now();
        const bench::Spawned checked =
            bench::Run({vekcfg, "check-config", "-j", std::to_string(jobs), settings}, true);
        ours.push_back(bench::Now() - start);
        peakKilobytes = std::max(peakKilobytes, checked.peakKilobytes);
        const long lines = std::count(checked.output.begin(), checked.output.end(), '\n');
        if (checked.status != 0 || lines != kRows)
        {
            std::fprintf(stderr, "vekcfg check-config failed (status %d):\n%s\n", checked.status,
                         checked.output.c_str());
            return 1;
        }
        std::printf("round %d: vekcfg check-config -j %d %.3f s, 10 x oggdec %.3f s\n", round, jobs,
                    ours.back(), theirs.back());
    }
    for (const std::string& path : created)
        std::remove(path.c_str());
    rmdir(folder);

    const double ourTime = bench::Median(ours);
    const double theirTime = bench::Median(theirs);
    const double ratio = ourTime / theirTime;
    const double pcmBytes = double(fixture.samplesPerChannel) * 2 * 2;
    std::printf("vekcfg check-config -j %d (10 rows), median of %d: %.3f s\n", jobs, rounds,
                ourTime);
    std::printf("10 sequential oggdec -Q -o /dev/null, median of %d: %.3f s\n", rounds, theirTime);
    std::printf("peak resident set of check-config: %ld kB = %.2f x one row's PCM\n", peakKilobytes,
                double(peakKilobytes) * 1024.0 / pcmBytes);
    std::printf("time target (ratio at most 0.60): %s\n", ratio <= 0.60 ? "met" : "missed");
    std::printf("ratio %.3f\n", ratio);
    return 0;
}
