// vekcfg.exe changes the tool's own file, found from TEMP as the tool finds
// it; the values read back through vekcfg show, through apply from standard
// input, and on the tool's pages.
#include "config/save_config.h"
#include "resources/resource.h"
#include "tests/e2e/tool_driver.h"
#include "tests/support/temp_folder.h"

#include <gtest/gtest.h>

namespace
{

// Runs vekcfg.exe, which lies beside this test, to its end with the test's
// environment; its standard output goes to `output`, and it reads `input`
// (a file) when one is given.
DWORD RunVekcfg(const std::string& arguments, const std::string& output,
                const std::string& input = std::string())
{
    char self[MAX_PATH] = {};
    GetModuleFileNameA(nullptr, self, sizeof self);
    const std::string folder(self, std::string(self).find_last_of('\\') + 1);
    std::string command = "\"" + folder + "vekcfg.exe\" " + arguments;
    SECURITY_ATTRIBUTES inheritable{sizeof inheritable, nullptr, TRUE};
    HANDLE out = CreateFileA(output.c_str(), GENERIC_WRITE, FILE_SHARE_READ, &inheritable,
                             CREATE_ALWAYS, FILE_ATTRIBUTE_NORMAL, nullptr);
    HANDLE in = input.empty()
                    ? INVALID_HANDLE_VALUE
                    : CreateFileA(input.c_str(), GENERIC_READ, FILE_SHARE_READ, &inheritable,
                                  OPEN_EXISTING, FILE_ATTRIBUTE_NORMAL, nullptr);
    STARTUPINFOA startup{};
    startup.cb = sizeof startup;
    startup.dwFlags = STARTF_USESTDHANDLES;
    startup.hStdInput = in;
    startup.hStdOutput = out;
    startup.hStdError = out;
    PROCESS_INFORMATION process{};
    DWORD exitCode = 12345;
    if (CreateProcessA(nullptr, command.data(), nullptr, nullptr, TRUE, 0, nullptr, nullptr,
                       &startup, &process))
    {
        WaitForSingleObject(process.hProcess, 60000);
        GetExitCodeProcess(process.hProcess, &exitCode);
        CloseHandle(process.hThread);
        CloseHandle(process.hProcess);
    }
    CloseHandle(out);
    if (in != INVALID_HANDLE_VALUE)
        CloseHandle(in);
    return exitCode;
}

} // namespace

TEST(Vekcfg, AValueSetOnTheCommandLineReadsBackThroughShowAndOnThePages)
{
    testing_support::TempSaveFolder folder;
    std::filesystem::create_directories(folder.SaveDirectory());
    config::CSaveConfig record;
    record.ResetAll();
    testing_support::WriteBytes(folder.SettingsFile(), record.SaveToBytes());

    // No FILE: on Windows it is the tool's own.
    const std::string output = folder.Root().File("vekcfg.txt");
    ASSERT_EQ(RunVekcfg("set graphics.screenSize=1280x960 keys.keyboardKeys[4]=Z "
                        "keys.keyboardKeys[14]=UP radioChat.entries[2].text=roger",
                        output),
              0u);
    ASSERT_EQ(RunVekcfg("show", output), 0u);
    const std::vector<std::uint8_t> shown = testing_support::ReadBytes(output);
    const std::string text(shown.begin(), shown.end());
    for (const char* line : {"graphics.screenSize = 3 (1280", "keys.keyboardKeys[4] = 44 (",
                             "radioChat.entries[2].text = \"roger\" (F3)"})
        EXPECT_NE(text.find(line), std::string::npos) << line;

    // The tree show prints, in the console's code page, brings the values
    // back through standard input into a file of defaults.
    const std::string tree = folder.Root().File("tree.json");
    ASSERT_EQ(RunVekcfg("show --json", tree), 0u);
    testing_support::WriteBytes(folder.SettingsFile(), record.SaveToBytes());
    ASSERT_EQ(RunVekcfg("apply -", output, tree), 0u);

    e2e::ToolProcess tool;
    const HWND dialog = tool.MainDialog();
    ASSERT_NE(dialog, nullptr);
    const std::pair<int, std::string> shownOnPages[] = {
        {IDC_SCREEN_SIZE, "1280×960"},
        {IDC_KEYBOARD_EDIT_FIRST + 4, "Z"},
        {IDC_KEYBOARD_EDIT_FIRST + 14, "UP"},
        {IDC_RADIO_CHAT_TEXT_FIRST + 2 * IDC_RADIO_CHAT_ROW_STEP, "roger"},
    };
    // The dialog shows before its pages are filled.
    for (const auto& [id, expected] : shownOnPages)
    {
        std::string seen;
        e2e::WaitFor(
            [&]
            {
                seen = e2e::WindowText(e2e::FindControl(dialog, id));
                return seen == expected;
            });
        EXPECT_EQ(seen, expected) << id;
    }
    e2e::PostCommand(dialog, IDCANCEL);
    EXPECT_EQ(tool.AnswerMessageBox(IDYES).caption, "終了確認");
    EXPECT_EQ(tool.ExitCode(), 0u);
}
