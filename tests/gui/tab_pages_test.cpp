// The main tab and the key tab: which page shows, and that switching pages
// neither saves nor changes anything.
#include "tests/gui/gui_harness.h"

#include <commctrl.h>
#include <gtest/gtest.h>

using gui::RunningTool;

TEST(TabPages, StartShowsTheFirstPageAndTheKeyboardSubPage)
{
    RunningTool tool;
    ASSERT_TRUE(tool.Started());
    EXPECT_EQ(TabCtrl_GetItemCount(tool.App().MainTab()), 7);
    EXPECT_EQ(TabCtrl_GetItemCount(tool.App().KeyTab()), 2);
    for (int index = 0; index < kPageCount; ++index)
        ASSERT_NE(tool.Page(index), nullptr) << index;
    EXPECT_EQ(tool.App().CurrentPage(), tool.Page(0));
    EXPECT_TRUE(IsWindowVisible(tool.Page(0)));
    EXPECT_FALSE(IsWindowVisible(tool.Page(1)));
    EXPECT_EQ(tool.App().CurrentKeyPage(), tool.KeyPage(0));
    EXPECT_EQ(GetParent(tool.KeyPage(0)), tool.Page(kKeyConfigPageIndex))
        << "sub-pages belong to the page, not to its tab control";
}

TEST(TabPages, SwitchingShowsExactlyOnePageAndChangesNoValue)
{
    RunningTool tool;
    const std::vector<std::uint8_t> before = tool.Record().SaveToBytes();
    for (int index : {6, 2, 5, 0, 3})
    {
        tool.ClickTab(index);
        EXPECT_EQ(tool.App().CurrentPage(), tool.Page(index));
        for (int other = 0; other < kPageCount; ++other)
            EXPECT_EQ(IsWindowVisible(tool.Page(other)) != FALSE, other == index) << other;
    }
    EXPECT_EQ(tool.Record().SaveToBytes(), before);
    EXPECT_EQ(gui::ReadFile(tool.SettingsFile()), before) << "switching never saves";
}

TEST(TabPages, TheKeyConfigPageKeepsItsLastSubPage)
{
    RunningTool tool;
    tool.ClickTab(kKeyConfigPageIndex);
    tool.ClickKeyTab(1);
    EXPECT_EQ(tool.App().CurrentKeyPage(), tool.KeyPage(1));
    tool.ClickTab(0);
    tool.ClickTab(kKeyConfigPageIndex);
    EXPECT_EQ(tool.App().CurrentKeyPage(), tool.KeyPage(1));
    EXPECT_TRUE(IsWindowVisible(tool.KeyPage(1)));
    EXPECT_FALSE(IsWindowVisible(tool.KeyPage(0)));
}

TEST(TabPages, AnIndexOutOfRangeHidesEveryPageAndKeepsTheCurrentOne)
{
    RunningTool tool;
    tool.App().SelectPage(7);
    EXPECT_EQ(tool.App().CurrentPage(), tool.Page(0));
    for (int index = 0; index < kPageCount; ++index)
        EXPECT_FALSE(IsWindowVisible(tool.Page(index)));
}

namespace
{
// Every visible control of `page` must lie inside the visible part of `clip`.
void ExpectControlsInside(HWND page, HWND clip, const char* name)
{
    RECT visible;
    GetClientRect(clip, &visible);
    MapWindowPoints(clip, nullptr, reinterpret_cast<POINT*>(&visible), 2);
    for (HWND control = GetWindow(page, GW_CHILD); control != nullptr;
         control = GetWindow(control, GW_HWNDNEXT))
    {
        if ((GetWindowLongPtrA(control, GWL_STYLE) & WS_VISIBLE) == 0)
            continue;
        RECT rect;
        GetWindowRect(control, &rect);
        EXPECT_TRUE(rect.left >= visible.left && rect.right <= visible.right &&
                    rect.top >= visible.top && rect.bottom <= visible.bottom)
            << name << ": control " << GetDlgCtrlID(control) << " lies outside the tab";
    }
}
} // namespace

TEST(TabPages, EveryControlOfEveryPageCanBeReached)
{
    RunningTool tool;
    const char* names[kPageCount] = {"graphics", "game",       "network",   "replay",
                                     "music",    "key config", "radio chat"};
    for (int index = 0; index < kPageCount; ++index)
        ExpectControlsInside(tool.Page(index), tool.App().MainTab(), names[index]);
    ExpectControlsInside(tool.KeyPage(0), tool.App().KeyTab(), "keyboard");
    ExpectControlsInside(tool.KeyPage(1), tool.App().KeyTab(), "controller");
}
