// What show makes of values the pages never store: a damaged or foreign
// file may hold any byte.
#include "cli/settings_report.h"
#include "tests/cli/vekcfg_runner.h"

#include <cstring>
#include <gtest/gtest.h>

namespace
{

using cli_testing::Utf8;

std::string Text(const config::CSaveConfig& record)
{
    return cli::SettingsText(cli::DescribeSettings(record, "f", config::kFileVersion));
}

TEST(SettingsReport, ValuesOutsideTheChoicesAndNamesAreSaidSo)
{
    config::CSaveConfig record;
    record.ResetAll();
    record.Graphics()->screenSize = 12;
    record.Game()->lockOnType = 0xFFFFFFFF;
    record.Network()->keyResponse = 5;
    record.Keys()->keyboardKeys[4] = 0x1C8; // the low byte names it
    record.Keys()->keyboardKeys[5] = 0xFD;
    record.Keys()->padConfigs[0].buttons[14] = 200;
    const std::string text = Text(record);
    for (const std::string& line : {
             std::string("graphics.screenSize = 12 (no such choice)\n"),
             std::string("game.lockOnType = 4294967295 (no such choice)\n"),
             std::string("network.keyResponse = 5 (no such choice)\n"),
             Utf8(u8"keys.keyboardKeys[4] = 456 (移動上: UP)\n"),
             Utf8(u8"keys.keyboardKeys[5] = 253 (移動下: (no name))\n"),
             Utf8(u8"keys.padConfigs[0].buttons[14] = 200 (スライド/決定: (no name))\n"),
         })
        EXPECT_NE(text.find(line), std::string::npos) << line;
}

TEST(SettingsReport, StringsEndAtTheirFieldAndControlCharactersAreEscaped)
{
    config::CSaveConfig record;
    record.ResetAll();
    config::UserBgmRow& row = record.UserBgm()->rows[0];
    std::memset(row.musicPath, 'a', sizeof row.musicPath); // no terminator
    std::strcpy(row.tensionPath, "t.txt");
    std::strcpy(record.RadioChat()->entries[1].text, "go\n\tnow\x01");
    const std::string text = Text(record);
    // As the page reads it: the last byte is the terminator's.
    EXPECT_NE(text.find("userBgm.rows[0].musicPath = \"" + std::string(259, 'a') + "\"\n"),
              std::string::npos);
    EXPECT_NE(text.find("radioChat.entries[1].text = \"go\\n\\tnow\\x01\" (F2)\n"),
              std::string::npos);
    const std::string json =
        cli::SettingsJson(cli::DescribeSettings(record, "f", config::kFileVersion));
    EXPECT_NE(json.find("\"value\": \"go\\n\\tnow\\u0001\""), std::string::npos);
}

} // namespace
