// Writes the seed corpora of the fuzz targets into fuzz/corpus/<target>/,
// made by our own code: the record's own image writer and the tests' RIFF
// and Ogg Vorbis fixture writers. Kept small: a few well-formed files of each
// kind and a few that are broken in the ways the readers must refuse.
//
// Usage: make_fuzz_corpus <corpus folder>   (the folder's old seeds are replaced)
#include "config/save_config.h"
#include "fuzz/fuzz_tension.h"
#include "tests/support/audio_fixtures.h"
#include "tests/support/ogg_pages.h"

#include <cmath>
#include <cstdio>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <stdexcept>
#include <string>
#include <utility>
#include <vector>

namespace
{

namespace fs = std::filesystem;
using testing_support::Bytes;

class Corpus
{
public:
    Corpus(const fs::path& root, const char* target) : folder_(root / target)
    {
        fs::remove_all(folder_);
        fs::create_directories(folder_);
    }

    void Add(const std::string& name, const Bytes& bytes) const
    {
        std::ofstream out(folder_ / name, std::ios::binary);
        out.write(reinterpret_cast<const char*>(bytes.data()), std::streamsize(bytes.size()));
        if (!out)
            throw std::runtime_error("cannot write " + (folder_ / name).string());
    }

private:
    fs::path folder_;
};

void PutU32(Bytes& out, std::uint32_t value)
{
    for (int i = 0; i < 4; ++i)
        out.push_back(static_cast<std::uint8_t>(value >> (8 * i)));
}

config::IpEntry Entry(const char* a, const char* b, const char* c, const char* d)
{
    config::IpEntry entry{};
    std::strcpy(entry.octets[0], a);
    std::strcpy(entry.octets[1], b);
    std::strcpy(entry.octets[2], c);
    std::strcpy(entry.octets[3], d);
    return entry;
}

// An image whose seven sections are stored with the given lengths, each
// holding the first bytes of the record's section (zeros beyond it).
Bytes SectionsOfLengths(config::CSaveConfig& record, std::uint32_t version,
                        const std::uint32_t (&lengths)[7])
{
    const std::pair<const void*, std::size_t> sections[7] = {
        {record.Graphics(), sizeof(config::ConfigGraphics)},
        {record.Game(), sizeof(config::ConfigGame)},
        {record.Network(), sizeof(config::ConfigNetwork)},
        {record.Replay(), sizeof(config::ConfigReplay)},
        {record.UserBgm(), sizeof(config::ConfigUserBgm)},
        {record.Keys(), sizeof(config::ConfigKeys)},
        {record.RadioChat(), sizeof(config::ConfigRadioChat)},
    };
    Bytes image;
    PutU32(image, version);
    for (int i = 0; i < 7; ++i)
    {
        PutU32(image, lengths[i]);
        const auto* bytes = static_cast<const std::uint8_t*>(sections[i].first);
        for (std::uint32_t b = 0; b < lengths[i]; ++b)
            image.push_back(b < sections[i].second ? bytes[b] : 0);
    }
    return image;
}

void MakeSettings(const fs::path& root)
{
    const Corpus corpus(root, "fuzz_settings");
    config::CSaveConfig record;
    record.ResetAll();
    corpus.Add("defaults", record.SaveToBytes());

    Bytes first = record.SaveToBytes();
    first[0] = 0x00, first[1] = 0x10, first[2] = 0x00, first[3] = 0x10;
    corpus.Add("first-version", first);

    // Sections of an older layout (shorter) and of a later one (longer; no
    // lists, which a shorter network section cannot count).
    corpus.Add("short-sections",
               SectionsOfLengths(record, 0x12000000, {12, 30, 400, 64, 2600, 200, 100}));
    corpus.Add("long-sections",
               SectionsOfLengths(record, 0x13001000, {24, 44, 472, 128, 5204, 500, 496}));

    record.AddAllowEntry(Entry("192", "168", "000", "001"));
    record.AddAllowEntry(Entry("*", "*", "*", "*"));
    record.AddDenyEntry(Entry("010", "*", "030", "040"));
    record.AddConnectEntry(Entry("127", "000", "000", "001"));
    std::strcpy(record.Network()->lobbyId, "表ロビー");
    std::strcpy(record.UserBgm()->rows[0].musicPath, "C:\\music\\曲.ogg");
    std::strcpy(record.UserBgm()->rows[0].tensionPath, "C:\\music\\曲.txt");
    std::strcpy(record.RadioChat()->entries[0].text, "了解！");
    const Bytes lists = record.SaveToBytes();
    corpus.Add("lists", lists);
    corpus.Add("cut-in-user-music", Bytes(lists.begin(), lists.begin() + 680 + 48 + 1000));
}

Bytes TensionInput(double seconds, const std::string& text)
{
    const auto units = static_cast<unsigned>(std::lround(seconds / fuzzing::kTensionLengthUnit));
    Bytes input{static_cast<std::uint8_t>(units), static_cast<std::uint8_t>(units >> 8)};
    input.insert(input.end(), text.begin(), text.end());
    return input;
}

void MakeTension(const fs::path& root)
{
    const Corpus corpus(root, "fuzz_tension");
    corpus.Add("worked-example", TensionInput(180, "FILENAME:Test;\nLOW:30;\nHI:60;\nLOW:90;\n"
                                                   "CLIMAX:165;\nFINALE:170;\n"));
    corpus.Add("japanese-keys",
               TensionInput(240, "ファイル名:曲名;\r\nコメント:一行目\r\n二行目;\r\n"
                                 "ローテンション:20.5;\r\nハイテンション:40;\r\n"
                                 "ノーマル:70;\r\nクライマックス:200;\r\nフィナーレ:210;\r\n"));
    corpus.Add("comments-and-case",
               TensionInput(100, "// a line comment\nname : x ; /* a block\ncomment */ low:10;\n"
                                 "Lt:20;Ht:25;nt:40;ct:90;cf:95;\nfc:c;"));
    corpus.Add("warnings", TensionInput(60, "LOW:0;\nLOW:60;\nLOW:-1;\nLOW:abc;\nHI:5;\nHI:5.004;\n"
                                            "LOW TENSION:7;\nUNKNOWN:1;\nNAME:n;"));
    corpus.Add("every-limit", TensionInput(480, "NAME:0123456789012345678901234567890123456789;\n"
                                                "COMMENT:a\nb\nc\nd\ne;\nLOW:1;NORMAL:2;LOW:3;"
                                                "NORMAL:4;LOW:5;NORMAL:6;LOW:7;NORMAL:8;HI:9;"
                                                "CLIMAX:400;HI:401;CLIMAX:402;FINALE:1;FINALE:2;"));
    corpus.Add("unterminated-comment", TensionInput(120, "NAME:x;\n/* not closed"));
    corpus.Add("value-at-the-end", TensionInput(120, "NAME:x;\nLOW:30"));
    corpus.Add("too-short", TensionInput(59.5, "NAME:x;"));
    corpus.Add("too-long", TensionInput(1000, "NAME:x;"));
}

void MakeRiff(const fs::path& root)
{
    using testing_support::FormatChunkBody;
    using testing_support::MakeWave;
    using testing_support::PatternBytes;
    using testing_support::RiffWriter;
    using testing_support::WaveSpec;
    const Corpus corpus(root, "fuzz_riff");

    WaveSpec pcm;
    pcm.dataBytes = 64;
    corpus.Add("pcm-stereo-16", MakeWave(pcm));

    WaveSpec mono = pcm;
    mono.channels = 1;
    mono.bitsPerSample = 8;
    mono.sampleRate = 8000;
    corpus.Add("pcm-mono-8", MakeWave(mono));

    WaveSpec extensible = pcm;
    extensible.formatTag = 0xFFFE;
    extensible.extra = PatternBytes(22);
    corpus.Add("extensible", MakeWave(extensible));

    corpus.Add("other-chunks", RiffWriter()
                                   .Chunk("LIST", PatternBytes(5))
                                   .Chunk("fmt ", FormatChunkBody(pcm))
                                   .Chunk("fact", PatternBytes(4))
                                   .Chunk("data", PatternBytes(7))
                                   .Finish());

    Bytes afterAvi = RiffWriter().Chunk("avih", PatternBytes(8)).Finish("AVI ");
    const Bytes wave = MakeWave(mono);
    afterAvi.insert(afterAvi.end(), wave.begin(), wave.end());
    corpus.Add("after-another-form", afterAvi);

    corpus.Add("data-claims-more", RiffWriter()
                                       .Chunk("fmt ", FormatChunkBody(pcm))
                                       .ChunkClaiming("data", 2000, PatternBytes(16))
                                       .Finish());
    WaveSpec silent = pcm;
    silent.channels = 0;
    corpus.Add("no-channels", MakeWave(silent));
}

void MakeOgg(const fs::path& root)
{
    using testing_support::EncodeOggVorbis;
    using testing_support::OggFixture;
    const Corpus corpus(root, "fuzz_ogg");

    OggFixture mono;
    mono.channels = 1;
    mono.sampleRate = 8000;
    mono.samplesPerChannel = 3000;
    const Bytes monoStream = EncodeOggVorbis(mono);
    corpus.Add("mono", monoStream);

    OggFixture stereo;
    stereo.channels = 2;
    stereo.sampleRate = 11025;
    stereo.samplesPerChannel = 6000;
    const Bytes stereoStream = EncodeOggVorbis(stereo);
    corpus.Add("stereo", stereoStream);

    // The last page numbered as if one before it were missing: a hole.
    Bytes hole = stereoStream;
    const std::size_t sequence =
        hole.size() - testing_support::SplitOggPages(stereoStream).back().size() + 18;
    ++hole[sequence];
    testing_support::RepairOggChecksums(hole.data(), hole.size());
    corpus.Add("hole", hole);

    // Two streams one after the other: a chained file, mono then stereo.
    Bytes chained = monoStream;
    chained.insert(chained.end(), stereoStream.begin(), stereoStream.end());
    corpus.Add("chained", chained);

    // Several pages of audio, which the decoder seeks among; and the same
    // with a last page whose granule position claims far more samples than
    // the stream holds (with a single page of audio the claim would move the
    // stream's start as well and cancel out).
    OggFixture paged;
    paged.channels = 1;
    paged.sampleRate = 8000;
    paged.samplesPerChannel = 8000 * 12;
    paged.quality = -0.1f;
    const Bytes pagedStream = EncodeOggVorbis(paged);
    corpus.Add("several-pages", pagedStream);
    Bytes claims = pagedStream;
    const std::size_t granule =
        claims.size() - testing_support::SplitOggPages(pagedStream).back().size() + 6;
    constexpr std::uint64_t kClaimed = 8000 * 60;
    for (int i = 0; i < 8; ++i)
        claims[granule + i] = static_cast<std::uint8_t>(kClaimed >> (8 * i));
    testing_support::RepairOggChecksums(claims.data(), claims.size());
    corpus.Add("claims-more-samples", claims);
}

} // namespace

int main(int argc, char** argv)
{
    if (argc != 2)
    {
        std::fprintf(stderr, "usage: make_fuzz_corpus <corpus folder>\n");
        return 2;
    }
    const fs::path root = argv[1];
    MakeSettings(root);
    MakeTension(root);
    MakeRiff(root);
    MakeOgg(root);
    return 0;
}
