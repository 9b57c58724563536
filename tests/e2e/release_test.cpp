// The release archive as a player gets it, unpacked into a new folder (named
// by VEK_RELEASE_DIR): the tool starts from there and saves, and both
// programs carry the build's version.
#include "config/save_config.h"
#include "tests/e2e/tool_driver.h"

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

// Runs a console program to its end; its standard output.
std::string OutputOf(const std::string& commandLine)
{
    SECURITY_ATTRIBUTES inherit = {sizeof inherit, nullptr, TRUE};
    HANDLE readEnd = nullptr;
    HANDLE writeEnd = nullptr;
    if (!CreatePipe(&readEnd, &writeEnd, &inherit, 0))
        return {};
    SetHandleInformation(readEnd, HANDLE_FLAG_INHERIT, 0);
    STARTUPINFOA startup = {};
    startup.cb = sizeof startup;
    startup.dwFlags = STARTF_USESTDHANDLES;
    startup.hStdOutput = writeEnd;
    startup.hStdError = GetStdHandle(STD_ERROR_HANDLE);
    std::string command = commandLine;
    PROCESS_INFORMATION process = {};
    const BOOL started = CreateProcessA(nullptr, command.data(), nullptr, nullptr, TRUE, 0, nullptr,
                                        nullptr, &startup, &process);
    CloseHandle(writeEnd);
    std::string output;
    if (started)
    {
        char chunk[256];
        DWORD got = 0;
        while (ReadFile(readEnd, chunk, sizeof chunk, &got, nullptr) && got > 0)
            output.append(chunk, got);
        WaitForSingleObject(process.hProcess, 10000);
        CloseHandle(process.hThread);
        CloseHandle(process.hProcess);
    }
    CloseHandle(readEnd);
    return output;
}

struct VersionResource
{
    bool found = false;
    DWORD fileVersion[2] = {};
    DWORD productVersion[2] = {};
    WORD translation[2] = {};
    std::string fileVersionText;
    std::string productVersionText;
    std::string productName;
    std::string fileDescription;
};

VersionResource ReadVersionResource(const std::string& path)
{
    VersionResource resource;
    DWORD ignored = 0;
    std::vector<char> block(GetFileVersionInfoSizeA(path.c_str(), &ignored));
    if (block.empty() ||
        !GetFileVersionInfoA(path.c_str(), 0, static_cast<DWORD>(block.size()), block.data()))
        return resource;
    void* value = nullptr;
    UINT size = 0;
    if (!VerQueryValueA(block.data(), "\\", &value, &size))
        return resource;
    const auto* fixed = static_cast<const VS_FIXEDFILEINFO*>(value);
    resource.found = true;
    resource.fileVersion[0] = fixed->dwFileVersionMS;
    resource.fileVersion[1] = fixed->dwFileVersionLS;
    resource.productVersion[0] = fixed->dwProductVersionMS;
    resource.productVersion[1] = fixed->dwProductVersionLS;
    if (VerQueryValueA(block.data(), "\\VarFileInfo\\Translation", &value, &size) && size >= 4)
    {
        resource.translation[0] = static_cast<const WORD*>(value)[0];
        resource.translation[1] = static_cast<const WORD*>(value)[1];
    }
    const auto text = [&](const char* name)
    {
        const std::string key = std::string("\\StringFileInfo\\041103a4\\") + name;
        return VerQueryValueA(block.data(), key.c_str(), &value, &size) && size > 0
                   ? std::string(static_cast<const char*>(value))
                   : std::string();
    };
    resource.fileVersionText = text("FileVersion");
    resource.productVersionText = text("ProductVersion");
    resource.productName = text("ProductName");
    resource.fileDescription = text("FileDescription");
    return resource;
}

} // namespace

TEST(Release, TheUnpackedToolStartsAndSaves)
{
    ASSERT_FALSE(ReleaseFolder().empty()) << "VEK_RELEASE_DIR names no folder";
    e2e::SaveFolder folder;
    e2e::ToolProcess tool(folder, ReleaseFolder() + "VEKConfig.exe");
    ASSERT_TRUE(tool.Started());
    HWND dialog = tool.WaitForMainDialog();
    ASSERT_NE(dialog, nullptr);
    DeleteFileA(folder.SettingsFile().c_str());

    tool.PostCommand(dialog, IDOK);
    EXPECT_EQ(tool.AnswerMessageBox(IDYES).text, "保存されました\nコンフィグツールを閉じますか？");
    DWORD code = 12345;
    ASSERT_TRUE(tool.WaitForExit(code));
    EXPECT_EQ(code, 0u);
    config::CSaveConfig defaults;
    defaults.ResetAll();
    EXPECT_EQ(e2e::ReadFileBytes(folder.SettingsFile()), defaults.SaveToBytes());
}

TEST(Release, BothProgramsCarryTheBuildsVersion)
{
    ASSERT_FALSE(ReleaseFolder().empty()) << "VEK_RELEASE_DIR names no folder";
    const std::string vekcfg = ReleaseFolder() + "vekcfg.exe";
    std::string version = OutputOf("\"" + vekcfg + "\" --version");
    version.erase(version.find_last_not_of("\r\n") + 1);
    EXPECT_EQ(version, "vekcfg " VEK_VERSION);

    const DWORD high = MAKELONG(VEK_VERSION_MINOR, VEK_VERSION_MAJOR);
    const DWORD low = MAKELONG(0, VEK_VERSION_PATCH);
    for (const char* program : {"VEKConfig.exe", "vekcfg.exe"})
    {
        SCOPED_TRACE(program);
        const VersionResource resource = ReadVersionResource(ReleaseFolder() + program);
        ASSERT_TRUE(resource.found);
        EXPECT_EQ(resource.fileVersion[0], high);
        EXPECT_EQ(resource.fileVersion[1], low);
        EXPECT_EQ(resource.productVersion[0], high);
        EXPECT_EQ(resource.productVersion[1], low);
        EXPECT_EQ(resource.fileVersionText, VEK_VERSION);
        EXPECT_EQ(resource.productVersionText, VEK_VERSION);
        EXPECT_EQ(resource.productName, "VEK Config");
        EXPECT_NE(resource.fileDescription, "");
        EXPECT_EQ(resource.translation[0], 0x0411) << "Japanese";
        EXPECT_EQ(resource.translation[1], 932);
    }
}
