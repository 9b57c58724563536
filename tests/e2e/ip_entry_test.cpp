// The IP entry dialog as a user meets it: an add button pressed, a field out
// of range refused with its box and the dialog kept, the address then added;
// a line selected and deleted; the lists saved.
#include "config/ip_address.h"
#include "config/save_config.h"
#include "resources/resource.h"
#include "tests/e2e/tool_driver.h"
#include "tests/support/temp_folder.h"

#include <array>
#include <gtest/gtest.h>

namespace
{

// Types an address into the IP entry dialog and presses OK; with an add
// button, presses it first. Returns the entry dialog.
HWND Enter(e2e::ToolProcess& tool, HWND dialog, int add, std::array<const char*, 4> octets)
{
    if (add != 0)
        PostMessageA(e2e::FindControl(dialog, add), BM_CLICK, 0, 0);
    const HWND entry = tool.DialogWith(IDC_IP_OCTET1);
    for (const int id : {IDC_IP_OCTET1, IDC_IP_OCTET2, IDC_IP_OCTET3, IDC_IP_OCTET4})
        SendDlgItemMessageA(entry, id, WM_SETTEXT, 0,
                            reinterpret_cast<LPARAM>(octets[id - IDC_IP_OCTET1]));
    e2e::PostCommand(entry, IDOK);
    return entry;
}

} // namespace

// A file written with free 接続 slots between filled ones: each line still
// deletes its own slot; an all-zero address is listed but leaves its slot
// free for the next.
TEST(IpEntry, ARefusedFieldKeepsTheDialogAndLinesAreAddedAndDeletedWithTheirSlots)
{
    testing_support::TempSaveFolder folder;
    config::CSaveConfig record;
    record.ResetAll();
    record.Network()->connectList[1] = {{"001", "001", "001", "001"}};
    record.Network()->connectList[3] = {{"003", "003", "003", "003"}};
    folder.WriteSettings(record.SaveToBytes());
    e2e::ToolProcess tool;
    const HWND dialog = tool.MainDialog();
    ASSERT_NE(dialog, nullptr);
    for (const int add : {IDC_ALLOW_ADD, IDC_DENY_ADD})
    {
        const HWND entry = Enter(tool, dialog, add, {"256", "7", "7", "7"});
        const e2e::MessageBoxSeen refusal = tool.AnswerMessageBox(IDOK);
        EXPECT_EQ(refusal.caption + ": " + refusal.text,
                  "Error: IPアドレスには0～255までの数字を入力してください。");
        EXPECT_EQ(Enter(tool, dialog, 0, {"*", "7", "7", "7"}), entry);
        EXPECT_TRUE(e2e::WaitFor([&] { return !IsWindow(entry); }));
    }
    SendMessageA(e2e::FindControl(dialog, IDC_DENY_LIST), LB_SETCURSEL, 0, 0);
    PostMessageA(e2e::FindControl(dialog, IDC_DENY_DELETE), BM_CLICK, 0, 0);

    const HWND list = e2e::FindControl(dialog, IDC_CONNECT_LIST);
    const auto lines = [&] { return SendMessageA(list, LB_GETCOUNT, 0, 0); };
    ASSERT_EQ(lines(), 2);
    const HWND entry = Enter(tool, dialog, IDC_CONNECT_ADD, {"9", "9", "9", "9"});
    ASSERT_TRUE(e2e::WaitFor([&] { return !IsWindow(entry) && lines() == 3; }));
    SendMessageA(list, LB_SETCURSEL, 2, 0); // 3.3.3.3
    PostMessageA(e2e::FindControl(dialog, IDC_CONNECT_DELETE), BM_CLICK, 0, 0);
    ASSERT_TRUE(e2e::WaitFor([&] { return lines() == 2; }));
    Enter(tool, dialog, IDC_CONNECT_ADD, {"0", "0", "0", "0"});
    ASSERT_TRUE(e2e::WaitFor([&] { return lines() == 3; }));
    const HWND last = Enter(tool, dialog, IDC_CONNECT_ADD, {"5", "5", "5", "5"});
    ASSERT_TRUE(e2e::WaitFor([&] { return !IsWindow(last); }));

    e2e::PostCommand(dialog, IDOK);
    EXPECT_EQ(tool.AnswerMessageBox(IDYES).caption, "終了確認");
    EXPECT_EQ(tool.ExitCode(), 0u);
    config::CSaveConfig saved;
    ASSERT_TRUE(saved.LoadFromPath(folder.SettingsFile().c_str()));
    ASSERT_EQ(saved.Network()->allowCount, 1u);
    EXPECT_EQ(config::ListedLine(*saved.GetAllowEntry(0)), "*.007.007.007");
    EXPECT_EQ(saved.Network()->denyCount, 0u);
    const config::IpEntry* slots = saved.Network()->connectList;
    EXPECT_EQ(config::ConnectLine(slots[0]) + " " + config::ConnectLine(slots[1]) + " " +
                  config::ConnectLine(slots[2]) + " " + config::ConnectLine(slots[3]),
              "9.9.9.9 1.1.1.1 5.5.5.5 0.0.0.0");
}
