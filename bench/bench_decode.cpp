// Decoding speed and memory of a whole Ogg Vorbis file through
// CSoundBuffer::Open, against Debian's oggdec on the same file.
//
// The benchmark makes its own input: 480 seconds of stereo 44.1 kHz music
// encoded with libvorbisenc at quality 0.3 (oggenc's default -q 3). Each run
// decodes it in a fresh process: ours (this program again, with --decode)
// and `oggdec -Q -o /dev/null`, alternately; the medians of the wall times
// are compared. The last line is `ratio R`, R = our time / oggdec's time.
//
// Peak memory is measured inside the decoding process: the growth of the
// resident set's high-water mark (VmHWM) over the resident set before Open.
// Target: ours within 1.10 x oggdec, peak at most file + 1.1 x PCM.
#include "bench/bench_support.h"
#include "sound/sound_buffer.h"
#include "tests/support/audio_fixtures.h"

#include <algorithm>
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

constexpr long kSampleRate = 44100;
constexpr int kChannels = 2;
constexpr std::uint64_t kSeconds = 480;
constexpr float kQuality = 0.3f;

// A "kB" field of /proc/self/status, in bytes.
long long StatusBytes(const char* field)
{
    std::FILE* status = std::fopen("/proc/self/status", "r");
    if (status == nullptr)
        return -1;
    char line[256];
    long long bytes = -1;
    const std::size_t length = std::strlen(field);
    while (std::fgets(line, sizeof line, status) != nullptr)
    {
        if (std::strncmp(line, field, length) == 0 && line[length] == ':')
            bytes = std::atoll(line + length + 1) * 1024;
    }
    std::fclose(status);
    return bytes;
}

// The child: one Open, then "seconds peakGrowth dataBytes" on stdout.
int DecodeOnce(const char* path)
{
    const long long before = StatusBytes("VmRSS");
    sound::CSoundBuffer buffer;
    const double start = bench::Now();
    const bool opened = buffer.Open(path, 1, sound::kCapsStatic);
    const double seconds = bench::Now() - start;
    const long long peak = StatusBytes("VmHWM");
    if (!opened)
        return 1;
    std::printf("%.6f %lld %u\n", seconds, peak - before, buffer.GetInfo().dataBytes);
    return 0;
}

std::string SelfPath()
{
    char path[4096];
    const ssize_t length = readlink("/proc/self/exe", path, sizeof path - 1);
    return length > 0 ? std::string(path, std::size_t(length)) : std::string();
}

} // namespace

int main(int argc, char** argv)
{
    if (argc == 3 && std::strcmp(argv[1], "--decode") == 0)
        return DecodeOnce(argv[2]);
    int runs = 7;
    if (argc == 3 && std::strcmp(argv[1], "--runs") == 0)
        runs = std::max(1, std::atoi(argv[2]));

#if defined(__SANITIZE_ADDRESS__)
    std::printf("note: this build has AddressSanitizer: its figures say little; measure a\n"
                "      Release build without sanitizers (see docs/performance.md)\n");
#endif
    if (bench::Run({"oggdec", "-Q", "--help"}, false).status != 0)
    {
        std::fprintf(stderr, "oggdec is missing: apt-get install -y vorbis-tools\n");
        return 2;
    }

    char folder[] = "/tmp/vek-bench-XXXXXX";
    if (mkdtemp(folder) == nullptr)
        return 2;
    const std::string path = std::string(folder) + "/music.ogg";
    testing_support::OggFixture fixture;
    fixture.channels = kChannels;
    fixture.sampleRate = kSampleRate;
    fixture.samplesPerChannel = kSeconds * kSampleRate;
    fixture.quality = kQuality;
    const double encodeStart = bench::Now();
    const testing_support::Bytes ogg =
        testing_support::EncodeOggVorbis(fixture, bench::MusicSource(kSampleRate));
    std::FILE* out = std::fopen(path.c_str(), "wb");
    if (out == nullptr || std::fwrite(ogg.data(), 1, ogg.size(), out) != ogg.size() ||
        std::fclose(out) != 0)
    {
        std::fprintf(stderr, "cannot write %s\n", path.c_str());
        return 2;
    }
    const double pcmBytes = double(fixture.samplesPerChannel) * kChannels * 2;
    std::printf("input: %llu s stereo %ld Hz Ogg Vorbis at quality %.1f, %zu bytes "
                "(encoded in %.1f s); PCM %.0f bytes\n",
                static_cast<unsigned long long>(kSeconds), kSampleRate, kQuality, ogg.size(),
                bench::Now() - encodeStart, pcmBytes);

    const std::string self = SelfPath();
    std::vector<double> ours, opens, oggdec, peaks;
    for (int run = 0; run < runs; ++run)
    {
        const bench::Spawned reference =
            bench::Run({"oggdec", "-Q", "-o", "/dev/null", path}, false);
        const bench::Spawned decoded = bench::Run({self, "--decode", path}, true);
        double openSeconds = 0;
        long long peak = 0;
        unsigned dataBytes = 0;
        if (decoded.status != 0 || reference.status != 0 ||
            std::sscanf(decoded.output.c_str(), "%lf %lld %u", &openSeconds, &peak, &dataBytes) !=
                3 ||
            double(dataBytes) != pcmBytes)
        {
            std::fprintf(stderr, "run %d failed (ours %d, oggdec %d)\n", run, decoded.status,
                         reference.status);
            return 1;
        }
        ours.push_back(decoded.seconds);
        opens.push_back(openSeconds);
        oggdec.push_back(reference.seconds);
        peaks.push_back(double(peak));
        std::printf("run %d: ours %.3f s (Open %.3f s), oggdec %.3f s, peak %.1f MiB\n", run,
                    decoded.seconds, openSeconds, reference.seconds, double(peak) / 1048576.0);
    }
    std::remove(path.c_str());
    rmdir(folder);

    const double ourTime = bench::Median(ours);
    const double theirTime = bench::Median(oggdec);
    const double peak = *std::max_element(peaks.begin(), peaks.end());
    const double fileBytes = double(ogg.size());
    const double ratio = ourTime / theirTime;
    const double allowed = fileBytes + 1.1 * pcmBytes;
    std::printf("ours (CSoundBuffer::Open in a fresh process), median of %d: %.3f s "
                "(Open alone %.3f s)\n",
                runs, ourTime, bench::Median(opens));
    std::printf("oggdec -Q -o /dev/null, median of %d: %.3f s\n", runs, theirTime);
    std::printf("peak memory during Open: %.0f bytes = file + %.3f x PCM "
                "(target at most file + 1.1 x PCM = %.0f bytes): %s\n",
                peak, (peak - fileBytes) / pcmBytes, allowed, peak <= allowed ? "met" : "missed");
    std::printf("time target (ratio at most 1.10): %s\n", ratio <= 1.10 ? "met" : "missed");
    std::printf("ratio %.3f\n", ratio);
    return 0;
}
