#include "app/config_application.h"

#include "app/system.h"
#include "base/window_text_win32.h"
#include "input/input.h"
#include "resources/resource.h"
#include "sound/audio_warm_up_win32.h"
#include "sound/sound_device.h"

#include <commctrl.h>
#include <new>

namespace
{
CConfigApplication* application = nullptr;
}

CConfigApplication* Application()
{
    return application;
}

void SetApplication(CConfigApplication* instance)
{
    application = instance;
}

LRESULT CALLBACK AppWindowProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam)
{
    if (message == WM_DESTROY)
    {
        PostQuitMessage(0);
        return 0;
    }
    if (application != nullptr)
        return application->WindowProc(window, message, wParam, lParam);
    return DefWindowProcW(window, message, wParam, lParam);
}

CConfigApplication::CConfigApplication()
    : record_(nullptr), mainTab_(nullptr), keyTab_(nullptr), currentPage_(nullptr),
      currentKeyPage_(nullptr), procedure_(nullptr), focusedAction_(0), selectedPlayer_(0),
      ipEntry_(), pages_(), keyPages_(), musicEdits_(), tensionEdits_()
{
}

CConfigApplication::~CConfigApplication()
{
    Exit();
}

bool CConfigApplication::Init(HINSTANCE instance, WNDPROC procedure)
{
    // The audio drivers load while the record is read and the dialog made.
    sound::AudioWarmUp audioWarmUp;
    record_ = new (std::nothrow) config::CSaveConfig();
    if (record_ == nullptr)
        return false;
    if (!record_->Load())
    {
        base::ShowMessage(nullptr, "コンフィグファイルが読み込めません", "", MB_OK);
        return false;
    }

    INITCOMMONCONTROLSEX controls = {sizeof controls, ICC_LISTVIEW_CLASSES | ICC_TAB_CLASSES};
    if (!InitCommonControlsEx(&controls))
        return false;

    system_ = new (std::nothrow) CSystem();
    if (system_ == nullptr)
        return false;
    if (!system_->CreateDialogWindow(instance, IDD_MAIN, -1, -1, IDI_APP,
                                     reinterpret_cast<DLGPROC>(procedure), nullptr))
        return false;
    procedure_ = procedure;

    audioWarmUp.Wait();
    sound_ = new (std::nothrow) sound::CSound();
    if (sound_ == nullptr || !sound_->Init(system_->GetHwnd()))
        return false;

    input_ = new (std::nothrow) input::CInput();
    if (input_ == nullptr)
        return false;
    const input::InputWindow inputWindow = {system_->GetInstance(), system_->GetHwnd()};
    if (!input_->Init(&inputWindow))
        return false;

    BeginFrameTimer(system_, 60);
    timerRaised_ = true;

    CreatePages(instance);
    InitGraphicsPage();
    InitGamePage();
    InitNetworkPage();
    InitKeyConfigPage();
    InitReplayPage();
    InitUserMusicPage();
    InitRadioChatPage();
    return true;
}

bool CConfigApplication::Update()
{
    input_->Update();
    // Keys and buttons are taken only while their page is in view.
    if (currentPage_ != nullptr && currentPage_ == pages_[kKeyConfigPageIndex].window)
    {
        if (currentKeyPage_ == keyPages_[kKeyboardPageIndex].window)
            CaptureKey();
        else
            CapturePadButton();
    }
    return true;
}

bool CConfigApplication::Render()
{
    return true;
}

bool CConfigApplication::Exit()
{
    if (record_ != nullptr)
    {
        delete record_;
        record_ = nullptr;
    }
    for (int row = 0; row < config::kUserBgmRowCount; ++row)
    {
        for (SubclassedEdit* edit : {&musicEdits_[row], &tensionEdits_[row]})
        {
            if (edit->previousProcedure != nullptr)
                SetWindowLongPtrW(edit->window, GWLP_WNDPROC,
                                  reinterpret_cast<LONG_PTR>(edit->previousProcedure));
        }
    }
    ReleaseBase();
    return true;
}
