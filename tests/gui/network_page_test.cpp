// The ネットワーク page and its IP entry dialog, driven as a user drives them:
// the dialog's fields are typed into and its buttons pressed from a CBT hook
// while the add button's modal loop runs.
#include "base/memory.h"
#include "config/fixed_text.h"
#include "config/ip_address.h"
#include "resources/resource.h"
#include "tests/gui/gui_harness.h"
#include "tests/gui/page_checks.h"

#include <array>
#include <cstring>
#include <deque>
#include <gtest/gtest.h>

using config::IpEntry;
using gui::MessageBoxAnswerer;
using gui::RunningTool;

namespace
{

constexpr int kNetworkPage = 2;
constexpr int kCloseCommand = 0;
constexpr char kOctetMessage[] = "IPアドレスには0～255までの数字を入力してください。";
constexpr char kSelectMessage[] = "削除するIPアドレスをリストから選択してください。";

// What the user does each time the IP entry dialog becomes active: types
// the four fields and presses OK, キャンセル or the close command.
struct IpDialogStep
{
    std::array<const char*, 4> fields;
    int button;
};

// What the dialog looked like when it became active, before any typing.
struct IpDialogShowing
{
    std::string caption;
    HWND owner;
    bool fieldsEmpty;
    bool fieldsLimitedToThree;
};

// Plays the steps at the IP entry dialog; a showing without a step left is
// cancelled and counted, so that a wrong test fails instead of hanging.
// Create it after any MessageBoxAnswerer: the later hook runs first, and the
// dialog (whose labels carry the id a message box's text has) must not
// reach the answerer.
class IpDialogUser
{
public:
    explicit IpDialogUser(std::vector<IpDialogStep> steps) : steps_(steps.begin(), steps.end())
    {
        active = this;
        hook_ = SetWindowsHookExA(WH_CBT, Hook, nullptr, GetCurrentThreadId());
    }
    ~IpDialogUser()
    {
        UnhookWindowsHookEx(hook_);
        active = nullptr;
    }
    IpDialogUser(const IpDialogUser&) = delete;
    IpDialogUser& operator=(const IpDialogUser&) = delete;

    const std::vector<IpDialogShowing>& Showings() const { return showings_; }
    std::size_t StepsLeft() const { return steps_.size(); }
    int Unplanned() const { return unplanned_; }

private:
    static LRESULT CALLBACK Hook(int code, WPARAM wParam, LPARAM lParam)
    {
        const HWND window = reinterpret_cast<HWND>(wParam);
        if (code != HCBT_ACTIVATE || active == nullptr ||
            GetDlgItem(window, IDC_IP_OCTET1) == nullptr)
            return CallNextHookEx(nullptr, code, wParam, lParam);
        active->Play(window);
        return 0;
    }

    void Play(HWND dialog)
    {
        const int fields[] = {IDC_IP_OCTET1, IDC_IP_OCTET2, IDC_IP_OCTET3, IDC_IP_OCTET4};
        IpDialogShowing showing{gui::WindowText(dialog), GetWindow(dialog, GW_OWNER), true, true};
        for (int field : fields)
        {
            showing.fieldsEmpty &= gui::WindowText(GetDlgItem(dialog, field)).empty();
            showing.fieldsLimitedToThree &=
                SendDlgItemMessageA(dialog, field, EM_GETLIMITTEXT, 0, 0) == 3;
        }
        showings_.push_back(showing);
        if (steps_.empty())
        {
            ++unplanned_;
            PostMessageA(dialog, WM_COMMAND, MAKEWPARAM(IDCANCEL, BN_CLICKED), 0);
            return;
        }
        const IpDialogStep step = steps_.front();
        steps_.pop_front();
        for (int i = 0; i < 4; ++i)
            SetDlgItemTextA(dialog, fields[i], step.fields[i]);
        if (step.button == kCloseCommand)
            PostMessageA(dialog, WM_CLOSE, 0, 0);
        else
            PostMessageA(dialog, WM_COMMAND, MAKEWPARAM(step.button, BN_CLICKED),
                         reinterpret_cast<LPARAM>(GetDlgItem(dialog, step.button)));
    }

    static inline IpDialogUser* active = nullptr;
    HHOOK hook_;
    std::deque<IpDialogStep> steps_;
    std::vector<IpDialogShowing> showings_;
    int unplanned_ = 0;
};

enum class Kind
{
    Connect,
    Allow,
    Deny
};

struct AddressListUnderTest
{
    const char* name;
    Kind kind;
    int list;
    int add;
    int remove;
};

const AddressListUnderTest kLists[] = {
    {"接続", Kind::Connect, IDC_CONNECT_LIST, IDC_CONNECT_ADD, IDC_CONNECT_DELETE},
    {"許可", Kind::Allow, IDC_ALLOW_LIST, IDC_ALLOW_ADD, IDC_ALLOW_DELETE},
    {"拒否", Kind::Deny, IDC_DENY_LIST, IDC_DENY_ADD, IDC_DENY_DELETE},
};

IpEntry Entry(const char* a, const char* b, const char* c, const char* d)
{
    IpEntry entry{};
    const char* texts[] = {a, b, c, d};
    for (int i = 0; i < 4; ++i)
        std::memcpy(entry.octets[i], texts[i], std::strlen(texts[i]));
    return entry;
}

std::string Bytes(const IpEntry& entry)
{
    return std::string(reinterpret_cast<const char*>(&entry), sizeof entry);
}

std::vector<std::string> Lines(HWND page, int list)
{
    std::vector<std::string> lines;
    const int count = static_cast<int>(SendDlgItemMessageA(page, list, LB_GETCOUNT, 0, 0));
    for (int index = 0; index < count; ++index)
    {
        char line[64] = {};
        SendDlgItemMessageA(page, list, LB_GETTEXT, index, reinterpret_cast<LPARAM>(line));
        lines.push_back(line);
    }
    return lines;
}

// The record's entries of one list, as bytes: the filled 接続 slots in slot
// order, or the 許可 or 拒否 entries.
std::vector<std::string> Entries(config::CSaveConfig& record, Kind kind)
{
    std::vector<std::string> entries;
    if (kind == Kind::Connect)
    {
        for (const IpEntry& slot : record.Network()->connectList)
        {
            if (!config::IsConnectSlotEmpty(slot))
                entries.push_back(Bytes(slot));
        }
        return entries;
    }
    const std::uint32_t count =
        kind == Kind::Allow ? record.Network()->allowCount : record.Network()->denyCount;
    for (std::uint32_t index = 0; index < count; ++index)
        entries.push_back(Bytes(kind == Kind::Allow ? *record.GetAllowEntry(index)
                                                    : *record.GetDenyEntry(index)));
    return entries;
}

// One press of an add button with the user entering `fields` and pressing OK.
void Add(RunningTool& tool, const AddressListUnderTest& list, std::array<const char*, 4> fields)
{
    IpDialogUser user({{fields, IDOK}});
    tool.Click(tool.Page(kNetworkPage), list.add);
    ASSERT_EQ(user.StepsLeft(), 0u);
    ASSERT_EQ(user.Unplanned(), 0);
}

void Select(HWND page, int list, int line)
{
    SendDlgItemMessageA(page, list, LB_SETCURSEL, line, 0);
}

} // namespace

TEST(NetworkPage, StartFillsEveryControlFromTheFileAndChangesNothing)
{
    config::CSaveConfig record;
    record.ResetAll();
    config::ConfigNetwork& network = *record.Network();
    network.port = 4321;
    std::strcpy(network.lobbyId, "ロビー表");
    std::strcpy(network.directId, "direct");
    network.useUpnp = 1;
    network.playBgm = 0;
    network.keyResponse = 3;
    network.connectList[0] = Entry("192", "168", "000", "001");
    network.connectList[1] = Entry("*", "*", "*", "*"); // reads as empty
    network.connectList[2] = Entry("010", "*", "000", "255");
    record.AddAllowEntry(Entry("010", "*", "*", "001"));
    record.AddDenyEntry(Entry("000", "000", "000", "000"));
    record.AddDenyEntry(Entry("255", "255", "255", "255"));
    const std::vector<std::uint8_t> file = record.SaveToBytes();

    RunningTool tool(file);
    ASSERT_TRUE(tool.Started());
    const HWND page = tool.Page(kNetworkPage);
    EXPECT_EQ(gui::WindowText(tool.Control(page, IDC_NETWORK_PORT)), "4321");
    EXPECT_EQ(gui::WindowText(tool.Control(page, IDC_NETWORK_LOBBY_ID)), "ロビー表");
    EXPECT_EQ(gui::WindowText(tool.Control(page, IDC_NETWORK_DIRECT_ID)), "direct");
    EXPECT_EQ(IsDlgButtonChecked(page, IDC_NETWORK_USE_UPNP), BST_CHECKED);
    EXPECT_EQ(IsDlgButtonChecked(page, IDC_NETWORK_PLAY_BGM), BST_UNCHECKED);
    ASSERT_EQ(gui::ItemCount(page, IDC_NETWORK_KEY_RESPONSE), 5);
    for (int index = 0; index < 5; ++index)
        EXPECT_EQ(gui::ItemText(page, IDC_NETWORK_KEY_RESPONSE, index), std::to_string(index + 1));
    EXPECT_EQ(gui::Selection(page, IDC_NETWORK_KEY_RESPONSE), 3);
    EXPECT_EQ(Lines(page, IDC_CONNECT_LIST),
              (std::vector<std::string>{"192.168.0.1", "10.0.0.255"}));
    EXPECT_EQ(Lines(page, IDC_ALLOW_LIST), (std::vector<std::string>{"010.*.*.001"}));
    EXPECT_EQ(Lines(page, IDC_DENY_LIST),
              (std::vector<std::string>{"000.000.000.000", "255.255.255.255"}));
    EXPECT_EQ(tool.Record().SaveToBytes(), file);
}

TEST(NetworkPage, EachControlWritesItsFieldAtOnce)
{
    RunningTool tool;
    const HWND page = tool.Page(kNetworkPage);
    config::ConfigNetwork& network = *tool.Record().Network();

    for (bool on : {true, false})
    {
        tool.SetCheck(page, IDC_NETWORK_USE_UPNP, on);
        EXPECT_EQ(network.useUpnp, on ? 1u : 0u);
        tool.SetCheck(page, IDC_NETWORK_PLAY_BGM, on);
        EXPECT_EQ(network.playBgm, on ? 1u : 0u);
    }
    for (int choice : {4, 0})
    {
        tool.Choose(page, IDC_NETWORK_KEY_RESPONSE, choice);
        EXPECT_EQ(network.keyResponse, choice);
    }
    const std::pair<const char*, int> ports[] = {
        {"70000", 4464}, {"-1", 65535}, {"", 0}, {"18001", 18001}};
    for (const auto& [text, port] : ports)
    {
        tool.Type(page, IDC_NETWORK_PORT, text);
        EXPECT_EQ(network.port, port) << text;
    }
    tool.Type(page, IDC_NETWORK_LOBBY_ID, std::string(40, 'L'));
    EXPECT_EQ(config::FieldText(network.lobbyId), std::string(31, 'L'));
    tool.Type(page, IDC_NETWORK_DIRECT_ID, "直接ID");
    EXPECT_EQ(config::FieldText(network.directId), "直接ID");
}

TEST(NetworkPage, EachAddButtonRunsTheIpDialogAndListsWhatOkAccepts)
{
    for (const AddressListUnderTest& list : kLists)
    {
        SCOPED_TRACE(list.name);
        RunningTool tool;
        const HWND page = tool.Page(kNetworkPage);
        IpDialogUser user({{{"192", "168", "0", "1"}, IDOK}, {{"*", "10", "*", "255"}, IDOK}});
        tool.Click(page, list.add);
        tool.Click(page, list.add);

        ASSERT_EQ(user.Showings().size(), 2u);
        for (const IpDialogShowing& showing : user.Showings())
        {
            EXPECT_EQ(showing.caption, "IPアドレス入力");
            EXPECT_EQ(showing.owner, tool.MainDialog());
            EXPECT_TRUE(showing.fieldsEmpty);
            EXPECT_TRUE(showing.fieldsLimitedToThree);
        }
        EXPECT_EQ(Entries(tool.Record(), list.kind),
                  (std::vector<std::string>{Bytes(Entry("192", "168", "000", "001")),
                                            Bytes(Entry("*", "010", "*", "255"))}));
        const std::vector<std::string> lines =
            list.kind == Kind::Connect ? std::vector<std::string>{"192.168.0.1", "0.10.0.255"}
                                       : std::vector<std::string>{"192.168.000.001", "*.010.*.255"};
        EXPECT_EQ(Lines(page, list.list), lines);
    }
}

TEST(NetworkPage, CancellingOrClosingTheIpDialogAddsNothing)
{
    RunningTool tool;
    const HWND page = tool.Page(kNetworkPage);
    const std::vector<std::uint8_t> before = tool.Record().SaveToBytes();
    for (const AddressListUnderTest& list : kLists)
    {
        IpDialogUser user(
            {{{"1", "2", "3", "4"}, IDCANCEL}, {{"1", "2", "3", "4"}, kCloseCommand}});
        tool.Click(page, list.add);
        tool.Click(page, list.add);
        EXPECT_EQ(user.Showings().size(), 2u) << list.name;
        EXPECT_TRUE(Lines(page, list.list).empty()) << list.name;
    }
    EXPECT_EQ(tool.Record().SaveToBytes(), before);
}

TEST(NetworkPage, DeleteRemovesTheSelectedLineAndItsEntryUntilTheListIsEmpty)
{
    for (const AddressListUnderTest& list : kLists)
    {
        SCOPED_TRACE(list.name);
        RunningTool tool;
        const HWND page = tool.Page(kNetworkPage);
        for (const char* first : {"1", "2", "3"})
            Add(tool, list, {first, "0", "0", "9"});

        Select(page, list.list, 1);
        tool.Click(page, list.remove);
        EXPECT_EQ(Entries(tool.Record(), list.kind),
                  (std::vector<std::string>{Bytes(Entry("001", "000", "000", "009")),
                                            Bytes(Entry("003", "000", "000", "009"))}));
        EXPECT_EQ(Lines(page, list.list).size(), 2u);
        EXPECT_EQ(Lines(page, list.list).back(),
                  list.kind == Kind::Connect ? "3.0.0.9" : "003.000.000.009");

        for (int remaining = 2; remaining > 0; --remaining)
        {
            Select(page, list.list, 0);
            tool.Click(page, list.remove);
        }
        EXPECT_TRUE(Lines(page, list.list).empty());
        EXPECT_TRUE(Entries(tool.Record(), list.kind).empty());
        EXPECT_EQ(tool.Record().Network()->allowCount + tool.Record().Network()->denyCount, 0u);
    }
}

TEST(NetworkPage, DeleteWithoutASelectionShowsItsMessageAndChangesNothing)
{
    RunningTool tool;
    const HWND page = tool.Page(kNetworkPage);
    for (const AddressListUnderTest& list : kLists)
        Add(tool, list, {"7", "7", "7", "7"});
    const std::vector<std::uint8_t> before = tool.Record().SaveToBytes();
    for (const AddressListUnderTest& list : kLists)
    {
        MessageBoxAnswerer answerer;
        Select(page, list.list, -1);
        tool.Click(page, list.remove);
        ASSERT_EQ(answerer.Seen().size(), 1u) << list.name;
        EXPECT_EQ(answerer.Seen()[0].caption, "Error");
        EXPECT_EQ(answerer.Seen()[0].text, kSelectMessage);
        EXPECT_EQ(Lines(page, list.list).size(), 1u) << list.name;
    }
    EXPECT_EQ(tool.Record().SaveToBytes(), before);
}

TEST(NetworkPage, TheTwentyFifthConnectAddressIsRefusedUntilALineIsDeleted)
{
    RunningTool tool;
    const HWND page = tool.Page(kNetworkPage);
    const AddressListUnderTest& connect = kLists[0];
    for (int address = 1; address <= config::kConnectSlotCount; ++address)
        Add(tool, connect, {"10", "0", "0", std::to_string(address).c_str()});
    const std::vector<std::uint8_t> full = tool.Record().SaveToBytes();
    {
        MessageBoxAnswerer answerer;
        Add(tool, connect, {"10", "0", "0", "25"});
        ASSERT_EQ(answerer.Seen().size(), 1u);
        EXPECT_EQ(answerer.Seen()[0].caption, "Error");
        EXPECT_EQ(answerer.Seen()[0].text, "接続IPアドレスの登録は２４件までです。");
    }
    EXPECT_EQ(tool.Record().SaveToBytes(), full);
    EXPECT_EQ(Lines(page, IDC_CONNECT_LIST).size(), 24u);

    Select(page, IDC_CONNECT_LIST, 0);
    tool.Click(page, IDC_CONNECT_DELETE);
    Add(tool, connect, {"10", "0", "0", "25"});
    const std::vector<std::string> lines = Lines(page, IDC_CONNECT_LIST);
    ASSERT_EQ(lines.size(), 24u);
    EXPECT_EQ(lines.front(), "10.0.0.2");
    EXPECT_EQ(lines.back(), "10.0.0.25");
    EXPECT_EQ(Bytes(tool.Record().Network()->connectList[23]),
              Bytes(Entry("010", "000", "000", "025")));
}

TEST(NetworkPage, ARefusedFieldKeepsTheDialogOpenWithItsMessage)
{
    RunningTool tool;
    const HWND page = tool.Page(kNetworkPage);
    MessageBoxAnswerer answerer;
    IpDialogUser user({{{"256", "1", "1", "1"}, IDOK},
                       {{"1", "", "1", "1"}, IDOK},
                       {{"1", "1", "1", "-1"}, IDOK},
                       {{"10", "0", "0", "1"}, IDOK}});
    tool.Click(page, IDC_ALLOW_ADD);

    EXPECT_EQ(user.Showings().size(), 4u) << "the dialog came back after each message";
    EXPECT_EQ(user.StepsLeft(), 0u);
    ASSERT_EQ(answerer.Seen().size(), 3u);
    for (const gui::MessageBoxSeen& seen : answerer.Seen())
    {
        EXPECT_EQ(seen.caption, "Error");
        EXPECT_EQ(seen.text, kOctetMessage);
    }
    EXPECT_EQ(Entries(tool.Record(), Kind::Allow),
              (std::vector<std::string>{Bytes(Entry("010", "000", "000", "001"))}));
    EXPECT_EQ(Lines(page, IDC_ALLOW_LIST), (std::vector<std::string>{"010.000.000.001"}));
}

TEST(NetworkPage, AnAllZeroConnectAddressIsListedButItsSlotGoesToTheNextAddress)
{
    std::vector<std::uint8_t> saved;
    {
        RunningTool tool;
        const HWND page = tool.Page(kNetworkPage);
        const AddressListUnderTest& connect = kLists[0];
        const config::ConfigNetwork& network = *tool.Record().Network();
        Add(tool, connect, {"1", "2", "3", "4"});
        Add(tool, connect, {"0", "0", "0", "0"});
        EXPECT_EQ(Lines(page, IDC_CONNECT_LIST), (std::vector<std::string>{"1.2.3.4", "0.0.0.0"}));
        EXPECT_TRUE(config::IsConnectSlotEmpty(network.connectList[1]));

        Add(tool, connect, {"5", "6", "7", "8"});
        EXPECT_EQ(Bytes(network.connectList[1]), Bytes(Entry("005", "006", "007", "008")));
        EXPECT_EQ(Lines(page, IDC_CONNECT_LIST), (std::vector<std::string>{"1.2.3.4", "5.6.7.8"}))
            << "each line stands for its slot, so deleting a line removes what it shows";

        Add(tool, connect, {"*", "*", "*", "*"});
        EXPECT_EQ(Lines(page, IDC_CONNECT_LIST),
                  (std::vector<std::string>{"1.2.3.4", "5.6.7.8", "0.0.0.0"}));
        Select(page, IDC_CONNECT_LIST, 1);
        tool.Click(page, IDC_CONNECT_DELETE);
        EXPECT_EQ(Entries(tool.Record(), Kind::Connect),
                  (std::vector<std::string>{Bytes(Entry("001", "002", "003", "004"))}));
        tool.Save(IDNO);
        saved = gui::ReadFile(tool.SettingsFile());
    }
    RunningTool restarted(saved);
    EXPECT_EQ(Lines(restarted.Page(kNetworkPage), IDC_CONNECT_LIST),
              (std::vector<std::string>{"1.2.3.4"}));
}

TEST(NetworkPage, ConnectLinesStayWithTheirSlotsInAFileWithFreeSlotsBetween)
{
    config::CSaveConfig record;
    record.ResetAll();
    record.Network()->connectList[1] = Entry("001", "001", "001", "001");
    record.Network()->connectList[3] = Entry("003", "003", "003", "003");
    RunningTool tool(record.SaveToBytes());
    const HWND page = tool.Page(kNetworkPage);
    EXPECT_EQ(Lines(page, IDC_CONNECT_LIST), (std::vector<std::string>{"1.1.1.1", "3.3.3.3"}));

    Add(tool, kLists[0], {"9", "9", "9", "9"});
    EXPECT_EQ(Lines(page, IDC_CONNECT_LIST),
              (std::vector<std::string>{"9.9.9.9", "1.1.1.1", "3.3.3.3"}));
    Select(page, IDC_CONNECT_LIST, 2);
    tool.Click(page, IDC_CONNECT_DELETE);
    EXPECT_EQ(Lines(page, IDC_CONNECT_LIST), (std::vector<std::string>{"9.9.9.9", "1.1.1.1"}));
    EXPECT_EQ(Entries(tool.Record(), Kind::Connect),
              (std::vector<std::string>{Bytes(Entry("009", "009", "009", "009")),
                                        Bytes(Entry("001", "001", "001", "001"))}));
}

TEST(NetworkPage, SavedListsAreByteForByteWhatWasEntered)
{
    RunningTool tool;
    Add(tool, kLists[0], {"192", "168", "0", "1"});
    Add(tool, kLists[0], {"*", "01", "001", "255"});
    Add(tool, kLists[1], {"10", "*", "abc", "**"});
    Add(tool, kLists[2], {"*", "*", "*", "*"});
    Add(tool, kLists[2], {"0", "00", "000", "1"});
    tool.Save(IDNO);

    const std::vector<std::uint8_t> file = gui::ReadFile(tool.SettingsFile());
    ASSERT_EQ(file.size(), 6876u + 3 * 16);
    const auto at = [&](std::size_t offset, std::size_t size)
    { return std::string(reinterpret_cast<const char*>(file.data()) + offset, size); };
    const std::size_t connectList = 76 + 75;
    EXPECT_EQ(at(connectList, 32), std::string("192\0"
                                               "168\0"
                                               "000\0"
                                               "001\0"
                                               "*\0\0\0"
                                               "001\0"
                                               "001\0"
                                               "255\0",
                                               32));
    EXPECT_EQ(at(connectList + 32, 22 * 16), std::string(22 * 16, '\0'));
    EXPECT_EQ(at(548, 48), std::string("010\0"
                                       "*\0\0\0"
                                       "000\0"
                                       "000\0"
                                       "*\0\0\0"
                                       "*\0\0\0"
                                       "*\0\0\0"
                                       "*\0\0\0"
                                       "000\0"
                                       "000\0"
                                       "000\0"
                                       "001\0",
                                       48));
}

TEST(NetworkPage, AnAllowOrDenyEntryThatCannotBeStoredShowsItsMessage)
{
    const std::pair<const AddressListUnderTest*, const char*> cases[] = {
        {&kLists[1], "許可IPアドレスの追加に失敗しました。"},
        {&kLists[2], "拒否IPアドレスの追加に失敗しました。"},
    };
    RunningTool tool;
    const std::vector<std::uint8_t> before = tool.Record().SaveToBytes();
    for (const auto& [list, text] : cases)
    {
        MessageBoxAnswerer answerer;
        {
            base::ScopedAllocationFailure noMemory(0);
            Add(tool, *list, {"1", "2", "3", "4"});
        }
        ASSERT_EQ(answerer.Seen().size(), 1u) << list->name;
        EXPECT_EQ(answerer.Seen()[0].caption, "Error");
        EXPECT_EQ(answerer.Seen()[0].text, text);
        EXPECT_TRUE(Lines(tool.Page(kNetworkPage), list->list).empty());
    }
    EXPECT_EQ(tool.Record().SaveToBytes(), before);
}
