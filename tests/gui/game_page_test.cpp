// The Game page: what it shows of the record, what each control writes into
// it, and the rules of the three volume sliders.
#include "resources/resource.h"
#include "tests/gui/gui_harness.h"
#include "tests/gui/page_checks.h"

#include <gtest/gtest.h>

using gui::RunningTool;

namespace
{
using Field = std::uint32_t (*)(config::CSaveConfig&);

struct Control
{
    int id;
    Field field;
};

const Control kChecks[] = {
    {IDC_VOICE_PLAYBACK, [](config::CSaveConfig& r) { return r.Game()->voicePlayback; }},
    {IDC_CAPTURE_ENABLED, [](config::CSaveConfig& r) { return r.Game()->captureEnabled; }},
    {IDC_PAD_VIBRATION, [](config::CSaveConfig& r) { return r.Game()->padVibration; }},
    {IDC_SCREEN_SHAKE, [](config::CSaveConfig& r) { return r.Game()->screenShake; }},
};

struct Choice
{
    int id;
    int options;
    Field field;
};

const Choice kChoices[] = {
    {IDC_RADAR_TYPE, 2,
     [](config::CSaveConfig& r) -> std::uint32_t { return r.Game()->radarType; }},
    {IDC_ARCADE_DIFFICULTY, 4,
     [](config::CSaveConfig& r) -> std::uint32_t { return r.Game()->arcadeDifficulty; }},
    {IDC_GUARD_CORRECTION, 2,
     [](config::CSaveConfig& r) -> std::uint32_t { return r.Game()->guardCorrection; }},
    {IDC_CAMERA_POSITION, 2,
     [](config::CSaveConfig& r) -> std::uint32_t { return r.Game()->cameraPosition; }},
    {IDC_LOCK_ON_TYPE, 4, [](config::CSaveConfig& r) { return r.Game()->lockOnType; }},
    {IDC_CAPTURE_SIZE, 12,
     [](config::CSaveConfig& r) -> std::uint32_t { return r.Game()->captureSize; }},
};

const int kSliders[] = {IDC_BGM_VOLUME, IDC_SE_VOLUME, IDC_VOICE_VOLUME};

struct Volumes
{
    std::int32_t bgm, se, voice;
    bool operator==(const Volumes&) const = default;
};

std::ostream& operator<<(std::ostream& out, const Volumes& v)
{
    return out << v.bgm << "/" << v.se << "/" << v.voice;
}

Volumes VolumesOf(RunningTool& tool)
{
    const config::ConfigGame* game = tool.Record().Game();
    return {game->bgmVolume, game->seVolume, game->voiceVolume};
}

std::vector<std::uint8_t> WithVolumes(Volumes volumes)
{
    return gui::SettingsWith(
        [volumes](config::CSaveConfig& record)
        {
            record.Game()->bgmVolume = volumes.bgm;
            record.Game()->seVolume = volumes.se;
            record.Game()->voiceVolume = volumes.voice;
        });
}
} // namespace

TEST(GamePage, ShowsTheRecordsValues)
{
    // Every field away from its default.
    RunningTool tool(gui::SettingsWith(
        [](config::CSaveConfig& record)
        { *record.Game() = {0, 0, -2500, -10, -1000, 0, 2, 1, 0, 0, 3, 1, 9, {}}; }));
    const HWND page = tool.Page(kGamePageIndex);
    for (const Control& check : kChecks)
        EXPECT_EQ(gui::IsChecked(page, check.id), check.field(tool.Record()) != 0) << check.id;
    for (const Choice& choice : kChoices)
        EXPECT_EQ(gui::Selection(page, choice.id), choice.field(tool.Record())) << choice.id;
    EXPECT_EQ(gui::SliderPosition(page, IDC_BGM_VOLUME), -2500);
    EXPECT_EQ(gui::SliderPosition(page, IDC_SE_VOLUME), -10);
    EXPECT_EQ(gui::SliderPosition(page, IDC_VOICE_VOLUME), -1000);
    EXPECT_EQ(gui::ItemText(page, IDC_LOCK_ON_TYPE, 2), "カメラ正面優先");
    EXPECT_EQ(gui::ItemText(page, IDC_CAPTURE_SIZE, 9), "1440\x81\x7E"
                                                        "900");
}

TEST(GamePage, EveryControlReachesItsField)
{
    RunningTool tool;
    const HWND page = tool.Page(kGamePageIndex);
    for (const Control& check : kChecks)
    {
        for (bool on : {true, false, true})
        {
            tool.SetCheck(page, check.id, on);
            EXPECT_EQ(check.field(tool.Record()), on ? 1u : 0u) << check.id;
        }
    }
    for (const Choice& choice : kChoices)
    {
        ASSERT_EQ(gui::ItemCount(page, choice.id), choice.options) << choice.id;
        for (int index : {choice.options - 1, 0})
        {
            tool.Choose(page, choice.id, index);
            EXPECT_EQ(choice.field(tool.Record()), static_cast<std::uint32_t>(index)) << choice.id;
        }
    }
    gui::Slide(page, IDC_BGM_VOLUME, -100);
    gui::Slide(page, IDC_SE_VOLUME, -200);
    gui::Slide(page, IDC_VOICE_VOLUME, -300);
    EXPECT_EQ(VolumesOf(tool), (Volumes{-100, -200, -300}));
}

TEST(GamePage, SlidersRunFromMinus3000To0InStepsOf10)
{
    RunningTool tool;
    const HWND page = tool.Page(kGamePageIndex);
    for (int id : kSliders)
    {
        EXPECT_EQ(SendDlgItemMessageA(page, id, TBM_GETRANGEMIN, 0, 0), -3000) << id;
        EXPECT_EQ(SendDlgItemMessageA(page, id, TBM_GETRANGEMAX, 0, 0), 0) << id;
        EXPECT_EQ(SendDlgItemMessageA(page, id, TBM_GETLINESIZE, 0, 0), 10) << id;
    }
}

TEST(GamePage, MovingAnySliderRewritesAllThreeVolumes)
{
    const struct
    {
        Volumes stored;
        int slider;
        int position;
        Volumes after;
    } cases[] = {
        // The left end is silence, whichever slider sits there.
        {{0, 0, 0}, IDC_SE_VOLUME, -3000, {0, -10000, 0}},
        {{-10000, -1200, 0}, IDC_VOICE_VOLUME, -500, {-10000, -1200, -500}},
        {{-2999, -2999, -2999}, IDC_BGM_VOLUME, -2999, {-2999, -2999, -2999}},
        // Values the sliders cannot show are replaced by what they do show.
        {{-5000, 300, 0}, IDC_VOICE_VOLUME, -20, {-10000, 0, -20}},
    };
    for (const auto& c : cases)
    {
        RunningTool tool(WithVolumes(c.stored));
        gui::Slide(tool.Page(kGamePageIndex), c.slider, c.position);
        EXPECT_EQ(VolumesOf(tool), c.after) << c.stored;
    }
}

TEST(GamePage, AStoredSilenceShowsAsTheLeftEndAndIsSavedUntouched)
{
    RunningTool tool(WithVolumes({-10000, -10000, -10000}));
    const HWND page = tool.Page(kGamePageIndex);
    for (int id : kSliders)
        EXPECT_EQ(gui::SliderPosition(page, id), -3000) << id;
    tool.SetCheck(page, IDC_SCREEN_SHAKE, false);
    tool.Save();
    const std::vector<std::uint8_t> file = gui::ReadFile(tool.SettingsFile());
    for (std::size_t offset : {8u, 12u, 16u})
        EXPECT_EQ(gui::LittleEndianAt(file, gui::kGameInFile + offset), -10000) << offset;
}

TEST(GamePage, AChoiceOutsideAListShowsNothingAndStaysUntilChosen)
{
    RunningTool tool(gui::SettingsWith(
        [](config::CSaveConfig& record)
        {
            record.Game()->lockOnType = 4;
            record.Game()->captureSize = 12;
        }));
    const HWND page = tool.Page(kGamePageIndex);
    EXPECT_EQ(gui::Selection(page, IDC_LOCK_ON_TYPE), CB_ERR);
    EXPECT_EQ(gui::Selection(page, IDC_CAPTURE_SIZE), CB_ERR);
    tool.Choose(page, IDC_RADAR_TYPE, 1);
    EXPECT_EQ(tool.Record().Game()->lockOnType, 4u);
    EXPECT_EQ(tool.Record().Game()->captureSize, 12);
}

TEST(GamePage, SavingWritesWhatTheControlsSet)
{
    RunningTool tool;
    const HWND page = tool.Page(kGamePageIndex);
    tool.SetCheck(page, IDC_SCREEN_SHAKE, false);
    tool.SetCheck(page, IDC_CAPTURE_ENABLED, true);
    gui::Slide(page, IDC_SE_VOLUME, -3000);
    gui::Slide(page, IDC_VOICE_VOLUME, -1230);
    tool.Choose(page, IDC_LOCK_ON_TYPE, 3);
    tool.Choose(page, IDC_RADAR_TYPE, 1);
    tool.Choose(page, IDC_CAMERA_POSITION, 0);
    tool.Choose(page, IDC_GUARD_CORRECTION, 0);
    tool.Choose(page, IDC_ARCADE_DIFFICULTY, 2);
    tool.Choose(page, IDC_CAPTURE_SIZE, 7);
    tool.Save();

    const std::vector<std::uint8_t> file = gui::ReadFile(tool.SettingsFile());
    const std::vector<std::uint8_t> section(file.begin() + gui::kGameInFile,
                                            file.begin() + gui::kGameInFile + 40);
    const std::vector<std::uint8_t> expected = {
        0,    0,    0,    0,    // screenShake
        1,    0,    0,    0,    // padVibration
        0,    0,    0,    0,    // bgmVolume
        0xF0, 0xD8, 0xFF, 0xFF, // seVolume -10000
        0x32, 0xFB, 0xFF, 0xFF, // voiceVolume -1230
        1,    0,    0,    0,    // voicePlayback
        3,    0,    0,    0,    // lockOnType
        1,    0,    0,    2,    // radar, camera, guard, difficulty
        1,    0,    0,    0,    // captureEnabled
        7,    0,    0,    0,    // captureSize and padding
    };
    EXPECT_EQ(section, expected);
}
