// The archive unpacked into a new folder (VEK_RELEASE_DIR): the tool starts
// from there and saves; both programs carry the build's version.
#include "tests/e2e/tool_driver.h"
#include "tests/support/temp_folder.h"

#include <cstdlib>
#include <gtest/gtest.h>
#include <string>
#include <vector>

namespace
{

std::string ReleaseFolder()
{
    const char* folder = std::getenv("VEK_RELEASE_DIR");
    return folder != nullptr ? std::string(folder) + "\\" : std::string();
}

// A string of the Japanese, code page 932 block of a version resource.
std::string VersionText(const std::vector<char>& block, const char* name)
{
    const std::string key = std::string("\\StringFileInfo\\041103a4\\") + name;
    void* value = nullptr;
    UINT size = 0;
    return VerQueryValueA(block.data(), key.c_str(), &value, &size) && size > 0
               ? static_cast<const char*>(value)
               : "";
}

} // namespace

// What it saves is the startup test's; here, that it runs from the folder.
TEST(Release, TheUnpackedToolStartsAndSaves)
{
    ASSERT_FALSE(ReleaseFolder().empty()) << "VEK_RELEASE_DIR names no folder";
    testing_support::TempSaveFolder folder;
    e2e::ToolProcess tool(ReleaseFolder() + "VEKConfig.exe");
    const HWND dialog = tool.MainDialog();
    ASSERT_NE(dialog, nullptr);
    e2e::PostCommand(dialog, IDOK);
    EXPECT_EQ(tool.AnswerMessageBox(IDYES).text, "保存されました\nコンフィグツールを閉じますか？");
    EXPECT_EQ(tool.ExitCode(), 0u);
}

TEST(Release, BothProgramsCarryTheBuildsVersion)
{
    ASSERT_FALSE(ReleaseFolder().empty()) << "VEK_RELEASE_DIR names no folder";
    for (const char* program : {"VEKConfig.exe", "vekcfg.exe"})
    {
        SCOPED_TRACE(program);
        const std::string path = ReleaseFolder() + program;
        DWORD ignored = 0;
        std::vector<char> block(GetFileVersionInfoSizeA(path.c_str(), &ignored));
        ASSERT_FALSE(block.empty());
        ASSERT_TRUE(GetFileVersionInfoA(path.c_str(), 0, DWORD(block.size()), block.data()));
        void* value = nullptr;
        UINT size = 0;
        ASSERT_TRUE(VerQueryValueA(block.data(), "\\", &value, &size));
        const auto* fixed = static_cast<const VS_FIXEDFILEINFO*>(value);
        for (const DWORD high : {fixed->dwFileVersionMS, fixed->dwProductVersionMS})
            EXPECT_EQ(high, DWORD(MAKELONG(VEK_VERSION_MINOR, VEK_VERSION_MAJOR)));
        for (const DWORD low : {fixed->dwFileVersionLS, fixed->dwProductVersionLS})
            EXPECT_EQ(low, DWORD(MAKELONG(0, VEK_VERSION_PATCH)));
        ASSERT_TRUE(VerQueryValueA(block.data(), "\\VarFileInfo\\Translation", &value, &size));
        EXPECT_EQ(*static_cast<const DWORD*>(value), DWORD(MAKELONG(0x0411, 932))) << "Japanese";
        for (const char* name : {"FileVersion", "ProductVersion"})
            EXPECT_EQ(VersionText(block, name), VEK_VERSION) << name;
        EXPECT_EQ(VersionText(block, "ProductName"), "VEK Config");
        EXPECT_NE(VersionText(block, "FileDescription"), "");
    }
}
