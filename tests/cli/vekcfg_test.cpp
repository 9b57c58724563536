// Every command of vekcfg with each of its outcomes, and the reports a user
// reads, run in the test's own process as the entry runs them. Paths are
// absolute: the messages name them as given.
#include "cli/command_line.h"
#include "cli/encoding.h"
#include "cli/platform.h"
#include "cli/vekcfg.h"
#include "config/save_config.h"
#include "tests/support/audio_fixtures.h"
#include "tests/support/temp_folder.h"

#include <algorithm>
#include <cstring>
#include <filesystem>
#include <gtest/gtest.h>
#include <tuple>

namespace cli_testing
{

// What was printed, as UTF-8 with LF, whatever the platform printed.
std::string Utf8FromConsole(const std::string& printed);

namespace
{

using testing_support::ReadBytes;

struct ProgramRun
{
    int exitCode;
    std::string out;
    std::string err;
};

ProgramRun Vekcfg(const std::vector<std::string>& arguments)
{
    std::vector<const char*> argv;
    for (const std::string& argument : arguments)
        argv.push_back(argument.c_str());
    testing::internal::CaptureStdout();
    testing::internal::CaptureStderr();
    const int exitCode = cli::RunVekcfg(static_cast<int>(argv.size()), argv.data());
    const std::string out = Utf8FromConsole(testing::internal::GetCapturedStdout());
    return {exitCode, out, Utf8FromConsole(testing::internal::GetCapturedStderr())};
}

std::string Utf8(const char8_t* text)
{
    return reinterpret_cast<const char*>(text);
}

const std::string kAccepted = Utf8(u8"テンションファイル作成成功!!\n");
const std::string kNoMusic = Utf8(u8"BGMファイルが開けません\n");
const std::string kClimaxOver =
    Utf8(u8"ClimaxTension 時間オーバー[現在 30.000000 秒です 18 秒以内にしてください]\n"
         u8"Time Data IsCorrect Error!!\n変換エラー!!\n");

// 180 s of music and the worked example: Normal 30, Low 105, Hi 30 of at
// most 36, Climax 15 of at most 18, the finale at 170; the same with the
// climax from 150 fails.
class Commands : public testing::Test
{
protected:
    Commands()
    {
        testing_support::WriteBytes(music, testing_support::MakeWaveOfLength(180.0));
        Write(example, "FILENAME:Test;\nLOW:30;\nHI:60;\nLOW:90;\nCLIMAX:165;\nFINALE:170;\n");
        Write(climax, "FILENAME:Test;\nLOW:30;\nHI:60;\nLOW:90;\nCLIMAX:150;\nFINALE:170;\n");
    }
    static std::string Write(const std::string& path, const std::string& bytes)
    {
        testing_support::WriteBytes(path, std::vector<std::uint8_t>(bytes.begin(), bytes.end()));
        return path;
    }

    testing_support::TempFolder folder;
    const std::string music = folder.File("music.wav"), missing = folder.File("missing.wav");
    const std::string example = folder.File("example.txt"), climax = folder.File("climax.txt");
    const std::string settings = folder.File("GameConfig.dat");
};

// The conversion every printed text goes through.
TEST(Utf8FromCp932, MapsTheToolsTextsAndReplacesWhatTheCodePageLacksOneCharacterEach)
{
    const std::pair<std::string, std::string> cases[] = {
        {"表示", Utf8(u8"表示")},              // a trail byte 5C is no backslash
        {"\x81\x60", Utf8(u8"\uFF5E")},        // the tilde of the messages
        {"\x81\x7E", Utf8(u8"×")},             // the resolutions' sign
        {"\xB1\xB2", Utf8(u8"\uFF71\uFF72")},  // half-width katakana
        {"a\x81", "a" + Utf8(u8"\uFFFD")},     // a lead byte at the end
        {"\x81\"x", Utf8(u8"\uFFFD") + "\"x"}, // a lead byte before a non-trail
        {"\x85\x40z", Utf8(u8"\uFFFD") + "z"}, // an unassigned pair is one character
        {std::string("a\0b", 3), std::string("a\0b", 3)}};
    for (const auto& [cp932, utf8] : cases)
        EXPECT_EQ(cli::Utf8FromCp932(cp932), utf8) << utf8;
}

TEST_F(Commands, CheckPrintsWhatTheCheckButtonShowsAndExitsOneOnFailure)
{
    const std::tuple<std::string, std::string, std::string, int> rows[] = {
        {music, example, kAccepted, 0},
        {music, climax, kClimaxOver, 1},
        {missing, example, kNoMusic, 1}};
    for (const auto& [musicPath, tensionPath, out, exitCode] : rows)
    {
        const ProgramRun run = Vekcfg({"check", musicPath, tensionPath});
        EXPECT_EQ(run.out, out) << tensionPath;
        EXPECT_EQ(run.exitCode, exitCode) << tensionPath;
        EXPECT_EQ(run.err, "") << tensionPath;
    }
}

TEST_F(Commands, DetailsAndThePictureShowTheTimeline)
{
    const ProgramRun details = Vekcfg({"check", "--details", music, example});
    for (const char* line :
         {"music length: 180.000 s\n", "name: \"Test\" (4 bytes; from its file-name entry)\n",
          "    90.000   165.000  LowTension\n",
          "  HiTension       30.000 s of 36 s      1 of 4 segments\n",
          "finale: 170.000 s, window 3.600 s (to 173.600 s), ClimaxTension there\n"})
        EXPECT_NE(details.out.find(line), std::string::npos) << line;
    EXPECT_NE(details.out.find("follows the loudness: no figure (the loudness of music"),
              std::string::npos);
    // Music that is loud only where the example's climax stands.
    const std::string loud = folder.File("loud.wav");
    testing_support::WriteBytes(
        loud, testing_support::MakeToneWave({1, 1, 8000, 16, {}, 0}, 180.0,
                                            [](double t) { return t >= 165.0 ? -10.0 : -30.0; }));
    EXPECT_NE(
        Vekcfg({"check", "--details", loud, example}).out.find("follows the loudness: 0.48 (rank"),
        std::string::npos);

    const std::string svg = folder.File("t.svg");
    EXPECT_EQ(Vekcfg({"check", "--svg", svg, loud, climax}).exitCode, 1);
    const std::vector<std::uint8_t> bytes = ReadBytes(svg);
    const std::string picture(bytes.begin(), bytes.end());
    for (const char8_t* part :
         {u8"<svg ", u8"class=\"finale-window\"", u8"変換エラー!!",
          u8"<polyline class=\"loudness\"", u8"data-level=\"ClimaxTension\" data-from=\"150.000\""})
        EXPECT_NE(picture.find(Utf8(part)), std::string::npos) << Utf8(part);
    const ProgramRun unwritable =
        Vekcfg({"check", "--svg", folder.File("no/t.svg"), music, example});
    EXPECT_EQ(unwritable.out, kAccepted);
    EXPECT_EQ(unwritable.exitCode, 2);
    EXPECT_NE(unwritable.err.find("no/t.svg"), std::string::npos);
}

TEST_F(Commands, CheckConfigChecksEveryRowWithMusicOneLineEach)
{
    config::CSaveConfig record;
    record.ResetAll();
    const std::string rows[][2] = {
        {music, example}, {missing, example}, {"", example}, {music, climax}};
    for (int row = 0; row < 4; ++row)
    {
        std::strcpy(record.UserBgm()->rows[row].musicPath, rows[row][0].c_str());
        std::strcpy(record.UserBgm()->rows[row].tensionPath, rows[row][1].c_str());
    }
    ASSERT_TRUE(record.SaveToPath(settings.c_str()));
    const ProgramRun run = Vekcfg({"check-config", settings});
    EXPECT_EQ(run.out,
              "1\t" + music + "\t" + example + "\t" + kAccepted + "2\t" + missing + "\t" + example +
                  "\t" + kNoMusic + "4\t" + music + "\t" + climax + "\t" +
                  Utf8(u8"ClimaxTension 時間オーバー[現在 30.000000 秒です 18 秒以内にしてく"
                       u8"ださい] / Time Data IsCorrect Error!! / 変換エラー!!\n"));
    EXPECT_EQ(run.exitCode, 1);
    EXPECT_EQ(Vekcfg({"check-config", "-j", "1", settings}).out, run.out);
    EXPECT_EQ(Vekcfg({"check-config", "-j4", settings}).out, run.out);
}

TEST_F(Commands, ShowPrintsEverySettingByNameWithItsMeaning)
{
    config::CSaveConfig record;
    record.ResetAll();
    record.Graphics()->screenSize = 8;
    record.Graphics()->hdrLevel = 5;
    record.Game()->bgmVolume = -10000;
    record.Game()->seVolume = -1250;
    config::IpEntry address{};
    for (int i = 0; i < 4; ++i)
        std::strcpy(address.octets[i], i < 3 ? "010" : "*");
    record.AddConnectEntry(address);
    record.AddAllowEntry(address);
    record.Keys()->keyboardKeys[4] = 0x1C8; // the low byte names it
    record.Keys()->padConfigs[1].buttons[14] = 200;
    std::strcpy(record.RadioChat()->entries[1].text, "go\n\tnow\x01");
    ASSERT_TRUE(record.SaveToPath(settings.c_str()));

    const ProgramRun text = Vekcfg({"show", settings});
    EXPECT_EQ(text.exitCode, 0);
    EXPECT_EQ(text.out.rfind("file = \"" + settings + "\"\n", 0), 0u);
    for (const char8_t* line :
         {u8"version = 318771200 (0x13001000)\n", u8"graphics.screenSize = 8 (1920×1080)\n",
          u8"graphics.hdrLevel = 5 (no such choice)\n", u8"game.bgmVolume = -10000 (silent)\n",
          u8"game.seVolume = -1250 (-12.50 dB)\n", u8"game.captureEnabled = 0 (off)\n",
          u8"network.keyResponse = 1 (2)\n",
          u8"network.connectList[0] = \"010.010.010.*\" (10.10.10.0)\n",
          u8"network.allowList[0] = \"010.010.010.*\"\n", u8"network.denyList = (none)\n",
          u8"replay.replayLock[29] = 0 (リプレイ30: unlocked)\n",
          u8"keys.keyboardKeys[4] = 456 (移動上: UP)\n",
          u8"keys.padConfigs[1].buttons[14] = 200 (スライド/決定: (no name))\n",
          u8"keys.padConfigs[1].device = 1 (2P: game controller 1 in enumeration order)\n",
          u8"radioChat.entries[1].text = \"go\\n\\tnow\\x01\" (F2)\n",
          u8"radioChat.entries[11].notToAll = 0 (F12: to everyone (全体 checked))\n"})
        EXPECT_NE(text.out.find(Utf8(line)), std::string::npos) << Utf8(line);

    EXPECT_EQ(text.out.find("connectList[1]"), std::string::npos) << "empty slots after the last";
    const ProgramRun json = Vekcfg({"show", "--json", settings});
    EXPECT_EQ(json.exitCode, 0);
    // ASCII only, so that any console and pipe pass it on unchanged.
    for (const char* part :
         {"\"screenSize\": {\n      \"value\": 8,\n      \"meaning\": \"1920\\u00d71080\"",
          "\"port\": 18000,", "\"value\": \"go\\n\\tnow\\u0001\""})
        EXPECT_NE(json.out.find(part), std::string::npos) << part;
    EXPECT_TRUE(std::all_of(json.out.begin(), json.out.end(), [](char c) { return c > 0; }));
}

// Every page changed, each setting by its number or by what it means; then
// each file's show --json applied over the other makes it again, byte for byte.
TEST_F(Commands, SetTakesANumberOrAMeaningAndApplyOfWhatShowPrintsCopiesAFile)
{
    config::CSaveConfig record;
    record.ResetAll();
    const std::string defaults = folder.File("defaults.dat"), tree = folder.File("tree.json");
    ASSERT_TRUE(record.SaveToPath(settings.c_str()) && record.SaveToPath(defaults.c_str()));
    const ProgramRun set = Vekcfg(
        {"set", settings, "graphics.screenSize=1280x960", "graphics.fullScreen=on",
         "game.seVolume=-12.50 dB", "keys.keyboardKeys[4]=Z", "keys.keyboardKeys[14]=up",
         "keys.padConfigs[1].buttons[14]=BUTTON3", "keys.padConfigs[1].buttons[16]=14",
         "keys.padConfigs[3].device=0", "radioChat.entries[1].notToAll=not to everyone",
         "radioChat.entries[11].text=" + Utf8(u8"援護を頼む"), "network.keyResponse=2",
         "network.lobbyId=" + Utf8(u8"ロビー"), "network.connectList+=192.168.1.*",
         // Listed when added, but its slot counts as free.
         "network.connectList+=*.*.*.*", "network.allowList+=10.0.0.1",
         "network.allowList+=10.0.0.2", "network.allowList-=010.0.0.1", "replay.replayLock[29]=1",
         "userBgm.rows[9].musicPath=" + Utf8(u8"C:\\音楽\\曲.ogg")});
    EXPECT_EQ(set.exitCode, 0) << set.err;
    EXPECT_EQ(set.out + set.err, "");
    const std::string out = Vekcfg({"show", settings}).out;
    for (const char8_t* line : {
             u8"graphics.screenSize = 3 (1280×960)\n",
             u8"keys.keyboardKeys[14] = 200 (スライド/決定: UP)\n",
             u8"keys.padConfigs[1].buttons[14] = 16 (スライド/決定: BUTTON3)\n",
             u8"network.connectList[0] = \"192.168.001.*\" (192.168.1.0)\n",
             u8"userBgm.rows[9].musicPath = \"C:\\音楽\\曲.ogg\"\n",
         })
        EXPECT_NE(out.find(Utf8(line)), std::string::npos) << Utf8(line);
    const std::vector<std::uint8_t> changed = ReadBytes(settings), initial = ReadBytes(defaults);
    const std::string trees[] = {Vekcfg({"show", "--json", settings}).out,
                                 Vekcfg({"show", "--json", defaults}).out};
    for (int i = 0; i < 2; ++i)
    {
        Write(tree, trees[i]);
        EXPECT_EQ(Vekcfg({"apply", i == 0 ? defaults : settings, tree}).err, "");
    }
    EXPECT_TRUE(ReadBytes(defaults) == changed && ReadBytes(settings) == initial);
}

// One row per rule that refuses a command or a change: every refusal exits 2
// with a message naming the setting or the file, and leaves the file as it
// was.
TEST_F(Commands, EveryKindOfRefusalExitsTwoNamingTheSettingAndLeavesTheFile)
{
    config::CSaveConfig record;
    record.ResetAll();
    ASSERT_TRUE(record.SaveToPath(settings.c_str()));
    const std::vector<std::uint8_t> image = ReadBytes(settings);
    int files = 0;
    const auto file = [&](const std::string& bytes)
    { return Write(folder.File("f" + std::to_string(files++)), bytes); };
    // The settings image with `bytes` at `offset` and its last `cut` bytes gone.
    const auto patched = [&](const std::string& bytes, std::size_t offset, std::size_t cut = 0)
    {
        return file(
            std::string(image.begin(), image.end() - cut).replace(offset, bytes.size(), bytes));
    };
    const auto apply = [&](const std::string& json) {
        return std::vector<std::string>{"apply", settings, file(json)};
    };
    const std::string unreadable = folder.File("folder.dat");
    std::filesystem::create_directory(unreadable);
    std::vector<std::string> overFull{"set", settings};
    for (int slot = 0; slot <= config::kConnectSlotCount; ++slot)
        overFull.push_back("network.connectList+=10.0.0." + std::to_string(slot + 1));
    const std::string program = file("MZ\x90" + std::string(6873, '\0'));

    const struct
    {
        const char* rule;
        std::vector<std::string> arguments;
        std::string named;
    } rows[] = {
        {"no command", {}, "vekcfg: no command given\nusage: vekcfg check"},
        {"an option without its value", {"check", "--svg"}, "--svg needs the path of the picture"},
        {"an empty value", {"check", "--svg", "", "m", "t"}, "--svg needs the path of the picture"},
        {"an unknown option", {"check", "--bogus", "m", "t"}, "option \"--bogus\" for check\n"},
        {"an operand too many", {"draft", "m", "t", "x"}, "draft needs MUSIC [OUT]"},
        {"unknown name", {"set", settings, "graphics.size=1"}, "graphics.size"},
        {"a choice out of range", {"set", settings, "graphics.screenSize=12"}, "screenSize: "},
        {"no such resolution", {"set", settings, "graphics.screenSize=1280x961"}, "screenSize: "},
        {"a switch of 2", {"set", settings, "graphics.fullScreen=2"}, "fullScreen: "},
        {"a lock by a word", {"set", settings, "replay.replayLock[0]=maybe"}, "replayLock[0]: "},
        {"a recipient of 2", {"set", settings, "radioChat.entries[0].notToAll=2"}, "notToAll: "},
        {"a level no slider stores", {"set", settings, "game.bgmVolume=-3000"}, "bgmVolume: "},
        {"a port above 65535", {"set", settings, "network.port=65536"}, "network.port: "},
        {"a controller above 255", {"set", settings, "keys.padConfigs[0].device=256"}, "device: "},
        {"a reserved key", {"set", settings, "keys.keyboardKeys[3]=ESCAPE"}, "keyboardKeys[3]: "},
        {"no such button", {"set", settings, "keys.padConfigs[0].buttons[0]=48"}, "buttons[0]: "},
        {"a stick direction no page assigns",
         {"set", settings, "keys.padConfigs[0].buttons[4]=5", "keys.padConfigs[0].buttons[5]=4"},
         "buttons[4]: no page changes this one"},
        {"a code left on two actions", {"set", settings, "keys.keyboardKeys[4]=Z"}, "same code"},
        {"a text too long",
         {"set", settings, "radioChat.entries[0].text=" + std::string(38, 'r')},
         "entries[0].text: "},
        {"a text code page 932 lacks", apply(R"({"network": {"lobbyId": "\ud83d\ude00"}})"),
         "network.lobbyId: "},
        {"a near match only (U+301C)", apply(R"({"network": {"directId": "\u301c"}})"),
         "directId: the text holds"},
        {"a section, not a field", {"set", settings, "graphics=1"}, "graphics"},
        {"a fifth player", {"set", settings, "keys.padConfigs[4].device=0"}, "padConfigs[4]"},
        {"+= on a value", {"set", settings, "graphics.fullScreen+=1"}, "fullScreen: "},
        {"a list given one value", {"set", settings, "network.allowList=1.2.3.4"}, "allowList: "},
        {"a list given one value in JSON", apply(R"({"network": {"denyList": "1.2.3.4"}})"),
         "denyList: "},
        {"a value given a list", apply(R"({"graphics": {"fullScreen": [1]}})"), "fullScreen: "},
        {"three octets", {"set", settings, "network.allowList+=1.2.3"}, "allowList: "},
        {"-= of an absent address", {"set", settings, "network.allowList-=1.2.3.4"}, "it is empty"},
        {"-= of an address not listed",
         {"set", settings, "network.denyList+=1.2.3.4", "network.denyList-=1.2.3.5"},
         "it holds 001.002.003.004"},
        {"+= on a full 接続 list", overFull, "network.connectList: "},
        {"JSON true for a switch", apply(R"({"graphics": {"fullScreen": true}})"), "fullScreen: "},
        {"JSON number for a text", apply(R"({"network": {"lobbyId": 1}})"), "lobbyId: "},
        {"a fraction", apply(R"({"network": {"port": 1.5}})"), "not a whole number"},
        {"a number beyond a double", apply("[1E400]"), "number overflow parsing '1E400'"},
        {"a member given twice", apply(R"({"a": 1, "a": 2})"), "\"a\" is given twice"},
        {"deeper than the tree", apply("[[[[[[[1]]]]]]]"), "nested deeper than 6"},
        {"invalid UTF-8", apply("[\"\xC3\"]"), "ill-formed UTF-8"},
        {"a lone surrogate", apply(R"(["\ud83d"])"), "column 9: syntax error"},
        {"bad JSON", apply(R"({"graphics": {"screenSize": 3,}})"), "line 1, column 31"},
        {"not a settings file", {"set", program, "graphics.fullScreen=1"}, "0x00905A4D, is no"},
        {"a newer version", {"check-config", patched("\x01", 0)}, "0x13001001, is above"},
        {"the first layout",
         {"set", patched(std::string("\0\x10\0\x10", 4), 0), "game.seVolume=0"},
         "first"},
        {"a section length",
         {"show", patched("\x15", 4)},
         "graphics section is 21 bytes where this tool writes 20"},
        {"a size", {"show", patched("", 0, 1)}, "6875 bytes where its sections and address lists"},
        {"a list count it does not hold",
         {"set", patched("\x01", 536), "game.seVolume=0"},
         "its replay section is 0 bytes"},
        {"a missing file", {"show", missing}, "cannot read the settings file \"" + missing},
        {"an unreadable file", {"set", unreadable, "graphics.screenSize=1"}, "folder.dat"},
    };
    for (const auto& row : rows)
    {
        const std::string path = row.arguments.size() > 1 ? row.arguments[1] : "";
        const std::vector<std::uint8_t> before =
            std::filesystem::is_regular_file(path) ? ReadBytes(path) : std::vector<std::uint8_t>();
        const ProgramRun run = Vekcfg(row.arguments);
        EXPECT_EQ(run.exitCode, 2) << row.rule;
        EXPECT_EQ(run.out, "") << row.rule;
        EXPECT_NE(run.err.find(row.named), std::string::npos) << row.rule << ": " << run.err;
        if (std::filesystem::is_regular_file(path))
        {
            EXPECT_EQ(ReadBytes(path), before) << row.rule;
        }
    }
    const ProgramRun help = Vekcfg({"show", "x", "-h"}); // asked for, it is no refusal
    EXPECT_EQ(help.exitCode, 0);
    EXPECT_EQ(help.out.rfind("vekcfg " + std::string(cli::kVersion) + ": the command-line", 0), 0u);
}

// A draft the check accepts (every length and kind of music: the tension
// tests), and the music it cannot use.
TEST_F(Commands, EveryDraftPassesTheCheckAndMusicItCannotUseGetsItsMessage)
{
    const std::string draft = folder.File("draft.txt");
    const std::pair<double, std::string> rows[] = {
        {59.999, Utf8(u8"60秒以上の長さのファイルが必要です]\n")},
        {183.37, ""},
        {480.001, Utf8(u8"480秒以下の長さのファイルが必要です]\n")},
    };
    for (const auto& [seconds, refusal] : rows)
    {
        testing_support::WriteBytes(music, testing_support::MakeWaveOfLength(seconds));
        std::filesystem::remove(draft);
        const ProgramRun run = Vekcfg({"draft", music, draft});
        EXPECT_EQ(run.exitCode, refusal.empty() ? 0 : 1) << seconds;
        EXPECT_NE(run.err.find(refusal), std::string::npos) << run.err;
        // Without OUT the same text goes to standard output.
        const std::vector<std::uint8_t> drafted = ReadBytes(draft);
        EXPECT_EQ(Vekcfg({"draft", music}).out, std::string(drafted.begin(), drafted.end()));
        if (refusal.empty())
        {
            EXPECT_EQ(Vekcfg({"check", music, draft}).out, kAccepted) << seconds;
        }
    }
    EXPECT_EQ(Vekcfg({"draft", missing}).err, kNoMusic);
}

// The tool's own file, found from TEMP as the tool finds it, where the
// platform has one; it is read, never made.
TEST_F(Commands, WithoutFileTheToolsOwnFileIsShownWhereThereIsOne)
{
    testing_support::TempSaveFolder save;
    std::filesystem::create_directories(save.Root().Path() / "Temp");
    std::filesystem::create_directories(save.SaveDirectory());
    config::CSaveConfig record;
    record.ResetAll();
    record.Network()->port = 12345;
    ASSERT_TRUE(record.SaveToPath(save.SettingsFile().c_str()));
    std::string own, reason;
    const bool hasOwn = cli::DefaultSettingsPath(&own, &reason);
    const ProgramRun shown = Vekcfg({"show"});
    EXPECT_EQ(shown.exitCode, hasOwn ? 0 : 2);
    EXPECT_NE(hasOwn ? shown.out.find("network.port = 12345\n")
                     : shown.err.find(reason + "\nusage: "),
              std::string::npos);
    std::filesystem::remove(save.SettingsFile());
    EXPECT_EQ(Vekcfg({"check-config"}).exitCode, 2);
    EXPECT_FALSE(std::filesystem::exists(save.SettingsFile()));
}

} // namespace
} // namespace cli_testing
