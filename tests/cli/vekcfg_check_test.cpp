// vekcfg check and check-config, run as a user runs them.
#include "tests/cli/vekcfg_fixture.h"
#include "tests/cli/xml_reader.h"
#include "tests/support/temp_folder.h"

#include <cstring>
#include <filesystem>

namespace cli_testing
{
namespace
{

const std::string kAccepted = Utf8(u8"テンションファイル作成成功!!\n");
const std::string kClimaxOver =
    Utf8(u8"ClimaxTension 時間オーバー[現在 30.000000 秒です 18 秒以内にしてください]\n"
         u8"Time Data IsCorrect Error!!\n変換エラー!!\n");

using CheckTest = VekcfgRun;

TEST_F(CheckTest, PrintsWhatTheCheckButtonShowsAndExitsOneOnFailure)
{
    WriteMusic("music.wav", 180.0);
    WriteMusic("short.wav", 59.0);
    WriteText("example.txt", kWorkedExample);
    WriteText("climax.txt", kClimaxTooLong);
    WriteText("japanese.txt", "名前:テスト;\nロー:30;\nハイ:60;\nノーマル:90;\n");
    WriteText("within-a-minute.txt", "FILENAME:Test;\nLOW:30;\n");
    struct Case
    {
        const char* music;
        const char* tension;
        std::string out;
        int exitCode;
    };
    const Case cases[] = {
        {"music.wav", "example.txt", kAccepted, 0},
        {"music.wav", "japanese.txt", kAccepted, 0},
        {"music.wav", "climax.txt", kClimaxOver, 1},
        {"missing.wav", "example.txt", Utf8(u8"BGMファイルが開けません\n"), 1},
        {"example.txt", "example.txt", Utf8(u8"BGMファイルが開けません\n"), 1},
        {"music.wav", "missing.txt", Utf8(u8"ファイルが開けません!!\n"), 1},
        {"short.wav", "within-a-minute.txt",
         Utf8(u8"ファイル時間 エラー[59.000000秒のファイルです : "
              u8"60秒以上の長さのファイルが必要です]\n"
              u8"Time Data IsCorrect Error!!\n変換エラー!!\n"),
         1},
    };
    for (const Case& c : cases)
    {
        const ProgramRun run = Run({"check", c.music, c.tension});
        EXPECT_EQ(run.out, c.out) << c.music << " " << c.tension;
        EXPECT_EQ(run.exitCode, c.exitCode) << c.music << " " << c.tension;
        EXPECT_EQ(run.err, "") << c.music << " " << c.tension;
    }
}

TEST_F(CheckTest, TheNameRuleMeasuresTheTensionPathAsGiven)
{
    WriteMusic("music.wav", 120.0);
    WriteText("none.txt", "// no entries: the path stands in for the name\n");
    std::string longSpelling;
    while (longSpelling.size() <= 40)
        longSpelling += "./";
    longSpelling += "none.txt";

    const ProgramRun shortSpelling = Run({"check", "music.wav", "none.txt"});
    EXPECT_EQ(shortSpelling.out, kAccepted);
    EXPECT_EQ(shortSpelling.exitCode, 0);
    const ProgramRun sameFile = Run({"check", "music.wav", longSpelling});
    EXPECT_EQ(sameFile.out,
              Utf8(u8"ファイル名 エラー[ファイル名を 1 \uFF5E 40 文字以内にしてください]\n"
                   u8"Time Data IsCorrect Error!!\n変換エラー!!\n"));
    EXPECT_EQ(sameFile.exitCode, 1);
}

TEST_F(CheckTest, DetailsGiveTheWorkedExamplesFiguresAndTheHiddenWarnings)
{
    WriteMusic("music.wav", 180.0);
    WriteText("example.txt", std::string(kWorkedExample) + "TEMPO:120;\n");
    const ProgramRun run = Run({"check", "--details", "music.wav", "example.txt"});
    EXPECT_EQ(run.out,
              kAccepted +
                  "\n"
                  "music length: 180.000 s\n"
                  "name: \"Test\" (4 bytes; from its file-name entry)\n"
                  "warnings not shown by the page:\n"
                  "  Time Data Not Tension!!\n"
                  "segments (from, to, level):\n"
                  "     0.000    30.000  NormalTension\n"
                  "    30.000    60.000  LowTension\n"
                  "    60.000    90.000  HiTension\n"
                  "    90.000   165.000  LowTension\n"
                  "   165.000   180.000  ClimaxTension\n"
                  "levels (total time against its limit, segments against their maximum):\n"
                  "  LowTension     105.000 s (no limit)   2 of 4 segments\n"
                  "  NormalTension   30.000 s (no limit)   1 of 10 segments\n"
                  "  HiTension       30.000 s of 36 s      1 of 4 segments\n"
                  "  ClimaxTension   15.000 s of 18 s      1 of 2 segments\n"
                  "finale: 170.000 s, window 3.600 s (to 173.600 s), ClimaxTension there\n");
    EXPECT_EQ(run.exitCode, 0);
}

TEST_F(CheckTest, DetailsFollowTheLogOfARejectedFileAndNameWhatTheRuleMeasured)
{
    WriteMusic("music.wav", 180.0);
    WriteMusic("two-minutes.wav", 120.0);
    WriteText("climax.txt", kClimaxTooLong);
    WriteText("japanese.txt", "名前:テスト;\nロー:30;\nハイ:60;\nノーマル:90;\nCF:100;\n");
    WriteText("none.txt", "");
    struct Case
    {
        const char* music;
        const char* tension;
        std::vector<std::string> lines;
        int exitCode;
    };
    const Case cases[] = {
        {"music.wav",
         "climax.txt",
         {kClimaxOver + "\nmusic length: 180.000 s\n",
          "  ClimaxTension   30.000 s of 18 s      1 of 2 segments\n"},
         1},
        {"music.wav",
         "japanese.txt",
         {Utf8(u8"name: \"テスト\" (6 bytes; from its file-name entry)\n"),
          "warnings not shown by the page: none\n",
          "finale: 100.000 s, window 3.600 s (to 103.600 s), NormalTension there\n"},
         0},
        {"two-minutes.wav",
         "none.txt",
         {"name: \"none.txt\" (8 bytes; the path stands in, the file has no file-name entry)\n",
          "     0.000   120.000  NormalTension\n", "  HiTension        0.000 s of 24 s ",
          "finale: none (its window would be 2.400 s)\n"},
         0},
        {"music.wav", "missing.txt", {"timeline: none, the tension file could not be read\n"}, 1},
        {"missing.wav", "none.txt", {"\nmusic: cannot be opened or decoded\n"}, 1},
    };
    for (const Case& c : cases)
    {
        const ProgramRun run = Run({"check", c.music, "--details", c.tension});
        for (const std::string& line : c.lines)
            EXPECT_NE(run.out.find(line), std::string::npos)
                << c.tension << ": " << line << run.out;
        EXPECT_EQ(run.out.find("warnings not shown") == std::string::npos, c.exitCode != 0)
            << c.tension;
        EXPECT_EQ(run.exitCode, c.exitCode) << c.tension;
    }
}

std::vector<std::string> BandLevels(const std::vector<XmlElement>& elements)
{
    std::vector<std::string> levels;
    for (const XmlElement& element : elements)
    {
        const auto found = element.attributes.find("class");
        if (found != element.attributes.end() && found->second == "segment")
            levels.push_back(element.attributes.at("data-level"));
    }
    return levels;
}

TEST_F(CheckTest, ThePictureIsWellFormedXmlWithOneBandPerSegment)
{
    WriteMusic("music.wav", 180.0);
    WriteText("example.txt", kWorkedExample);
    WriteText("climax.txt", kClimaxTooLong);
    WriteText("marked.txt", "FILENAME:<A & B>;\nLOW:30;\nHI:40;\nNORMAL:50;\n");
    struct Case
    {
        const char* tension;
        std::vector<std::string> levels;
        bool finaleMarked;
        int exitCode;
    };
    const Case cases[] = {
        {"example.txt",
         {"NormalTension", "LowTension", "HiTension", "LowTension", "ClimaxTension"},
         true,
         0},
        {"climax.txt",
         {"NormalTension", "LowTension", "HiTension", "LowTension", "ClimaxTension"},
         true,
         1},
        {"marked.txt", {"NormalTension", "LowTension", "HiTension", "NormalTension"}, false, 0},
    };
    for (const Case& c : cases)
    {
        const std::string picture = Path("timeline.svg");
        std::filesystem::remove(picture);
        const ProgramRun run = Run({"check", "--svg", "timeline.svg", "music.wav", c.tension});
        EXPECT_EQ(run.exitCode, c.exitCode) << c.tension;
        EXPECT_EQ(run.err, "") << c.tension;
        const std::vector<std::uint8_t> bytes = testing_support::ReadBytes(picture);
        std::vector<XmlElement> elements;
        std::string error;
        ASSERT_TRUE(ReadXml(std::string(bytes.begin(), bytes.end()), &elements, &error))
            << c.tension << ": " << error;
        ASSERT_FALSE(elements.empty());
        EXPECT_EQ(elements.front().name, "svg");
        EXPECT_EQ(BandLevels(elements), c.levels) << c.tension;
        bool finale = false;
        for (const XmlElement& element : elements)
            finale = finale || (element.attributes.count("class") != 0 &&
                                element.attributes.at("class") == "finale-window");
        EXPECT_EQ(finale, c.finaleMarked) << c.tension;
    }
}

TEST_F(CheckTest, NoPictureIsWrittenWithoutATimelineAndAnUnwritableOneExitsTwo)
{
    WriteMusic("music.wav", 180.0);
    WriteText("example.txt", kWorkedExample);
    const ProgramRun noMusic = Run({"check", "--svg", "t.svg", "missing.wav", "example.txt"});
    EXPECT_EQ(noMusic.exitCode, 1);
    EXPECT_FALSE(std::filesystem::exists(Path("t.svg")));
    EXPECT_EQ(noMusic.err, "vekcfg: \"t.svg\" not written: the music could not be opened\n");

    const ProgramRun nowhere =
        Run({"check", "--svg", "no-such-folder/t.svg", "music.wav", "example.txt"});
    EXPECT_EQ(nowhere.out, kAccepted);
    EXPECT_EQ(nowhere.exitCode, 2);
    EXPECT_EQ(nowhere.err.rfind("vekcfg: cannot write \"no-such-folder/t.svg\": ", 0), 0u)
        << nowhere.err;
}

void SetRow(config::CSaveConfig& record, int row, const std::string& music,
            const std::string& tension)
{
    config::UserBgmRow& stored = record.UserBgm()->rows[row];
    std::strncpy(stored.musicPath, music.c_str(), sizeof stored.musicPath - 1);
    std::strncpy(stored.tensionPath, tension.c_str(), sizeof stored.tensionPath - 1);
}

using CheckConfigTest = VekcfgRun;

TEST_F(CheckConfigTest, ChecksEveryRowWithMusicOneLineEach)
{
    const std::string music = WriteMusic("music.wav", 180.0);
    const std::string example = WriteText("example.txt", kWorkedExample);
    const std::string climax = WriteText("climax.txt", kClimaxTooLong);
    config::CSaveConfig record = DefaultRecord();
    SetRow(record, 0, music, example);
    SetRow(record, 1, Path("missing.wav"), example);
    SetRow(record, 2, music, climax);
    SetRow(record, 3, "", example);
    SetRow(record, 5, "music.wav", "example.txt");
    WriteSettings("GameConfig.dat", record);

    const ProgramRun run = Run({"check-config", "GameConfig.dat"});
    EXPECT_EQ(run.out,
              "1\t" + music + "\t" + example + "\t" + Utf8(u8"テンションファイル作成成功!!\n") +
                  "2\t" + Path("missing.wav") + "\t" + example + "\t" +
                  Utf8(u8"BGMファイルが開けません\n") + "3\t" + music + "\t" + climax + "\t" +
                  Utf8(u8"ClimaxTension 時間オーバー[現在 30.000000 秒です 18 秒以内にしてください]"
                       u8" / Time Data IsCorrect Error!! / 変換エラー!!\n") +
                  "6\tmusic.wav\texample.txt\t" + Utf8(u8"テンションファイル作成成功!!\n"));
    EXPECT_EQ(run.exitCode, 1);
    EXPECT_EQ(run.err, "");

    config::CSaveConfig passing = DefaultRecord();
    SetRow(passing, 4, music, example);
    WriteSettings("passing.dat", passing);
    EXPECT_EQ(Run({"check-config", "passing.dat"}).exitCode, 0);
    WriteSettings("empty.dat", DefaultRecord());
    const ProgramRun empty = Run({"check-config", "empty.dat"});
    EXPECT_EQ(empty.out, "");
    EXPECT_EQ(empty.exitCode, 0);
}

} // namespace
} // namespace cli_testing
