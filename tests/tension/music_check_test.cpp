// The check of one music row: the outcome and the text the user is shown,
// from music and tension files written by the test.
#include "tension/music_check.h"
#include "tests/support/audio_fixtures.h"
#include "tests/support/sound_device_fixture.h"
#include "tests/support/temp_folder.h"

#include <filesystem>
#include <gtest/gtest.h>
#include <string>

using tension::CheckMusicRow;
using tension::CTextString;
using tension::MusicCheckResult;
using testing_support::TempFolder;

namespace
{

constexpr char kSuccess[] = "テンションファイル作成成功!!";
constexpr char kMusicUnreadable[] = "BGMファイルが開けません";
constexpr char kIsCorrectError[] = "Time Data IsCorrect Error!!\n";
constexpr char kConversionError[] = "変換エラー!!\n";

void WriteText(const std::string& path, const std::string& text)
{
    testing_support::WriteBytes(path, std::vector<std::uint8_t>(text.begin(), text.end()));
}

// Files named relative to a fresh working folder, so that a tension file's
// path, which stands in for a missing name entry, stays within 40 bytes.
class MusicCheckTest : public ::testing::Test
{
protected:
    void SetUp() override
    {
        ASSERT_TRUE(device_.Ready());
        previous_ = std::filesystem::current_path();
        std::filesystem::current_path(folder_.Path());
        testing_support::WriteBytes("two-minutes.wav", testing_support::MakeWaveOfLength(120.0));
        testing_support::WriteBytes("half-minute.wav", testing_support::MakeWaveOfLength(30.0));
        testing_support::WriteBytes("three-minutes.wav", testing_support::MakeWaveOfLength(180.0));
        WriteText("unknown-key.txt", "SPEED: 3;\n");
        WriteText("named.txt", "NAME: Test;\nLOW: 30;\n");
    }
    void TearDown() override { std::filesystem::current_path(previous_); }

    struct Outcome
    {
        MusicCheckResult result;
        std::string shown;
    };

    static Outcome Check(const std::string& music, const std::string& tensionFile)
    {
        CTextString message("left over");
        const MusicCheckResult result = CheckMusicRow(music.c_str(), tensionFile.c_str(), &message);
        return Outcome{result, message.CStr()};
    }

    testing_support::ScopedSoundDevice device_;
    TempFolder folder_;
    std::filesystem::path previous_;
};

} // namespace

TEST_F(MusicCheckTest, MusicThatCannotBeDecodedIsReportedBeforeTheTensionFileIsRead)
{
    WriteText("not-music.wav", "RIFF? no.");
    WriteText("not-music.ogg", "OggS? no.");
    for (const char* music : {"", "missing.wav", "not-music.wav", "not-music.ogg"})
    {
        const Outcome outcome = Check(music, "no-such-tension.txt");
        EXPECT_EQ(outcome.result, MusicCheckResult::MusicUnreadable) << music;
        EXPECT_EQ(outcome.shown, kMusicUnreadable) << music;
    }
}

TEST_F(MusicCheckTest, ARejectedTensionFileShowsTheWholeLogInOrder)
{
    WriteText("climax-too-long.txt",
              "FILENAME : Test;\nLOW : 30;\nHI : 60;\nLOW : 90;\nCLIMAX : 150;\nFINALE : 170;\n");
    const struct
    {
        const char* music;
        const char* tensionFile;
        std::string log;
    } cases[] = {
        {"two-minutes.wav", "", "ファイルが開けません!!\n"},
        {"two-minutes.wav", "missing.txt", "ファイルが開けません!!\n"},
        {"half-minute.wav", "named.txt",
         std::string("Time Data Outside Range!!\n"
                     "ファイル時間 エラー[30.000000秒のファイルです : "
                     "60秒以上の長さのファイルが必要です]\n") +
             kIsCorrectError + kConversionError},
        {"three-minutes.wav", "climax-too-long.txt",
         std::string(
             "ClimaxTension 時間オーバー[現在 30.000000 秒です 18 秒以内にしてください]\n") +
             kIsCorrectError + kConversionError},
    };
    for (const auto& c : cases)
    {
        const Outcome outcome = Check(c.music, c.tensionFile);
        EXPECT_EQ(outcome.result, MusicCheckResult::TensionRejected) << c.tensionFile;
        EXPECT_EQ(outcome.shown, c.log) << c.tensionFile;
    }
}

TEST_F(MusicCheckTest, AnAcceptedFileShowsSuccessAndNotItsWarnings)
{
    for (const char* tensionFile : {"unknown-key.txt", "named.txt"})
    {
        const Outcome outcome = Check("two-minutes.wav", tensionFile);
        EXPECT_EQ(outcome.result, MusicCheckResult::Accepted) << tensionFile;
        EXPECT_EQ(outcome.shown, kSuccess) << tensionFile;
    }
}

TEST_F(MusicCheckTest, OggVorbisMusicIsCheckedByItsDecodedLength)
{
    testing_support::OggFixture fixture;
    fixture.channels = 1;
    fixture.sampleRate = 8000;
    fixture.samplesPerChannel = 8000 * 90;
    testing_support::WriteBytes("ninety-seconds.ogg", testing_support::EncodeOggVorbis(fixture));
    fixture.samplesPerChannel = 8000 * 59;
    testing_support::WriteBytes("too-short.ogg", testing_support::EncodeOggVorbis(fixture));

    EXPECT_EQ(Check("ninety-seconds.ogg", "named.txt").result, MusicCheckResult::Accepted);
    EXPECT_EQ(Check("too-short.ogg", "named.txt").result, MusicCheckResult::TensionRejected);
}

// Windows refuses to delete a file that is still open.
TEST_F(MusicCheckTest, NeitherFileIsHeldAfterTheCheck)
{
    for (const char* tensionFile : {"named.txt", "unknown-key.txt"})
        Check("two-minutes.wav", tensionFile);
    Check("half-minute.wav", "named.txt");
    for (const char* file : {"two-minutes.wav", "half-minute.wav", "named.txt", "unknown-key.txt"})
        EXPECT_TRUE(std::filesystem::remove(file)) << file;
}

TEST_F(MusicCheckTest, TheMessageMayBeLeftOut)
{
    EXPECT_EQ(CheckMusicRow("two-minutes.wav", "named.txt", nullptr), MusicCheckResult::Accepted);
    EXPECT_EQ(CheckMusicRow("missing.wav", "named.txt", nullptr),
              MusicCheckResult::MusicUnreadable);
    EXPECT_EQ(CheckMusicRow("two-minutes.wav", "missing.txt", nullptr),
              MusicCheckResult::TensionRejected);
}
