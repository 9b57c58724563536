#pragma once

#include "app/application_main.h"
#include "config/save_config.h"

#include <cstdint>

// A dialog of the tool: its template and, once created, its window.
struct PageSlot
{
    std::uint32_t templateId;
    HWND window;
};

// An edit whose window procedure the tool replaces to take dropped files.
struct SubclassedEdit
{
    std::uint32_t controlId;
    HWND window;
    WNDPROC previousProcedure;
};

inline constexpr int kPageCount = 7;
inline constexpr int kKeyPageCount = 2;
inline constexpr int kKeyConfigPageIndex = 5;
inline constexpr int kGraphicsPageIndex = 0;
inline constexpr int kGamePageIndex = 1;
inline constexpr int kNetworkPageIndex = 2;
inline constexpr int kReplayPageIndex = 3;
inline constexpr int kUserMusicPageIndex = 4;
inline constexpr int kRadioChatPageIndex = 6;
inline constexpr int kKeyboardPageIndex = 0;
inline constexpr int kPadPageIndex = 1;

class CConfigApplication : public CApplicationMain
{
public:
    CConfigApplication();
    ~CConfigApplication() override;

    bool Init(HINSTANCE instance, WNDPROC procedure) override;
    bool Update() override;
    bool Render() override;
    bool Exit() override;
    LRESULT WindowProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) override;

    config::CSaveConfig* Record() { return record_; }
    CSystem* System() { return system_; }
    input::CInput* Input() { return input_; }
    HWND MainTab() const { return mainTab_; }
    HWND KeyTab() const { return keyTab_; }
    HWND PageWindow(int index) const { return pages_[index].window; }
    HWND KeyPageWindow(int index) const { return keyPages_[index].window; }
    HWND CurrentPage() const { return currentPage_; }
    HWND CurrentKeyPage() const { return currentKeyPage_; }
    std::int8_t FocusedAction() const { return focusedAction_; }
    std::uint32_t SelectedPlayer() const { return selectedPlayer_; }

    // Shows one page of the main tab (or of the key tab) and hides the
    // others; an index out of range hides them all.
    bool SelectPage(int index);
    bool SelectKeyPage(int index);

    using PageHandler = LRESULT (CConfigApplication::*)(HWND page, UINT message, WPARAM wParam,
                                                        LPARAM lParam);

    // Graphics page: screen size, HDR, trail quality, full screen, movies.
    bool InitGraphicsPage();
    LRESULT OnGraphicsPage(HWND page, UINT message, WPARAM wParam, LPARAM lParam);

    // Game page: options, the three volume sliders and the game's choices.
    bool InitGamePage();
    LRESULT OnGamePage(HWND page, UINT message, WPARAM wParam, LPARAM lParam);

    // Replay page: saving replays and the lock of each of the thirty.
    bool InitReplayPage();
    LRESULT OnReplayPage(HWND page, UINT message, WPARAM wParam, LPARAM lParam);

    // User music page (BGM): ten music and tension file paths, typed, browsed
    // for or dropped onto the twenty subclassed edits, and checked.
    bool InitUserMusicPage();
    LRESULT OnUserMusicPage(HWND page, UINT message, WPARAM wParam, LPARAM lParam);
    LRESULT OnUserMusicEdit(HWND edit, UINT message, WPARAM wParam, LPARAM lParam);

    // Radio-chat page: the twelve function-key messages and their receivers.
    bool InitRadioChatPage();
    LRESULT OnRadioChatPage(HWND page, UINT message, WPARAM wParam, LPARAM lParam);

    // Network page (ネットワーク) and the IP entry dialog its add buttons run.
    void InitNetworkPage();
    LRESULT OnNetworkPage(HWND page, UINT message, WPARAM wParam, LPARAM lParam);
    static INT_PTR CALLBACK IpEntryDialogProc(HWND dialog, UINT message, WPARAM wParam,
                                              LPARAM lParam);
    LRESULT OnIpEntryDialog(HWND dialog, UINT message, WPARAM wParam, LPARAM lParam);
    bool ReadIpEntry(HWND dialog);

    // Key-config page: a keyboard key and, per player, a controller button
    // for each action, assigned by pressing it while the action's edit has
    // the focus.
    bool InitKeyConfigPage();
    void FillKeyboardPage();
    void FillPadPage();
    LRESULT OnKeyboardPage(HWND page, UINT message, WPARAM wParam, LPARAM lParam);
    LRESULT OnPadPage(HWND page, UINT message, WPARAM wParam, LPARAM lParam);
    void CaptureKey();
    void CapturePadButton();

private:
    // Creates the two tab controls' items and pages and places the pages on
    // their display areas. A page that cannot be created is left out.
    void CreatePages(HINSTANCE instance);
    LRESULT OnKeyConfigPage(HWND page, UINT message, WPARAM wParam, LPARAM lParam);

    // The main dialog's own messages: the two buttons, the close command and
    // the tab.
    LRESULT OnMainDialog(HWND dialog, UINT message, WPARAM wParam, LPARAM lParam);
    LRESULT OnMainTabNotify(LPARAM lParam);
    LRESULT OnSave(HWND dialog);
    void ConfirmClose(HWND dialog, const char* question);

    config::CSaveConfig* record_;
    HWND mainTab_;
    HWND keyTab_;
    HWND currentPage_;
    HWND currentKeyPage_;
    WNDPROC procedure_;
    std::int8_t focusedAction_;
    std::uint32_t selectedPlayer_;
    config::IpEntry ipEntry_;
    // The free 接続 slot that an all-zero address last went to, listed until
    // another address takes it; -1 for none.
    int enteredFreeConnectSlot_ = -1;
    PageSlot pages_[kPageCount];
    PageSlot keyPages_[kKeyPageCount];
    SubclassedEdit musicEdits_[config::kUserBgmRowCount];
    SubclassedEdit tensionEdits_[config::kUserBgmRowCount];
};

// The one application object of the process. Set as soon as it is
// constructed: messages sent while the dialogs are created must reach it.
CConfigApplication* Application();
void SetApplication(CConfigApplication* application);

// The window procedure of every dialog, page and subclassed edit of the tool.
LRESULT CALLBACK AppWindowProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam);
