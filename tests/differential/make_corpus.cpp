// Writes the files on which the two builds of vekcfg must agree, and the list
// of commands to run on them (cases.txt, one command a line, paths relative
// to the folder): tension files in both line ends and with the runtime's odd
// corners, music of many wave formats and Ogg Vorbis, missing files, and
// settings files with fixed text fields filled to their last byte.
//
// Usage: make_differential_corpus <folder>
#include "config/save_config.h"
#include "tests/support/audio_fixtures.h"
#include "tests/support/temp_folder.h"

#include <cmath>
#include <cstring>
#include <filesystem>
#include <fstream>
#include <string>
#include <utility>
#include <vector>

namespace
{

namespace fs = std::filesystem;
using testing_support::Bytes;

// The corpus folder, and the commands to run on it.
struct Corpus
{
    fs::path folder;
    std::ofstream cases{folder / "cases.txt"};

    template <typename Range> void Write(const std::string& name, const Range& bytes) const
    {
        testing_support::WriteBytes((folder / name).string(), {bytes.begin(), bytes.end()});
    }
    void Case(const std::string& command) { cases << command << '\n'; }
    // A command with text in UTF-8, as a terminal gives it.
    void Case(const char8_t* command) { Case(reinterpret_cast<const char*>(command)); }
};

std::string CrLf(const std::string& text)
{
    std::string out;
    for (const char c : text)
        out += c == '\n' ? std::string("\r\n") : std::string(1, c);
    return out;
}

// The worked example's timeline for 180 seconds of music.
const std::string kTimeline = "LOW:30;\nHI:60;\nLOW:90;\nCLIMAX:165;\nFINALE:170;\n";

void TensionFiles(Corpus& corpus)
{
    const std::string comment4x39 = "COMMENT:" + std::string(39, 'c') + "\n" +
                                    std::string(39, 'd') + "\n" + std::string(39, 'e') + "\n" +
                                    std::string(39, 'f') + ";\n";
    const struct
    {
        const char* name;
        std::string text;
    } files[] = {
        {"lf.txt", "FILENAME:Test;\n" + kTimeline},
        {"crlf.txt", CrLf("FILENAME:Test;\n" + kTimeline)},
        {"comment-lf.txt", "NAME:c;\n" + comment4x39 + kTimeline},
        {"comment-crlf.txt", CrLf("NAME:c;\n" + comment4x39 + kTimeline)},
        {"ctrl-z.txt", "NAME:z;\n" + kTimeline + "\x1A" + "LOW:100;\nCLIMAX:x;\n"},
        {"ctrl-z-early.txt", "NAME:z;\nLOW:30;\x1A\nHI:60;\n"},
        {"lone-cr.txt", "NAME:r;\rLOW:30;\r" + CrLf(kTimeline)},
        {"hex.txt", "NAME:h;\nLOW:0x1E;\n" + kTimeline},
        {"odd-numbers.txt", "NAME:o;\nLOW:inf;\nHI:nan;\nLOW:1d1;\nHI:2.5e1x;\nLOW:+.5e2;\n"
                            "NORMAL: 1e400;\nHI:1e-400;\nLOW:0100;\nCLIMAX:165;\nFINALE:170;\n"},
        {"long-name.txt", "NAME:" + std::string(41, 'n') + ";\n" + kTimeline},
        {"long-comment-line.txt", "NAME:l;\nCOMMENT:" + std::string(41, 'x') + ";\n" + kTimeline},
        {"japanese.txt", CrLf("ファイル名:表示テスト;\nコメント:ソ表能\n十;\nロー:30;\nハイ:60;\n"
                              "ロー:90;\nクライマックス:165;\nフィナーレ:170;\n")},
        {"no-name.txt", kTimeline},
        // Twenty-one double-byte characters: one byte over the name's limit.
        {"japanese-long-name.txt",
         "名前:表表表表表表表表表表表表表表表表表表表表表;\n" + kTimeline},
        {"climax-150.txt", "NAME:over;\nLOW:30;\nHI:60;\nLOW:90;\nCLIMAX:150;\nFINALE:170;\n"},
    };
    for (const auto& file : files)
        corpus.Write(file.name, file.text);
}

void MusicFiles(Corpus& corpus)
{
    using testing_support::MakeWave;
    using testing_support::WaveSpec;
    corpus.Write("music.wav", testing_support::MakeWaveOfLength(180));
    corpus.Write("short.wav", testing_support::MakeWaveOfLength(20));

    // 180 seconds in each format, so that only the format decides.
    const struct
    {
        const char* name;
        WaveSpec wave;
    } formats[] = {
        {"pcm16-stereo.wav", {1, 2, 8000, 16, {}, 0}}, {"pcm12.wav", {1, 1, 8000, 12, {}, 0}},
        {"pcm24.wav", {1, 1, 8000, 24, {}, 0}},        {"pcm32.wav", {1, 1, 8000, 32, {}, 0}},
        {"float32.wav", {3, 1, 8000, 32, {}, 0}},      {"adpcm.wav", {2, 1, 8000, 16, {}, 0}},
        {"six-channels.wav", {1, 6, 8000, 16, {}, 0}}, {"rate-50.wav", {1, 1, 50, 8, {}, 0}},
        {"rate-250000.wav", {1, 1, 250000, 8, {}, 0}},
    };
    for (auto format : formats)
    {
        format.wave.dataBytes = 180 * format.wave.sampleRate * format.wave.channels *
                                ((format.wave.bitsPerSample + 7) / 8);
        corpus.Write(format.name, MakeWave(format.wave));
    }

    // A block align that is not channels × bytes per sample.
    WaveSpec stereo{1, 2, 8000, 16, {}, 180 * 8000 * 4};
    Bytes body = testing_support::FormatChunkBody(stereo);
    body[12] = 3;
    corpus.Write("bad-block-align.wav",
                 testing_support::RiffWriter()
                     .Chunk("fmt ", body)
                     .Chunk("data", testing_support::PatternBytes(stereo.dataBytes))
                     .Finish());

    // Extensible formats, told apart by their sub-format: PCM plays, ADPCM does not.
    for (const auto& [name, subFormat] :
         {std::pair{"extensible-pcm.wav", 1}, {"extensible-adpcm.wav", 2}})
    {
        WaveSpec extensible{0xFFFE, 1, 8000, 16, {16, 0, 4, 0, 0, 0}, 180 * 8000 * 2};
        const Bytes guidTail = {0, 0, 0, 0, 0x10, 0, 0x80, 0, 0, 0xAA, 0, 0x38, 0x9B, 0x71};
        extensible.extra.push_back(std::uint8_t(subFormat));
        extensible.extra.push_back(0);
        extensible.extra.insert(extensible.extra.end(), guidTail.begin(), guidTail.end());
        corpus.Write(name, MakeWave(extensible));
    }

    testing_support::OggFixture ogg;
    ogg.channels = 1;
    ogg.sampleRate = 8000;
    ogg.samplesPerChannel = 180 * 8000;
    corpus.Write("music.ogg", testing_support::EncodeOggVorbis(ogg));

    // Music whose loudness rises and falls, for the drafts laid on it and
    // the figure of a timeline against it.
    const auto level = [](double t)
    { return -30.0 + 12.0 * std::sin(t / 17.0) + 6.0 * std::sin(t / 5.0); };
    corpus.Write("shaped.wav",
                 testing_support::MakeToneWave({1, 2, 8000, 16, {}, 0}, 183.5, level));
}

// A settings file whose music rows name corpus files, and whose fixed text
// fields run to their last byte without a terminator.
void SettingsFiles(Corpus& corpus)
{
    config::CSaveConfig record;
    record.ResetAll();
    const char* rows[][2] = {
        {"music.wav", "lf.txt"},      {"music.wav", "crlf.txt"},       {"music.ogg", "ctrl-z.txt"},
        {"music.wav", "hex.txt"},     {"pcm12.wav", "lf.txt"},         {"missing.wav", "lf.txt"},
        {"music.wav", "missing.txt"}, {"music.wav", "climax-150.txt"},
    };
    int row = 0;
    for (const auto& paths : rows)
    {
        std::strcpy(record.UserBgm()->rows[row].musicPath, paths[0]);
        std::strcpy(record.UserBgm()->rows[row].tensionPath, paths[1]);
        ++row;
    }
    corpus.Write("rows.dat", record.SaveToBytes());

    // The whole field is the path, and it names no file.
    std::memset(record.UserBgm()->rows[8].musicPath, 'm', config::kPathCapacity);
    std::memset(record.UserBgm()->rows[8].tensionPath, 't', config::kPathCapacity);
    std::memset(record.Network()->lobbyId, 'L', sizeof record.Network()->lobbyId);
    std::memset(record.Network()->directId, 'D', sizeof record.Network()->directId);
    std::memset(record.RadioChat()->entries[0].text, 'r',
                sizeof record.RadioChat()->entries[0].text);
    std::memset(record.Network()->connectList[0].octets, '9',
                sizeof record.Network()->connectList[0]);
    corpus.Write("unterminated.dat", record.SaveToBytes());

    // Changed below by set and apply with Japanese texts.
    record.ResetAll();
    corpus.Write("defaults.dat", record.SaveToBytes());
    corpus.Write("japanese.json",
                 std::string(R"({"network": {"directId": "\u30c0\u30a4\u30ec\u30af\u30c8"},)") +
                     reinterpret_cast<const char*>(
                         u8R"( "radioChat": {"entries": [{"text": "援護を頼む"}]}})"));
}

} // namespace

int main(int argc, char** argv)
{
    if (argc != 2)
        return 2;
    const fs::path folder = argv[1];
    fs::create_directories(folder);
    Corpus corpus{folder};
    TensionFiles(corpus);
    MusicFiles(corpus);
    SettingsFiles(corpus);

    for (const char* tension :
         {"lf.txt", "crlf.txt", "comment-lf.txt", "comment-crlf.txt", "ctrl-z.txt",
          "ctrl-z-early.txt", "lone-cr.txt", "hex.txt", "odd-numbers.txt", "long-name.txt",
          "long-comment-line.txt", "japanese.txt", "japanese-long-name.txt", "no-name.txt",
          "climax-150.txt", "missing.txt"})
        corpus.Case(std::string("check --details music.wav ") + tension);
    for (const char* music :
         {"music.ogg", "short.wav", "pcm16-stereo.wav", "pcm12.wav", "pcm24.wav", "pcm32.wav",
          "float32.wav", "adpcm.wav", "six-channels.wav", "rate-50.wav", "rate-250000.wav",
          "bad-block-align.wav", "extensible-pcm.wav", "extensible-adpcm.wav", "missing.wav"})
        corpus.Case(std::string("check --details ") + music + " lf.txt");
    for (const char* settings : {"rows.dat", "unterminated.dat"})
    {
        corpus.Case(std::string("check-config ") + settings);
        corpus.Case(std::string("show --json ") + settings);
    }
    corpus.Case("show unterminated.dat");
    for (const char* music : {"music.wav", "music.ogg", "short.wav", "missing.wav", "shaped.wav"})
        corpus.Case(std::string("draft ") + music);
    corpus.Case("check --details shaped.wav lf.txt");
    // Each build's set writes the same file: a second run changes nothing.
    corpus.Case("set rows.dat graphics.screenSize=1280x960 keys.keyboardKeys[4]=Z "
                "keys.keyboardKeys[14]=UP radioChat.entries[1].text=roger");
    corpus.Case("set rows.dat graphics.screenSize=1280x961");
    corpus.Case(u8"set defaults.dat radioChat.entries[2].text=了解！ network.lobbyId=ロビー～");
    corpus.Case(u8"set defaults.dat radioChat.entries[2].text=😀");
    corpus.Case(u8"set defaults.dat radioChat.entries[3].text=〜¥");
    corpus.Case("apply defaults.dat japanese.json");
    corpus.Case("show defaults.dat");
    corpus.Case("show rows.dat");
    return 0;
}
