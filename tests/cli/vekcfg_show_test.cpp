// vekcfg show, its JSON, and the usage and file errors of every command.
#include "tests/cli/json_reader.h"
#include "tests/cli/vekcfg_fixture.h"

#include <cstring>
#include <filesystem>

namespace cli_testing
{
namespace
{

config::IpEntry Address(const char* a, const char* b, const char* c, const char* d)
{
    config::IpEntry entry{};
    const char* octets[] = {a, b, c, d};
    for (int i = 0; i < 4; ++i)
        std::memcpy(entry.octets[i], octets[i], std::strlen(octets[i]));
    return entry;
}

// A record unlike the defaults in every kind of value the report names.
config::CSaveConfig Varied()
{
    config::CSaveConfig record;
    record.ResetAll();
    record.Graphics()->screenSize = 8;
    record.Graphics()->hdrLevel = 2;
    record.Graphics()->trailQuality = 4;
    record.Game()->bgmVolume = -10000;
    record.Game()->seVolume = -1250;
    record.Game()->lockOnType = 3;
    record.Network()->port = 27015;
    std::strcpy(record.Network()->lobbyId, "abc");
    record.AddConnectEntry(Address("192", "168", "000", "001"));
    record.AddAllowEntry(Address("010", "000", "*", "001"));
    record.Replay()->replayLock[2] = 1;
    std::strcpy(record.UserBgm()->rows[0].musicPath, "C:\\music\\a.ogg");
    std::strcpy(record.UserBgm()->rows[0].tensionPath, "C:\\music\\\"a\".txt");
    record.Keys()->padConfigs[1].buttons[14] = 15;
    record.Keys()->padConfigs[1].device = 3;
    // 表 ends in the byte of a backslash (95 5C).
    std::strcpy(record.RadioChat()->entries[0].text, "表示");
    record.RadioChat()->entries[0].notToAll = 1;
    return record;
}

using ShowTest = VekcfgRun;

TEST_F(ShowTest, PrintsEverySettingByNameWithItsMeaning)
{
    WriteSettings("GameConfig.dat", Varied());
    const ProgramRun run = Run({"show", "GameConfig.dat"});
    EXPECT_EQ(run.exitCode, 0);
    EXPECT_EQ(run.err, "");
    const std::string lines[] = {
        "file = \"GameConfig.dat\"\n",
        "version = 318771200 (0x13001000)\n",
        Utf8(u8"graphics.screenSize = 8 (1920×1080)\n"),
        "graphics.fullScreen = 0 (off)\n",
        "graphics.hdrLevel = 2 (LEVEL2)\n",
        Utf8(u8"graphics.trailQuality = 4 (最高)\n"),
        "game.bgmVolume = -10000 (silent)\n",
        "game.seVolume = -1250 (-12.50 dB)\n",
        "game.voiceVolume = 0 (0.00 dB)\n",
        Utf8(u8"game.lockOnType = 3 (順送り)\n"),
        Utf8(u8"game.cameraPosition = 1 (右)\n"),
        "network.port = 27015\n",
        "network.keyResponse = 1 (2)\n",
        "network.lobbyId = \"abc\"\n",
        "network.connectList[0] = \"192.168.0.1\"\n",
        "network.allowList[0] = \"010.000.*.001\"\n",
        "network.denyList = (none)\n",
        "network.playBgm = 1 (on)\n",
        Utf8(u8"replay.replayLock[2] = 1 (リプレイ3: locked)\n"),
        Utf8(u8"replay.replayLock[29] = 0 (リプレイ30: unlocked)\n"),
        "userBgm.rows[0].musicPath = \"C:\\music\\a.ogg\"\n",
        "userBgm.rows[9].tensionPath = \"\"\n",
        Utf8(u8"keys.keyboardKeys[4] = 200 (移動上: UP)\n"),
        Utf8(u8"keys.keyboardKeys[0] = 80 (使用しない: NUMPAD2)\n"),
        Utf8(u8"keys.padConfigs[1].buttons[14] = 15 (スライド/決定: BUTTON2)\n"),
        "keys.padConfigs[1].device = 3 (2P: game controller 3 in enumeration order)\n",
        Utf8(u8"radioChat.entries[0].text = \"表示\" (F1)\n"),
        Utf8(u8"radioChat.entries[0].notToAll = 1 (F1: not to everyone (全体 cleared))\n"),
        Utf8(u8"radioChat.entries[11].notToAll = 0 (F12: to everyone (全体 checked))\n"),
    };
    for (const std::string& line : lines)
        EXPECT_NE(run.out.find(line), std::string::npos) << line;
}

const JsonValue& At(const JsonValue& value, const std::vector<std::string>& path)
{
    static const JsonValue missing;
    const JsonValue* current = &value;
    for (const std::string& step : path)
    {
        if (current->kind == JsonValue::Kind::Array)
        {
            const std::size_t index = std::stoul(step);
            current = index < current->items.size() ? &current->items[index] : nullptr;
        }
        else
        {
            current = current->Member(step);
        }
        if (current == nullptr)
            return missing;
    }
    return *current;
}

TEST_F(ShowTest, JsonReadsBackToTheSameSettings)
{
    WriteSettings("GameConfig.dat", Varied());
    const ProgramRun run = Run({"show", "--json", "GameConfig.dat"});
    EXPECT_EQ(run.exitCode, 0);
    JsonValue root;
    ASSERT_TRUE(ParseJson(run.out, &root)) << run.out;

    const std::pair<std::vector<std::string>, double> numbers[] = {
        {{"version", "value"}, 0x13001000},
        {{"graphics", "screenSize", "value"}, 8},
        {{"game", "seVolume", "value"}, -1250},
        {{"network", "port"}, 27015},
        {{"replay", "replayLock", "2", "value"}, 1},
        {{"keys", "keyboardKeys", "23", "value"}, 0x39},
        {{"keys", "padConfigs", "1", "device", "value"}, 3},
        {{"radioChat", "entries", "0", "notToAll", "value"}, 1},
    };
    for (const auto& [path, number] : numbers)
    {
        EXPECT_EQ(At(root, path).kind, JsonValue::Kind::Number) << path.back();
        EXPECT_EQ(At(root, path).number, number) << path.back();
    }
    const std::pair<std::vector<std::string>, std::string> texts[] = {
        {{"file"}, "GameConfig.dat"},
        {{"graphics", "screenSize", "meaning"}, Utf8(u8"1920×1080")},
        {{"network", "lobbyId"}, "abc"},
        {{"network", "connectList", "0"}, "192.168.0.1"},
        {{"network", "allowList", "0"}, "010.000.*.001"},
        {{"userBgm", "rows", "0", "musicPath"}, "C:\\music\\a.ogg"},
        {{"userBgm", "rows", "0", "tensionPath"}, "C:\\music\\\"a\".txt"},
        {{"keys", "keyboardKeys", "23", "meaning"}, Utf8(u8"命令変更: SPACE")},
        {{"radioChat", "entries", "0", "text", "value"}, Utf8(u8"表示")},
    };
    for (const auto& [path, text] : texts)
        EXPECT_EQ(At(root, path).string, text) << path.back();
    const std::pair<std::vector<std::string>, std::size_t> sizes[] = {
        {{"network", "denyList"}, 0},   {{"replay", "replayLock"}, 30},
        {{"userBgm", "rows"}, 10},      {{"keys", "keyboardKeys"}, 24},
        {{"keys", "padConfigs"}, 4},    {{"keys", "padConfigs", "3", "buttons"}, 24},
        {{"radioChat", "entries"}, 12},
    };
    for (const auto& [path, size] : sizes)
    {
        EXPECT_EQ(At(root, path).kind, JsonValue::Kind::Array) << path.back();
        EXPECT_EQ(At(root, path).items.size(), size) << path.back();
    }
}

TEST_F(ShowTest, UnreadableSettingsFilesExitTwoNamingThePath)
{
    std::filesystem::create_directories(Path("folder.dat"));
    WriteText("short.dat", "ab");
    WriteText("newer.dat", std::string("\x01\x10\x00\x13", 4) + std::string(6872, '\0'));
    const std::pair<const char*, std::string> cases[] = {
        {"missing.dat", "vekcfg: cannot read the settings file \"missing.dat\": "},
        {"folder.dat", "vekcfg: cannot read the settings file \"folder.dat\": "},
        {"short.dat", "vekcfg: the settings file \"short.dat\" is not a settings file: it is "
                      "shorter than its version word\n"},
        {"newer.dat", "vekcfg: the settings file \"newer.dat\" has version 0x13001001; this "
                      "tool reads versions up to 0x13001000\n"},
    };
    for (const char* command : {"show", "check-config"})
    {
        for (const auto& [file, message] : cases)
        {
            const ProgramRun run = Run({command, file});
            EXPECT_EQ(run.exitCode, 2) << command << " " << file;
            EXPECT_EQ(run.out, "") << command << " " << file;
            EXPECT_EQ(run.err.substr(0, message.size()), message) << command << " " << file;
        }
    }
    EXPECT_FALSE(std::filesystem::exists(Path("missing.dat"))) << "a missing file is never made";
}

TEST_F(ShowTest, UsageErrorsExitTwoWithTheUsageOnStandardError)
{
    const std::vector<std::string> cases[] = {
        {},
        {"frobnicate"},
        {"check", "music.wav"},
        {"check", "a", "b", "c"},
        {"check", "--svg"},
        {"check", "--svg", "a.svg", "--svg", "b.svg", "m", "t"},
        {"check", "--bogus", "m", "t"},
        {"check", "--details", "--details", "m", "t"},
        {"check-config", "a.dat", "b.dat"},
        {"check-config", "--json", "a.dat"},
        {"show", "--details", "a.dat"},
        {"--version", "show"},
    };
    for (const std::vector<std::string>& arguments : cases)
    {
        const ProgramRun run = Run(arguments);
        const std::string shown = arguments.empty() ? "(none)" : arguments[0];
        EXPECT_EQ(run.exitCode, 2) << shown;
        EXPECT_EQ(run.out, "") << shown;
        EXPECT_EQ(run.err.rfind("vekcfg: ", 0), 0u) << shown;
        EXPECT_NE(run.err.find("\nusage: vekcfg check [--details] [--svg OUT.svg] MUSIC TENSION\n"),
                  std::string::npos)
            << shown;
    }
}

TEST_F(ShowTest, HelpAndVersionExitZero)
{
    for (const std::vector<std::string>& arguments :
         {std::vector<std::string>{"--help"}, {"-h"}, {"check", "--help"}, {"show", "x", "-h"}})
    {
        const ProgramRun run = Run(arguments);
        EXPECT_EQ(run.exitCode, 0) << arguments[0];
        EXPECT_EQ(run.out.rfind("vekcfg 1.0.0: the command-line companion", 0), 0u) << run.out;
        EXPECT_NE(run.out.find("Exit status: 0 success"), std::string::npos);
    }
    const ProgramRun version = Run({"--version"});
    EXPECT_EQ(version.out, "vekcfg 1.0.0\n");
    EXPECT_EQ(version.exitCode, 0);
}

TEST_F(ShowTest, ADoubleDashEndsTheOptionsSoAPathMayBeginWithADash)
{
    WriteSettings("-odd.dat", Varied());
    const ProgramRun run = Run({"show", "--json", "--", "-odd.dat"});
    EXPECT_EQ(run.exitCode, 0) << run.err;
    JsonValue root;
    EXPECT_TRUE(ParseJson(run.out, &root));
}

} // namespace
} // namespace cli_testing
