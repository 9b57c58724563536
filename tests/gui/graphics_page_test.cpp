// The Graphics page: what it shows of the record, what each control writes
// into it, and values the lists cannot show.
#include "resources/resource.h"
#include "tests/gui/gui_harness.h"
#include "tests/gui/page_checks.h"

#include <gtest/gtest.h>

using gui::RunningTool;

namespace
{
struct Choice
{
    int id;
    int options;
    std::uint32_t (*field)(config::CSaveConfig&);
};

const Choice kChoices[] = {
    {IDC_SCREEN_SIZE, 12,
     [](config::CSaveConfig& r) -> std::uint32_t { return r.Graphics()->screenSize; }},
    {IDC_HDR_LEVEL, 5,
     [](config::CSaveConfig& r) -> std::uint32_t { return r.Graphics()->hdrLevel; }},
    {IDC_TRAIL_QUALITY, 5, [](config::CSaveConfig& r) { return r.Graphics()->trailQuality; }},
};

struct Check
{
    int id;
    std::uint32_t (*field)(config::CSaveConfig&);
};

const Check kChecks[] = {
    {IDC_FULL_SCREEN, [](config::CSaveConfig& r) { return r.Graphics()->fullScreen; }},
    {IDC_SHOW_MOVIE, [](config::CSaveConfig& r) { return r.Graphics()->showMovie; }},
};
} // namespace

TEST(GraphicsPage, ShowsTheRecordsValues)
{
    RunningTool tool(gui::SettingsWith([](config::CSaveConfig& record)
                                       { *record.Graphics() = {8, {}, 1, 0, 3, {}, 4}; }));
    const HWND page = tool.Page(kGraphicsPageIndex);
    EXPECT_EQ(gui::Selection(page, IDC_SCREEN_SIZE), 8);
    EXPECT_EQ(gui::ItemText(page, IDC_SCREEN_SIZE, 8), "1920\x81\x7E"
                                                       "1080");
    EXPECT_EQ(gui::Selection(page, IDC_HDR_LEVEL), 3);
    EXPECT_EQ(gui::ItemText(page, IDC_HDR_LEVEL, 3), "LEVEL3");
    EXPECT_EQ(gui::Selection(page, IDC_TRAIL_QUALITY), 4);
    EXPECT_EQ(gui::ItemText(page, IDC_TRAIL_QUALITY, 4), "最高");
    EXPECT_TRUE(gui::IsChecked(page, IDC_FULL_SCREEN));
    EXPECT_FALSE(gui::IsChecked(page, IDC_SHOW_MOVIE));
}

TEST(GraphicsPage, EveryControlReachesItsField)
{
    RunningTool tool;
    const HWND page = tool.Page(kGraphicsPageIndex);
    for (const Choice& choice : kChoices)
    {
        ASSERT_EQ(gui::ItemCount(page, choice.id), choice.options) << choice.id;
        for (int index : {choice.options - 1, 0})
        {
            tool.Choose(page, choice.id, index);
            EXPECT_EQ(choice.field(tool.Record()), static_cast<std::uint32_t>(index)) << choice.id;
        }
    }
    for (const Check& check : kChecks)
    {
        for (bool on : {true, false, true})
        {
            tool.SetCheck(page, check.id, on);
            EXPECT_EQ(check.field(tool.Record()), on ? 1u : 0u) << check.id;
        }
    }
}

TEST(GraphicsPage, AScreenSizeOutsideTheListShowsNothingAndStaysUntilChosen)
{
    // 200 is past the list too, and reaches it as -56.
    for (std::uint8_t stored : {12, 200})
    {
        RunningTool tool(gui::SettingsWith([stored](config::CSaveConfig& record)
                                           { record.Graphics()->screenSize = stored; }));
        const HWND page = tool.Page(kGraphicsPageIndex);
        EXPECT_EQ(gui::Selection(page, IDC_SCREEN_SIZE), CB_ERR) << +stored;
        tool.SetCheck(page, IDC_FULL_SCREEN, true);
        tool.Save();
        EXPECT_EQ(gui::ReadFile(tool.SettingsFile())[gui::kGraphicsInFile], stored);

        tool.Choose(page, IDC_SCREEN_SIZE, 5);
        EXPECT_EQ(tool.Record().Graphics()->screenSize, 5);
    }
}

TEST(GraphicsPage, SavingWritesWhatTheControlsSet)
{
    RunningTool tool;
    const HWND page = tool.Page(kGraphicsPageIndex);
    tool.Choose(page, IDC_SCREEN_SIZE, 11);
    tool.Choose(page, IDC_HDR_LEVEL, 2);
    tool.Choose(page, IDC_TRAIL_QUALITY, 0);
    tool.SetCheck(page, IDC_FULL_SCREEN, true);
    tool.SetCheck(page, IDC_SHOW_MOVIE, false);
    tool.Save();

    const std::vector<std::uint8_t> file = gui::ReadFile(tool.SettingsFile());
    const std::vector<std::uint8_t> section(file.begin() + gui::kGraphicsInFile,
                                            file.begin() + gui::kGraphicsInFile + 20);
    const std::vector<std::uint8_t> expected = {11, 0, 0, 0, 1, 0, 0, 0, 0, 0,
                                                0,  0, 2, 0, 0, 0, 0, 0, 0, 0};
    EXPECT_EQ(section, expected);
}
