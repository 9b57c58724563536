#pragma once

// Runs the tool's own start-up inside the test process, with TEMP in a folder
// of the test's own, and drives its dialogs by the messages a user's actions
// produce. Message boxes are answered by a CBT hook and recorded.

#include "app/config_application.h"
#include "base/win32.h"
#include "tests/support/temp_folder.h"

#include <deque>
#include <memory>
#include <string>
#include <vector>

namespace gui
{

struct MessageBoxSeen
{
    std::string caption;
    std::string text;
};

// Answers every message box shown while it exists: the queued answers in
// order, then `fallback`.
class MessageBoxAnswerer
{
public:
    explicit MessageBoxAnswerer(int fallback = IDOK);
    ~MessageBoxAnswerer();
    MessageBoxAnswerer(const MessageBoxAnswerer&) = delete;
    MessageBoxAnswerer& operator=(const MessageBoxAnswerer&) = delete;

    void Queue(int answer) { answers_.push_back(answer); }
    const std::vector<MessageBoxSeen>& Seen() const { return seen_; }

private:
    static LRESULT CALLBACK Hook(int code, WPARAM wParam, LPARAM lParam);

    HHOOK hook_;
    int fallback_;
    std::deque<int> answers_;
    std::vector<MessageBoxSeen> seen_;
};

// The application object after its Init, with its settings file in a folder
// of the test's own. Destroying it closes the dialog and runs Exit.
class RunningTool
{
public:
    RunningTool();
    // Starts from this settings file instead of none.
    explicit RunningTool(const std::vector<std::uint8_t>& settingsFile);
    ~RunningTool();
    RunningTool(const RunningTool&) = delete;
    RunningTool& operator=(const RunningTool&) = delete;

    bool Started() const { return started_; }
    CConfigApplication& App() { return *application_; }
    config::CSaveConfig& Record() { return *application_->Record(); }
    HWND MainDialog();
    HWND Page(int index) { return application_->PageWindow(index); }
    HWND KeyPage(int index) { return application_->KeyPageWindow(index); }
    HWND Control(HWND page, int id) { return GetDlgItem(page, id); }
    std::string SettingsFile() const { return folder_.SettingsFile(); }

    // Dispatches what is waiting, then runs one idle pass (Update, Render).
    void Pump();

    // A user's click on a main tab or key tab: selection and notification.
    void ClickTab(int index);
    void ClickKeyTab(int index);

    // The notifications a user's action on a control sends its page.
    void Click(HWND page, int id);                         // a button or check box
    void SetCheck(HWND page, int id, bool on);             // a check box clicked into that state
    void Choose(HWND page, int id, int index);             // a combo box selection
    void Type(HWND page, int id, const std::string& text); // an edit's new text

    // Presses 保存 and answers the closing question with `answer`.
    std::vector<MessageBoxSeen> Save(int answer = IDNO);

private:
    void Start();

    testing_support::TempSaveFolder folder_;
    std::unique_ptr<CConfigApplication> application_;
    bool started_ = false;
};

std::string WindowText(HWND window);
std::vector<std::uint8_t> ReadFile(const std::string& path);

} // namespace gui
