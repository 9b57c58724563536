// The ネットワーク page: key response, port, music and UPnP switches, the two
// IDs and the three address lists, with the IP entry dialog that the add
// buttons run. Every change goes into the record at once.
#include "app/config_application.h"
#include "app/system.h"
#include "base/window_text_win32.h"
#include "config/field_table.h"
#include "config/fixed_text.h"
#include "config/ip_address.h"
#include "dialog/page_controls.h"
#include "resources/resource.h"

#include <algorithm>
#include <cstdio>
#include <string>
#include <vector>

namespace
{

constexpr char kErrorCaption[] = "Error";
constexpr int kOctetFields[4] = {IDC_IP_OCTET1, IDC_IP_OCTET2, IDC_IP_OCTET3, IDC_IP_OCTET4};

// One address list of the page: its list box, its two buttons, the record's
// operations behind them and how an address reads in it.
struct AddressList
{
    int listBox;
    int addButton;
    int deleteButton;
    bool (config::CSaveConfig::*add)(const config::IpEntry& entry);
    bool (config::CSaveConfig::*remove)(std::int32_t index);
    std::string (*line)(const config::IpEntry& entry);
    const char* addFailure;
};

const AddressList kAddressLists[] = {
    {IDC_CONNECT_LIST, IDC_CONNECT_ADD, IDC_CONNECT_DELETE, &config::CSaveConfig::AddConnectEntry,
     &config::CSaveConfig::RemoveConnectEntry, config::ConnectLine,
     "接続IPアドレスの登録は２４件までです。"},
    {IDC_ALLOW_LIST, IDC_ALLOW_ADD, IDC_ALLOW_DELETE, &config::CSaveConfig::AddAllowEntry,
     &config::CSaveConfig::RemoveAllowEntry, config::ListedLine,
     "許可IPアドレスの追加に失敗しました。"},
    {IDC_DENY_LIST, IDC_DENY_ADD, IDC_DENY_DELETE, &config::CSaveConfig::AddDenyEntry,
     &config::CSaveConfig::RemoveDenyEntry, config::ListedLine,
     "拒否IPアドレスの追加に失敗しました。"},
};

// The port's and the octets' text as the fields are read: at most 29 bytes.
std::string FieldInput(HWND edit)
{
    std::string text = base::WindowText932(edit);
    text.resize(std::min<std::size_t>(text.size(), 29));
    return text;
}

const AddressList* ListAddedBy(int button)
{
    for (const AddressList& list : kAddressLists)
    {
        if (list.addButton == button)
            return &list;
    }
    return nullptr;
}

const AddressList* ListDeletedBy(int button)
{
    for (const AddressList& list : kAddressLists)
    {
        if (list.deleteButton == button)
            return &list;
    }
    return nullptr;
}

// The list box is looked up once by its callers: under Wine every lookup is
// a call to its server, and a list can hold 24 lines.
void AddLine(HWND listBox, const std::string& line)
{
    base::AddListItem(listBox, line);
}

// The 接続 list shows the slots ListedConnectSlots names, and is filled anew
// after each change, so that a line always stands for its slot.
void FillConnectList(HWND page, const config::ConfigNetwork& network, int enteredFreeSlot)
{
    const HWND listBox = GetDlgItem(page, IDC_CONNECT_LIST);
    SendMessageW(listBox, LB_RESETCONTENT, 0, 0);
    for (const int slot : config::ListedConnectSlots(network, enteredFreeSlot))
        AddLine(listBox, config::ConnectLine(network.connectList[slot]));
}

// Stores an entered address and shows it. A 接続 address takes the first
// free slot, which can be the one of an all-zero address entered before:
// such an address leaves its slot free and is listed until another takes it.
void AddAddress(HWND page, const AddressList& list, config::CSaveConfig& record,
                const config::IpEntry& entry, int& enteredFreeSlot)
{
    // Looked up before the address fills it.
    const int slot = config::FirstEmptyConnectSlot(*record.Network());
    if (!(record.*list.add)(entry))
    {
        base::ShowMessage(page, list.addFailure, kErrorCaption, MB_OK);
        return;
    }
    if (list.listBox != IDC_CONNECT_LIST)
    {
        AddLine(GetDlgItem(page, list.listBox), list.line(entry));
        return;
    }
    const config::ConfigNetwork& network = *record.Network();
    enteredFreeSlot = config::IsConnectSlotEmpty(network.connectList[slot]) ? slot : -1;
    FillConnectList(page, network, enteredFreeSlot);
}

void DeleteAddress(HWND page, const AddressList& list, config::CSaveConfig& record,
                   int& enteredFreeSlot)
{
    const auto selected =
        static_cast<std::int32_t>(SendDlgItemMessageW(page, list.listBox, LB_GETCURSEL, 0, 0));
    std::int32_t index = selected;
    if (list.listBox == IDC_CONNECT_LIST)
    {
        const std::vector<int> slots =
            config::ListedConnectSlots(*record.Network(), enteredFreeSlot);
        index = selected >= 0 && std::size_t(selected) < slots.size() ? slots[selected] : -1;
    }
    if (!(record.*list.remove)(index))
    {
        base::ShowMessage(page, "削除するIPアドレスをリストから選択してください。", kErrorCaption,
                          MB_OK);
        return;
    }
    if (list.listBox != IDC_CONNECT_LIST)
    {
        SendDlgItemMessageW(page, list.listBox, LB_DELETESTRING, selected, 0);
        return;
    }
    // The slots after the removed one moved up by one.
    if (enteredFreeSlot >= index)
        enteredFreeSlot = enteredFreeSlot == index ? -1 : enteredFreeSlot - 1;
    FillConnectList(page, *record.Network(), enteredFreeSlot);
}

} // namespace

void CConfigApplication::InitNetworkPage()
{
    const HWND page = pages_[kNetworkPageIndex].window;
    const config::ConfigNetwork& network = *record_->Network();

    // Each text set here comes back at once as the edit's update, so the
    // record's fields are read into copies first.
    base::SetItemText932(page, IDC_NETWORK_LOBBY_ID, config::FieldText(network.lobbyId));
    base::SetItemText932(page, IDC_NETWORK_DIRECT_ID, config::FieldText(network.directId));
    char port[16];
    std::snprintf(port, sizeof port, "%d", network.port);
    base::SetItemText932(page, IDC_NETWORK_PORT, port);

    dialog::ShowCheck(page, IDC_NETWORK_USE_UPNP, network.useUpnp != 0);
    dialog::ShowCheck(page, IDC_NETWORK_PLAY_BGM, network.playBgm != 0);
    dialog::FillChoices(page, IDC_NETWORK_KEY_RESPONSE, config::kKeyResponseNames,
                        network.keyResponse);

    enteredFreeConnectSlot_ = -1;
    FillConnectList(page, network, enteredFreeConnectSlot_);
    const HWND allowList = GetDlgItem(page, IDC_ALLOW_LIST);
    for (std::uint32_t index = 0; index < network.allowCount; ++index)
        AddLine(allowList, config::ListedLine(*record_->GetAllowEntry(index)));
    const HWND denyList = GetDlgItem(page, IDC_DENY_LIST);
    for (std::uint32_t index = 0; index < network.denyCount; ++index)
        AddLine(denyList, config::ListedLine(*record_->GetDenyEntry(index)));
}

LRESULT CConfigApplication::OnNetworkPage(HWND page, UINT message, WPARAM wParam, LPARAM)
{
    if (message != WM_COMMAND)
        return 0;
    const int control = LOWORD(wParam);
    const int code = HIWORD(wParam);
    config::ConfigNetwork& network = *record_->Network();

    if (code == EN_UPDATE)
    {
        const HWND edit = GetDlgItem(page, control);
        if (control == IDC_NETWORK_PORT)
            network.port = config::ReadPort(FieldInput(edit).c_str());
        else if (control == IDC_NETWORK_LOBBY_ID)
            config::StoreFieldText(network.lobbyId, config::kIdTextLimit, base::TakeTyped932(edit));
        else if (control == IDC_NETWORK_DIRECT_ID)
            config::StoreFieldText(network.directId, config::kIdTextLimit,
                                   base::TakeTyped932(edit));
    }
    else if (code == CBN_SELCHANGE && control == IDC_NETWORK_KEY_RESPONSE)
    {
        const LRESULT choice = SendDlgItemMessageW(page, control, CB_GETCURSEL, 0, 0);
        if (choice != CB_ERR)
            network.keyResponse = static_cast<std::uint8_t>(choice);
    }
    else if (code == BN_CLICKED)
    {
        if (control == IDC_NETWORK_USE_UPNP)
            network.useUpnp = dialog::CheckValue(page, control);
        else if (control == IDC_NETWORK_PLAY_BGM)
            network.playBgm = dialog::CheckValue(page, control);
        else if (const AddressList* list = ListAddedBy(control))
        {
            if (base::RunModalDialog(system_->GetInstance(), IDD_IP_ENTRY, system_->GetHwnd(),
                                     IpEntryDialogProc, reinterpret_cast<LPARAM>(this)) == 1)
                AddAddress(page, *list, *record_, ipEntry_, enteredFreeConnectSlot_);
        }
        else if (const AddressList* list = ListDeletedBy(control))
            DeleteAddress(page, *list, *record_, enteredFreeConnectSlot_);
    }
    return 1;
}

INT_PTR CALLBACK CConfigApplication::IpEntryDialogProc(HWND dialog, UINT message, WPARAM wParam,
                                                       LPARAM lParam)
{
    if (message == WM_INITDIALOG)
        SetWindowLongPtrW(dialog, GWLP_USERDATA, lParam);
    auto* application =
        reinterpret_cast<CConfigApplication*>(GetWindowLongPtrW(dialog, GWLP_USERDATA));
    if (application == nullptr)
        return 0;
    return application->OnIpEntryDialog(dialog, message, wParam, lParam);
}

LRESULT CConfigApplication::OnIpEntryDialog(HWND dialog, UINT message, WPARAM wParam, LPARAM)
{
    switch (message)
    {
    case WM_INITDIALOG:
        for (int field : kOctetFields)
        {
            base::SetItemText932(dialog, field, "");
            SendDlgItemMessageW(dialog, field, EM_LIMITTEXT, 3, 0);
        }
        return 1;
    case WM_CLOSE:
        EndDialog(dialog, 0);
        return 1;
    case WM_COMMAND:
        if (LOWORD(wParam) == IDOK)
        {
            // A refused field keeps the dialog open for another try.
            if (ReadIpEntry(dialog))
                EndDialog(dialog, 1);
        }
        else if (LOWORD(wParam) == IDCANCEL)
        {
            EndDialog(dialog, 0);
        }
        return 1;
    default:
        return 0;
    }
}

// The octets are stored one by one as they pass; after a refusal the entry
// holds a mixture, which nothing uses before the next full success.
bool CConfigApplication::ReadIpEntry(HWND dialog)
{
    for (int octet = 0; octet < 4; ++octet)
    {
        const std::string text = FieldInput(GetDlgItem(dialog, kOctetFields[octet]));
        if (!config::ReadOctet(text.c_str(), ipEntry_.octets[octet]))
        {
            base::ShowMessage(dialog, "IPアドレスには0～255までの数字を入力してください。",
                              kErrorCaption, MB_OK);
            return false;
        }
    }
    return true;
}
