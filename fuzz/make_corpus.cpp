// make_fuzz_corpus <folder>: replaces the seeds in <folder>/<target>/ with a
// few well-formed files of each kind, from the record's image writer and the
// tests' RIFF and Ogg Vorbis writers; the fuzzer and its dictionary break them.
#include "config/save_config.h"
#include "fuzz/fuzz_support.h"
#include "tests/support/audio_fixtures.h"

#include <cmath>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <initializer_list>
#include <string>
#include <utility>

namespace
{

namespace fs = std::filesystem;
using testing_support::Bytes;

void Write(const fs::path& root, const char* target,
           std::initializer_list<std::pair<const char*, Bytes>> seeds)
{
    fs::remove_all(root / target);
    fs::create_directories(root / target);
    for (const auto& [name, bytes] : seeds)
        std::ofstream(root / target / name, std::ios::binary)
            .write(reinterpret_cast<const char*>(bytes.data()), std::streamsize(bytes.size()));
}

Bytes Tension(double seconds, const std::string& text)
{
    const auto units = static_cast<unsigned>(std::lround(seconds / fuzzing::kTensionLengthUnit));
    Bytes input{static_cast<std::uint8_t>(units), static_cast<std::uint8_t>(units >> 8)};
    input.insert(input.end(), text.begin(), text.end());
    return input;
}

} // namespace

int main(int argc, char** argv)
{
    if (argc != 2)
        return 2;
    const fs::path root = argv[1];

    config::CSaveConfig record;
    record.ResetAll();
    const Bytes defaults = record.SaveToBytes();
    Bytes firstVersion = defaults;
    std::memcpy(firstVersion.data(), "\x00\x10\x00\x10", 4);
    const config::IpEntry entry{{"192", "*", "000", "001"}};
    record.AddAllowEntry(entry);
    record.AddDenyEntry(entry);
    std::strcpy(record.UserBgm()->rows[0].musicPath, "C:\\music\\曲.ogg");
    Write(
        root, "fuzz_settings",
        {{"defaults", defaults}, {"first-version", firstVersion}, {"lists", record.SaveToBytes()}});

    Write(root, "fuzz_tension",
          {{"worked-example", Tension(180, "FILENAME:Test;\nLOW:30;\nHI:60;\nLOW:90;\n"
                                           "CLIMAX:165;\nFINALE:170;\n")},
           {"japanese-crlf",
            Tension(240, "ファイル名:曲名;\r\nコメント:一行目\r\n二行目;\r\n"
                         "ロー:20.5;\r\nハイ:40;\r\nノーマル:55;\r\nクライマックス:220;\r\n")},
           {"warnings-and-comments",
            Tension(100, "// line\nname : x ; /* block\n*/ lt:10;Ht:25;\nLOW:0;\nHI:25.004;\n"
                         "LOW TENSION:7;\nCF:95;\nCF:96;\nFC:a\nb\nc\nd\ne;\nNT:40")}});

    const testing_support::WaveSpec pcm{.dataBytes = 64};
    const testing_support::WaveSpec extensible{
        .formatTag = 0xFFFE, .extra = testing_support::PatternBytes(22), .dataBytes = 64};
    Write(root, "fuzz_riff",
          {{"pcm", testing_support::MakeWave(pcm)},
           {"extensible", testing_support::MakeWave(extensible)},
           {"other-chunks", testing_support::RiffWriter()
                                .Chunk("LIST", testing_support::PatternBytes(5))
                                .Chunk("fmt ", testing_support::FormatChunkBody(pcm))
                                .Chunk("data", testing_support::PatternBytes(7))
                                .Finish()}});

    // Several pages of audio, which the decoder seeks among, and a chain of
    // two streams of other channel counts and rates.
    Bytes chained = testing_support::EncodeOggVorbis({1, 8000, 3000, 0.1f});
    const Bytes second = testing_support::EncodeOggVorbis({2, 11025, 6000, 0.1f});
    chained.insert(chained.end(), second.begin(), second.end());
    Write(root, "fuzz_ogg",
          {{"several-pages", testing_support::EncodeOggVorbis({1, 8000, 8000 * 12, -0.1f})},
           {"chained", chained}});
    return 0;
}
