// How well `vekcfg draft` follows real music, and what it costs.
//
// Figures: over the music of Debian's game packages (the folders below, or
// those given on the command line; nothing is copied), every piece of 60 to
// 480 seconds is measured once, and two timelines are laid on it: the fixed
// pattern that drafts used before (the same shares of every length) and the
// draft laid on the loudness. For each: the rank correlation of each
// second's level with its loudness, and the check's verdict on the draft.
// Targets: every draft passes, mean figure at least 0.65, none below 0.3.
//
// Time: 480 seconds of stereo 44.1 kHz music made here (the tests' tune
// encoded at quality 0.3), alternately drafted by `vekcfg draft` (the one
// beside this program) and decoded alone by this program (--decode: the
// decode the check makes, into memory), each in a fresh process; the
// medians are compared. Target: the draft at most 1.15 x the decode.
// --time-only skips the figures, --runs N sets the rounds (7).
#include "bench/bench_support.h"
#include "sound/audio_file.h"
#include "sound/loudness.h"
#include "tension/loudness_timeline.h"
#include "tension/tension_draft.h"
#include "tension/tension_file.h"

#include <algorithm>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <string>
#include <unistd.h>
#include <vector>

namespace
{

namespace fs = std::filesystem;

const char* const kMusicFolders[] = {"/usr/share/games/hedgewars/Data/Music",
                                     "/usr/share/games/supertux2/music"};

// The drafts of before: the same shares of every length.
const std::pair<const char*, double> kFixedPattern[] = {
    {"LOW", 0.10}, {"HI", 0.30},  {"NORMAL", 0.42}, {"LOW", 0.55},
    {"HI", 0.70},  {"LOW", 0.76}, {"CLIMAX", 0.92}, {"FINALE", 0.94},
};

std::string FixedPattern(float length)
{
    std::string text = "FILENAME:fixed;\n";
    for (const auto& [key, share] : kFixedPattern)
    {
        char entry[64];
        std::snprintf(entry, sizeof entry, "%s:%.1f;\n", key,
                      std::floor(share * length * 10.0 + 1e-6) / 10.0);
        text += entry;
    }
    return text;
}

// The figure of a tension file's timeline; NaN when it has none.
double FigureOf(const std::string& text, float length, const std::vector<double>& loudness,
                bool* passes)
{
    tension::CTensionFile file;
    *passes = file.ParseForLength(length, text.c_str(), ':', ';', nullptr);
    double figure = std::nan("");
    if (file.GetTimeline() != nullptr &&
        !tension::FollowFigure(*file.GetTimeline(), loudness, &figure))
        figure = std::nan("");
    return figure;
}

int DecodeOnce(const char* path)
{
    sound::DecodedAudio audio;
    sound::SourceKind kind;
    return sound::DecodeAudioFile(path, &audio, &kind) ? 0 : 1;
}

std::string BesideSelf(const char* name)
{
    char path[4096];
    const ssize_t length = readlink("/proc/self/exe", path, sizeof path - 1);
    const std::string self(path, length > 0 ? std::size_t(length) : 0);
    return self.substr(0, self.find_last_of('/') + 1) + name;
}

bool Figures(const std::vector<std::string>& folders)
{
    std::vector<fs::path> pieces;
    for (const std::string& folder : folders)
    {
        std::error_code error;
        for (fs::recursive_directory_iterator it(folder, error), end; !error && it != end;
             it.increment(error))
        {
            if (it->path().extension() == ".ogg" || it->path().extension() == ".wav")
                pieces.push_back(it->path());
        }
    }
    std::sort(pieces.begin(), pieces.end());
    std::printf("%-44s %8s %7s %7s %s\n", "piece", "seconds", "fixed", "draft", "check");
    int count = 0, passed = 0;
    double fixedSum = 0.0, draftSum = 0.0, lowest = 1.0;
    for (const fs::path& piece : pieces)
    {
        sound::MusicMeasure music;
        if (!sound::MeasureMusic(piece.c_str(), &music) ||
            !(music.length >= tension::kShortestMusic && music.length <= tension::kLongestMusic))
            continue;
        bool fixedPasses = false, draftPasses = false;
        const double fixed =
            FigureOf(FixedPattern(music.length), music.length, music.loudness, &fixedPasses);
        const std::string draftText =
            tension::DraftTension(tension::DraftName(piece.string()), music.length, music.loudness);
        const double draft = FigureOf(draftText, music.length, music.loudness, &draftPasses);
        const std::string name =
            piece.parent_path().filename().string() + "/" + piece.filename().string();
        std::printf("%-44s %8.1f %7.3f %7.3f %s\n", name.c_str(), double(music.length), fixed,
                    draft, draftPasses ? "passes" : "FAILS");
        ++count;
        passed += draftPasses ? 1 : 0;
        fixedSum += std::isnan(fixed) ? 0.0 : fixed;
        draftSum += std::isnan(draft) ? 0.0 : draft;
        lowest = std::min(lowest, std::isnan(draft) ? 0.0 : draft);
    }
    if (count == 0)
    {
        std::printf("no music of 60 to 480 seconds found: install hedgewars-data and "
                    "supertux-data, or name folders of music\n");
        return false;
    }
    const double fixedMean = fixedSum / count, draftMean = draftSum / count;
    std::printf("pieces %d, drafts passing %d\n", count, passed);
    std::printf("mean figure: fixed pattern %.3f, draft %.3f; lowest draft %.3f\n", fixedMean,
                draftMean, lowest);
    const bool met = count >= 20 && passed == count && draftMean >= 0.65 && lowest >= 0.3;
    std::printf("targets (at least 20 pieces, all pass, mean >= 0.65, none below 0.3): %s\n",
                met ? "met" : "NOT met");
    return met;
}

void Time(int runs)
{
    const std::string music = "/tmp/bench_draft_480.ogg";
    testing_support::OggFixture fixture;
    fixture.samplesPerChannel = 480 * 44100;
    fixture.quality = 0.3f;
    const testing_support::Bytes encoded =
        testing_support::EncodeOggVorbis(fixture, bench::MusicSource(44100));
    std::FILE* out = std::fopen(music.c_str(), "wb");
    if (out == nullptr)
        return;
    std::fwrite(encoded.data(), 1, encoded.size(), out);
    std::fclose(out);
    std::vector<double> drafts, decodes;
    const std::string self = BesideSelf("bench_draft"), vekcfg = BesideSelf("vekcfg");
    for (int run = 0; run < runs; ++run)
    {
        decodes.push_back(bench::Run({self, "--decode", music}, false).seconds);
        drafts.push_back(
            bench::Run({vekcfg, "draft", music, "/tmp/bench_draft_480.txt"}, false).seconds);
    }
    const double draft = bench::Median(drafts), decode = bench::Median(decodes);
    std::printf("480 s of music: draft %.3f s, decode alone %.3f s (medians of %d)\n", draft,
                decode, runs);
    std::printf("ratio %.2f (target at most 1.15)\n", draft / decode);
    std::remove(music.c_str());
    std::remove("/tmp/bench_draft_480.txt");
}

} // namespace

int main(int argc, char** argv)
{
    if (argc == 3 && std::string(argv[1]) == "--decode")
        return DecodeOnce(argv[2]);
    int runs = 7;
    bool timeOnly = false;
    std::vector<std::string> folders;
    for (int i = 1; i < argc; ++i)
    {
        if (std::string(argv[i]) == "--runs" && i + 1 < argc)
            runs = std::atoi(argv[++i]);
        else if (std::string(argv[i]) == "--time-only")
            timeOnly = true;
        else
            folders.emplace_back(argv[i]);
    }
    if (folders.empty())
        folders.assign(std::begin(kMusicFolders), std::end(kMusicFolders));
    const bool met = timeOnly || Figures(folders);
    Time(runs);
    return met ? 0 : 1;
}
