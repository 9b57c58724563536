#include "app/application_main.h"

#include "app/system.h"
#include "input/input.h"
#include "sound/sound_device.h"

CApplicationMain::CApplicationMain()
    : system_(nullptr), graphicsDevice_(nullptr), input_(nullptr), sound_(nullptr),
      comObject_(nullptr), textInput_(nullptr), timerRaised_(false)
{
}

CApplicationMain::~CApplicationMain()
{
    ReleaseBase();
}

bool CApplicationMain::Update()
{
    return true;
}

bool CApplicationMain::OnUserMessage1()
{
    return true;
}

bool CApplicationMain::OnUserMessage2()
{
    return true;
}

bool CApplicationMain::Render()
{
    return true;
}

bool CApplicationMain::Exit()
{
    ReleaseBase();
    return true;
}

const char* CApplicationMain::GetClassName() const
{
    return "CApplicationMain";
}

void CApplicationMain::ReleaseBase()
{
    if (input_ != nullptr)
    {
        delete input_;
        input_ = nullptr;
    }
    if (sound_ != nullptr)
    {
        delete sound_;
        sound_ = nullptr;
    }
    if (system_ != nullptr)
    {
        delete system_;
        system_ = nullptr;
    }
    if (timerRaised_)
    {
        EndFrameTimer();
        timerRaised_ = false;
    }
}
