// vekcfg.exe without FILE changes the tool's own file (found from TEMP as the
// tool finds it), and the tool, whose pages are filled after it shows, shows
// the value.
#include "config/save_config.h"
#include "resources/resource.h"
#include "tests/e2e/tool_driver.h"
#include "tests/support/temp_folder.h"

#include <gtest/gtest.h>

TEST(Vekcfg, AValueSetOnTheCommandLineShowsOnTheToolsPage)
{
    testing_support::TempSaveFolder folder;
    config::CSaveConfig record;
    record.ResetAll();
    folder.WriteSettings(record.SaveToBytes());
    ASSERT_EQ(e2e::ToolProcess("vekcfg.exe", "set graphics.screenSize=1280x960").ExitCode(), 0u);

    e2e::ToolProcess tool;
    const HWND dialog = tool.MainDialog();
    ASSERT_NE(dialog, nullptr);
    EXPECT_EQ(e2e::WindowText(e2e::FindControl(dialog, IDC_SCREEN_SIZE)), "1280×960");
}
