// The tension file: its syntax, checks and messages by table, loading from
// files and archives, and the game's queries.
#include "base/memory.h"
#include "sound/sound_buffer.h"
#include "tension/tension_file.h"
#include "tests/support/audio_fixtures.h"
#include "tests/support/sound_device_fixture.h"
#include "tests/support/temp_folder.h"

#include <cstdio>
#include <cstring>
#include <filesystem>
#include <gtest/gtest.h>
#include <map>
#include <string>
#include <tuple>
#include <vector>

using tension::CTensionFile;
using tension::CTextString;
using tension::TensionLevel;

namespace
{

const std::string kNotTension = "Time Data Not Tension!!\n";
const std::string kOutside = "Time Data Outside Range!!\n";
const std::string kKeyAdd = "Time Data KeyAdd Error!!\n";
const std::string kIsCorrect = "Time Data IsCorrect Error!!\n";
const std::string kName = "ファイル名 エラー[ファイル名を 1 ～ 40 文字以内にしてください]\n";
const std::string kCannotOpen = "ファイルが開けません!!\n";
const std::string kTwoFinales =
    "クライマックスフィナーレ エラー[クライマックスフィナーレが複数指定されています]\n";
const std::string kWorked =
    "FILENAME : Test;\nLOW : 30;\nHI : 60;\nLOW : 90;\nCLIMAX : 165;\nFINALE : 170;\n";

// Music of a given length (8-bit mono at 1000 Hz), opened once per length.
sound::CSoundBuffer* Music(double seconds)
{
    static testing_support::ScopedSoundDevice device;
    static testing_support::TempFolder folder;
    static std::map<double, sound::CSoundBuffer> shelf;
    auto [music, fresh] = shelf.try_emplace(seconds);
    if (fresh)
    {
        const std::string path = folder.File(std::to_string(seconds) + ".wav");
        testing_support::WriteBytes(path, testing_support::MakeWaveOfLength(seconds));
        EXPECT_TRUE(device.Ready() && music->second.Open(path.c_str(), 1, sound::kCapsStatic));
    }
    return &music->second;
}

// The timeline as time and level initial: "0N 30L 60H 180N".
std::string Timeline(const CTensionFile& file)
{
    std::string shown;
    const tension::CKeyFrameList* timeline = file.GetTimeline();
    for (std::uint32_t i = 0; timeline != nullptr && i < timeline->GetKeyCount(); ++i)
    {
        char key[32];
        const tension::KeyFrame& frame = *timeline->GetKey(i);
        std::snprintf(key, sizeof key, " %g%c", frame.time, "LNHC"[frame.value & 3]);
        shown += key;
    }
    return shown.empty() ? shown : shown.substr(1);
}

struct Row
{
    const char* what;
    double seconds;
    std::string text;
    bool accepted;
    std::string log;                // without the kIsCorrect that ends a refusal with a message
    const char* timeline = nullptr; // null: not looked at
};

// Parses as the tool does, against music of that length, and as the fuzz
// target does, against the length alone: both give the same answer. The
// text lies in a block of exactly its size, so that a read past it shows.
void Check(const Row& row)
{
    const std::string expected = row.log + (row.accepted || row.log.empty() ? "" : kIsCorrect);
    const std::vector<char> text(row.text.c_str(), row.text.c_str() + row.text.size() + 1);
    for (const bool withMusic : {true, false})
    {
        CTensionFile file;
        CTextString log;
        EXPECT_EQ(withMusic ? file.Parse(Music(row.seconds), text.data(), ':', ';', &log)
                            : file.ParseForLength(float(row.seconds), text.data(), ':', ';', &log),
                  row.accepted)
            << row.what;
        EXPECT_EQ(log.CStr(), expected) << row.what;
        EXPECT_TRUE(row.timeline == nullptr || Timeline(file) == row.timeline)
            << row.what << ": " << Timeline(file);
    }
}

// One-second segments from second 10 on, one per letter L, N, H or C.
std::string Segments(const char* levels)
{
    std::string text;
    for (int i = 0; levels[i] != '\0'; ++i)
        text += std::string(1, levels[i]) + "T:" + std::to_string(10 + i) + ";\n";
    return text;
}

} // namespace

TEST(TensionParse, EntriesKeysValuesAndComments)
{
    const Row rows[] = {
        {"the worked example", 180, kWorked, true, "", "0N 30L 60H 90L 165C 180N"},
        {"Japanese keys, CR LF line ends, a comment over two lines", 240,
         "ファイル名:曲名;\r\nコメント:一行目\r\n二行目;\r\nロー:20;\r\nハイ:60;\r\n"
         "ノーマル:80;\r\nクライマックス:220;\r\nフィナーレ:230;\r\n",
         true, "", "0N 20L 60H 80N 220C 240N"},
        {"short keys in any case of ASCII letters; no key with a blank or in full width", 200,
         "fn:x;\nlt:10;\nHt:20;\nnT:30;\nCt:190;\ncf:195;\nFc:c;\nLOW TENSION:5;\nＬＯＷ:6;", true,
         kNotTension + kNotTension, "0N 10L 20H 30N 190C 200N"},
        {"comments where keys are read, one inside a key", 200,
         "// note\nFN:x; // name\n/* LOW:50; 2*3 a/b */\nLO/* joined */W:30;\nHI // "
         "split\n:40;\nLOW:45;",
         true, "", "0N 30L 40H 45L 200N"},
        {"an unterminated block comment", 200, "FN:x;\n/* open", false, ""},
        {"level times outside the music or no number", 200,
         "FN:x;\nLOW:0;\nLOW:200;\nLOW:-5;\nLOW:abc;\nLOW: 30", true,
         kOutside + kOutside + kOutside + kOutside + kOutside, "0N 200N"},
        {"times within 0.006 s of a key", 200,
         "FN:x;\nLT:30;\nLT:30.005;\nLT:29.995;\nLT:30.006;\n"
         "LT:30.007;\nLT:29.993;\nLT:199.995;",
         true, kKeyAdd + kKeyAdd + kKeyAdd + kKeyAdd, "0N 29.993L 30L 30.007L 200N"},
        {"entries other than accepted levels pass over the character after them", 200,
         "FN:x;ロLOW:30;\nFC:c;HI:40;\nCF:50;LOW:60;\nLOW:0;HI:20;\n", true,
         kNotTension + kNotTension + kOutside + kNotTension, "0N 30L 200N"},
        {"an unknown key skips to its terminator; it and an accepted level leave the next whole",
         200, "FN:x;\nLOW:30;HI:20;\nFOO:1;LOW:25;\nBAR: 2\nHI:40;", true,
         kNotTension + kNotTension, "0N 20H 25L 30L 200N"},
        {"a lead byte at the end of a key", 200, "FN:x;\nLOW\x81", true, "", "0N 200N"},
        {"a lead byte at the end of a block comment", 200, "FN:x;\n/*\x81", false, ""},
        {"two finales: the checks speak first", 200, "CF:150;\nCLIMAX:190;\nCF:160;\n", false,
         kName + kTwoFinales},
    };
    for (const Row& row : rows)
        Check(row);
}

TEST(TensionCheck, LimitsAndTheirMessages)
{
    const std::string lines = "ファイルコメント エラー[行数を 4 以内にしてください]\n";
    const std::string line = "ファイルコメント エラー[1行の文字数を 40 以内にしてください]\n";
    const std::string c40(40, 'c');
    const std::string kanji20 = "一二三四五六七八九十一二三四五六七八九十";
    const Row rows[] = {
        {"music of 60 s", 60, "FN:x;", true, ""},
        {"music of 59.5 s, no further check", 59.5, "HI:10;", false,
         "ファイル時間 エラー[59.500000秒のファイルです : 60秒以上の長さのファイルが必要です]\n"},
        {"music of 480.5 s", 480.5, "HI:10;", false,
         "ファイル時間 エラー[480.500000秒のファイルです : 480秒以下の長さのファイルが必要です]\n"},
        {"no name", 200, "", false, kName, "0N 200N"},
        {"a name of 41 bytes", 200, "FN:" + c40 + "c;", false, kName},
        {"a comment of five lines", 200, "FN:x;\nFC:a\nb\nc\nd\ne;", false, lines},
        {"a comment line of 41 bytes", 200, "FN:x;\nFC:" + c40 + "c;", false, line},
        {"a name, a comment and segments of each level at their limits", 480,
         "FN:" + c40 + ";\nFC:" + kanji20 + "\r\n" + c40 + "\n" + c40 + "\n" +
             std::string(36, 'c') + ";\n" + Segments("LHLHLHLHCNCNNNNNNNN"),
         true, ""},
        {"Hi for 20 s and Climax for 10 s of 100 s", 100,
         "FN:x;\nLOW:10;\nHI:50;\nLOW:70;\nCLIMAX:90;\n", true, ""},
        {"Hi for 20.5 s of 100 s", 100, "FN:x;\nLOW:10;\nHI:50;\nLOW:70.5;\n", false,
         "HiTension 時間オーバー[現在 20.500000 秒です 20 秒以内にしてください]\n"},
        {"Climax for 10.5 s of 100 s", 100, "FN:x;\nLOW:10;\nCLIMAX:89.5;\n", false,
         "ClimaxTension 時間オーバー[現在 10.500000 秒です 10 秒以内にしてください]\n"},
        {"Hi for 19.5 s of 99.9 s", 99.9, "FN:x;\nLOW:10;\nHI:50;\nLOW:69.5;\n", false,
         "HiTension 時間オーバー[現在 19.500000 秒です 19 秒以内にしてください]\n"},
        {"eleven Normal segments", 480, "FN:x;\n" + Segments("NNNNNNNNNNL"), false,
         "NormalTension 回数オーバー[現在 11 回です 10 回以内にしてください]\n"},
        {"five Hi segments", 480, "FN:x;\n" + Segments("HNHNHNHNHL"), false,
         "HiTension 回数オーバー[現在 5 回です 4 回以内にしてください]\n"},
        {"three Climax segments", 480, "FN:x;\n" + Segments("CNCNCL"), false,
         "ClimaxTension 回数オーバー[現在 3 回です 2 回以内にしてください]\n"},
        {"five Low segments", 480, "FN:x;\n" + Segments("LNLNLNLNLN"), false,
         "LowTension 回数オーバー[現在 5 回です 4 回以内にしてください]\n"},
        {"every failing check in order", 200,
         "FC:" + std::string(170, 'c') + ";\n" + Segments("HNHNHNHNHNHN") +
             "CLIMAX:140;\nNT:170;\n",
         false,
         kName + "ファイルコメント エラー[文字数を 160 以内にしてください]\n" +
             "HiTension 回数オーバー[現在 6 回です 4 回以内にしてください]\n" +
             "ClimaxTension 時間オーバー[現在 30.000000 秒です 20 秒以内にしてください]\n" +
             "LowTension 時間不足[現在 0.000000 秒です HiTension 時間の 6.000000 "
             "秒以上必要です]\n"},
    };
    for (const Row& row : rows)
        Check(row);
}

TEST(TensionParse, ValuesAreTrimmedAndKeptUntilReplacedSeparatedAsTheCallerSays)
{
    CTensionFile file;
    const auto parse = [&file](const std::string& text)
    { return file.ParseForLength(200, text.c_str(), ':', ';', nullptr); };
    ASSERT_TRUE(parse(" \t\r\n\v FN \t : \r\n  My Song \t\n;\nFC: one\r\ntwo: // /* */;\nCF:150;"));
    EXPECT_EQ(file.GetFinaleTime(), 150.0f);
    ASSERT_TRUE(parse("LOW:30;\nFN: without its terminator"));
    EXPECT_STREQ(file.GetName().CStr(), "My Song");
    EXPECT_STREQ(file.GetComment().CStr(), "one\r\ntwo: // /* */");
    EXPECT_EQ(file.GetFinaleTime(), 0.0f);
    parse("FN:a\x81;b;");
    EXPECT_STREQ(file.GetName().CStr(), "a\x81;b") << "a lead byte takes the terminator";
    parse("FN:" + std::string(300, 'n') + ";");
    EXPECT_EQ(file.GetName().Length(), 259u) << "cut to its buffer";
    EXPECT_TRUE(file.Parse(Music(200), "FN=x,\nLOW=30,\nHI:40;\n", '=', ',', nullptr));
    EXPECT_EQ(Timeline(file), "0N 30L 200N");
    EXPECT_FALSE(file.Parse(Music(200), nullptr, ':', ';', nullptr));
    EXPECT_FALSE(file.Parse(Music(59.5), "FOO:1;\nLOW:0;\nCF:1;\nCF:2;\n", ':', ';', nullptr));
}

TEST(TensionQuery, TheGameAsksACopyForTheLevelAndTheFinaleAtATime)
{
    CTensionFile file;
    EXPECT_EQ(file.GetTension(10.0f), TensionLevel::Normal) << "before any parse";
    ASSERT_TRUE(file.Parse(Music(180), kWorked.c_str(), ':', ';', nullptr));
    CTensionFile copy(file);
    EXPECT_TRUE(file.ReleaseTimeline());
    EXPECT_FLOAT_EQ(copy.GetFinaleWindow(), 3.6f);
    const auto N = TensionLevel::Normal, L = TensionLevel::Low, H = TensionLevel::Hi,
               C = TensionLevel::Climax;
    const std::tuple<float, TensionLevel, bool> cases[] = {
        {-1.0f, N, false},  {29.9f, N, false}, {30.0f, L, false},  {169.9f, C, false},
        {170.0f, C, true},  {173.5f, C, true}, {173.7f, C, false}, {180.0f, N, false},
        {241.0f, H, false}, {351.0f, C, true},
    };
    for (const auto& [time, level, finale] : cases)
    {
        EXPECT_EQ(copy.GetTension(time), level) << time;
        EXPECT_EQ(copy.IsFinale(time), finale) << time;
    }
    EXPECT_STREQ(tension::LevelMessageName(L), "LowTension") << "as the checks name it";
    copy.SetLoopStart(60.0f);
    EXPECT_EQ(copy.GetTension(215.0f), TensionLevel::Low) << "folded to 60 + 35 s";
    EXPECT_EQ(copy.GetTension(180.0f), N) << "the last entry itself is not folded";
}

TEST(TensionLoad, FilesAreReadInTextModeAndNamedByTheirPathUntilAnEntryNamesThem)
{
    // Files named relative to a fresh working folder, so that a path that
    // stands in for a missing name is short on every platform.
    const testing_support::TempFolder folder;
    const std::filesystem::path previous = std::filesystem::current_path();
    std::filesystem::current_path(folder.Path());
    std::filesystem::create_directory("folder");
    const std::string longPath = std::string(37, 'p') + ".txt";
    // The path, the text written (null: none), whether it loads, the log and the name.
    const std::tuple<std::string, const char*, bool, std::string, std::string> cases[] = {
        {"crlf.txt", "FN:Test;\r\nFC:one\r\ntwo;\r\nLOW:30;\r\n", true, "", "Test"},
        {"missing.txt", nullptr, false, kCannotOpen, ""},
        {"folder", nullptr, false, kCannotOpen, ""},
        {"empty.txt", "", true, "", "empty.txt"},
        {longPath, "", false, kName + kIsCorrect + "変換エラー!!\n", longPath},
    };
    for (const auto& [path, text, loaded, shown, name] : cases)
    {
        if (text != nullptr)
            testing_support::WriteBytes(path, {text, text + std::strlen(text)});
        CTensionFile file;
        CTextString log;
        EXPECT_EQ(file.LoadFromFile(Music(180), path.c_str(), &log), loaded) << path;
        EXPECT_EQ(log.CStr(), shown) << path;
        EXPECT_EQ(file.GetName().CStr(), name) << path;
    }
    CTensionFile file, unread;
    EXPECT_TRUE(file.LoadFromFile(Music(180), "crlf.txt", nullptr));
    EXPECT_STREQ(file.GetComment().CStr(), "one\ntwo");
    EXPECT_EQ(Timeline(file), "0N 30L 180N");
    {
        base::ScopedAllocationFailure failure(1); // the name's copy succeeds, the text's not
        EXPECT_FALSE(unread.LoadFromFile(Music(180), "crlf.txt", nullptr));
    }
    EXPECT_EQ(unread.GetTimeline(), nullptr);
    std::filesystem::current_path(previous);
}

TEST(TensionArchive, AnEntryIsLoadedByItsExactNameFromTheFirstArchiveThatLoadsIt)
{
    tension::CqvxPackFile failing, good;
    ASSERT_TRUE(failing.AddEntry("other", "", 0));
    ASSERT_TRUE(failing.AddEntry("song", "CF:1;\nCF:2;\n", 12));
    ASSERT_TRUE(good.AddEntry("song", "LOW:30;", 7));
    EXPECT_FALSE(good.AddEntry(nullptr, "", 0));
    CTensionFile file;
    CTextString log;
    EXPECT_FALSE(file.LoadFromArchive(Music(180), "SONG", &good, &log));
    EXPECT_FALSE(file.LoadFromArchive(Music(180), "song", nullptr, &log));
    EXPECT_FALSE(file.LoadFromArchive(Music(180), "song", &failing, &log));
    EXPECT_EQ(log.CStr(), kCannotOpen + kCannotOpen + kTwoFinales + kIsCorrect +
                              "File Buffer Conversion Error!!\n");
    const tension::CqvxPackFile* archives[] = {&failing, nullptr, &good};
    EXPECT_TRUE(file.LoadFromArchiveList(Music(180), "song", {archives, 3}, nullptr));
    EXPECT_EQ(Timeline(file), "0N 30L 180N");
    EXPECT_FALSE(file.LoadFromArchiveList(Music(180), nullptr, {archives, 3}, nullptr));
}
