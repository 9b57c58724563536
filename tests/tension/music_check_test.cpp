// The check of one music row, wired to the sound buffer and the tension
// file: what the user is shown for each outcome.
#include "tension/music_check.h"
#include "tests/support/audio_fixtures.h"
#include "tests/support/sound_device_fixture.h"
#include "tests/support/temp_folder.h"

#include <filesystem>
#include <gtest/gtest.h>
#include <string>
#include <tuple>

using tension::MusicCheckResult;

TEST(MusicCheck, TheUserIsShownTheOutcomeOrTheWholeLogAndNeitherFileIsHeld)
{
    testing_support::ScopedSoundDevice device;
    ASSERT_TRUE(device.Ready());
    const testing_support::TempFolder folder;
    const std::string tension = folder.File("named.txt"), music = folder.File("120.wav"),
                      shortMusic = folder.File("30.wav"), text = "NAME: x;\nLOW: 30;\nSPEED: 3;\n";
    testing_support::WriteBytes(tension, {text.begin(), text.end()});
    testing_support::WriteBytes(music, testing_support::MakeWaveOfLength(120.0));
    testing_support::WriteBytes(shortMusic, testing_support::MakeWaveOfLength(30.0));
    const std::tuple<std::string, MusicCheckResult, std::string> cases[] = {
        {folder.File("missing.wav"), MusicCheckResult::MusicUnreadable, "BGMファイルが開けません"},
        {music, MusicCheckResult::Accepted, "テンションファイル作成成功!!"},
        {shortMusic, MusicCheckResult::TensionRejected,
         "Time Data Outside Range!!\nTime Data Not Tension!!\n"
         "ファイル時間 エラー[30.000000秒のファイルです : 60秒以上の長さのファイルが必要です]\n"
         "Time Data IsCorrect Error!!\n変換エラー!!\n"},
    };
    for (const auto& [row, result, shown] : cases)
    {
        tension::CTextString message("left over");
        EXPECT_EQ(tension::CheckMusicRow(row.c_str(), tension.c_str(), &message), result);
        EXPECT_EQ(message.CStr(), shown) << row;
    }
    // Windows refuses to delete a file that is still open.
    for (const std::string& file : {tension, music, shortMusic})
        EXPECT_TRUE(std::filesystem::remove(file)) << file;
}
