// The 接続 list's lines and slots, with addresses typed into the IP entry
// dialog and OK pressed from a CBT hook while the add button waits.
#include "config/ip_address.h"
#include "resources/resource.h"
#include "tests/gui/gui_harness.h"

#include <array>
#include <deque>

using gui::RunningTool;
using Lines = std::vector<std::string>;

namespace
{

constexpr int kNetworkPage = 2;

// The addresses to type, one into each IP entry dialog shown; with none left
// the dialog is cancelled. Installed after AnswerMessageBox, this hook runs
// first and keeps the dialog (its labels have a box text's id) from it.
std::deque<std::array<const char*, 4>> addresses;

LRESULT CALLBACK TypeAddress(int code, WPARAM wParam, LPARAM lParam)
{
    const HWND dialog = reinterpret_cast<HWND>(wParam);
    if (code != HCBT_ACTIVATE || GetDlgItem(dialog, IDC_IP_OCTET1) == nullptr)
        return CallNextHookEx(nullptr, code, wParam, lParam);
    const int fields[] = {IDC_IP_OCTET1, IDC_IP_OCTET2, IDC_IP_OCTET3, IDC_IP_OCTET4};
    for (int i = 0; i < 4 && !addresses.empty(); ++i)
        SetDlgItemTextA(dialog, fields[i], addresses.front()[i]);
    PostMessageA(dialog, WM_COMMAND, addresses.empty() ? IDCANCEL : IDOK, 0);
    if (!addresses.empty())
        addresses.pop_front();
    return 0;
}

// Presses an add button; the dialog then takes the addresses in turn.
void Add(HWND page, int button, std::deque<std::array<const char*, 4>> typed)
{
    addresses = std::move(typed);
    const gui::CbtHook hook(TypeAddress);
    gui::Notify(page, button);
}

Lines LinesOf(HWND page, int list)
{
    Lines lines(SendDlgItemMessageA(page, list, LB_GETCOUNT, 0, 0));
    for (std::size_t index = 0; index < lines.size(); ++index)
    {
        char line[64] = {};
        SendDlgItemMessageA(page, list, LB_GETTEXT, index, reinterpret_cast<LPARAM>(line));
        lines[index] = line;
    }
    return lines;
}

} // namespace

TEST(NetworkPage, ConnectLinesStayWithTheirSlotsInAFileWithFreeSlotsBetween)
{
    RunningTool tool(
        [](config::CSaveConfig& record)
        {
            record.Network()->connectList[1] = {{"001", "001", "001", "001"}};
            record.Network()->connectList[3] = {{"003", "003", "003", "003"}};
        });
    const HWND page = tool.PageWindow(kNetworkPage);
    EXPECT_EQ(LinesOf(page, IDC_CONNECT_LIST), (Lines{"1.1.1.1", "3.3.3.3"}));

    Add(page, IDC_CONNECT_ADD, {{"9", "9", "9", "9"}});
    EXPECT_EQ(LinesOf(page, IDC_CONNECT_LIST), (Lines{"9.9.9.9", "1.1.1.1", "3.3.3.3"}));
    SendDlgItemMessageA(page, IDC_CONNECT_LIST, LB_SETCURSEL, 2, 0);
    gui::Notify(page, IDC_CONNECT_DELETE);
    EXPECT_EQ(LinesOf(page, IDC_CONNECT_LIST), (Lines{"9.9.9.9", "1.1.1.1"}));
    const config::IpEntry* slots = tool.Record()->Network()->connectList;
    EXPECT_EQ(config::ListedLine(slots[0]), "009.009.009.009");
    EXPECT_EQ(config::ListedLine(slots[1]), "001.001.001.001");
    EXPECT_TRUE(config::IsConnectSlotEmpty(slots[2]) && config::IsConnectSlotEmpty(slots[3]));

    // An all-zero address is listed, but its slot stays free for the next.
    Add(page, IDC_CONNECT_ADD, {{"0", "0", "0", "0"}});
    EXPECT_EQ(LinesOf(page, IDC_CONNECT_LIST), (Lines{"9.9.9.9", "1.1.1.1", "0.0.0.0"}));
    Add(page, IDC_CONNECT_ADD, {{"5", "5", "5", "5"}});
    EXPECT_EQ(LinesOf(page, IDC_CONNECT_LIST), (Lines{"9.9.9.9", "1.1.1.1", "5.5.5.5"}));
}
