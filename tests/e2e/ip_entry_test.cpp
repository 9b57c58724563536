// The IP entry dialog as a user meets it: an add button pressed, a field out
// of range refused with its box and the dialog kept, the address then added;
// a line selected and deleted; the lists saved.
#include "config/save_config.h"
#include "resources/resource.h"
#include "tests/e2e/tool_driver.h"
#include "tests/support/temp_folder.h"

#include <gtest/gtest.h>

TEST(IpEntry, ARefusedFieldKeepsTheDialogOkAddsTheAddressAndDeleteRemovesIt)
{
    testing_support::TempSaveFolder folder;
    e2e::ToolProcess tool;
    const HWND dialog = tool.MainDialog();
    ASSERT_TRUE(e2e::WaitFor([&] { return e2e::FindControl(dialog, IDC_DENY_DELETE) != nullptr; }));
    HWND entry = nullptr;
    const auto type = [&](const char* first)
    {
        for (const int id : {IDC_IP_OCTET2, IDC_IP_OCTET3, IDC_IP_OCTET4})
            SendDlgItemMessageA(entry, id, WM_SETTEXT, 0, reinterpret_cast<LPARAM>("7"));
        SendDlgItemMessageA(entry, IDC_IP_OCTET1, WM_SETTEXT, 0, reinterpret_cast<LPARAM>(first));
        e2e::PostCommand(entry, IDOK);
    };
    for (const int add : {IDC_ALLOW_ADD, IDC_DENY_ADD})
    {
        PostMessageA(e2e::FindControl(dialog, add), BM_CLICK, 0, 0);
        ASSERT_NE(entry = tool.DialogWith(IDC_IP_OCTET1), nullptr);
        type("256");
        const e2e::MessageBoxSeen refusal = tool.AnswerMessageBox(IDOK);
        EXPECT_EQ(refusal.caption + ": " + refusal.text,
                  "Error: IPアドレスには0～255までの数字を入力してください。");
        type("*");
        EXPECT_TRUE(e2e::WaitFor([&] { return !IsWindow(entry); }));
    }
    SendMessageA(e2e::FindControl(dialog, IDC_DENY_LIST), LB_SETCURSEL, 0, 0);
    PostMessageA(e2e::FindControl(dialog, IDC_DENY_DELETE), BM_CLICK, 0, 0);

    e2e::PostCommand(dialog, IDOK);
    EXPECT_EQ(tool.AnswerMessageBox(IDYES).caption, "終了確認");
    EXPECT_EQ(tool.ExitCode(), 0u);
    config::CSaveConfig saved;
    ASSERT_TRUE(saved.LoadFromPath(folder.SettingsFile().c_str()));
    ASSERT_EQ(saved.Network()->allowCount, 1u);
    EXPECT_EQ(std::string(saved.GetAllowEntry(0)->octets[0]) + saved.GetAllowEntry(0)->octets[3],
              "*007");
    EXPECT_EQ(saved.Network()->denyCount, 0u);
}
