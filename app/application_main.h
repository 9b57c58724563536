#pragma once

#include "base/win32.h"

class CSystem;
namespace input
{
class CInput;
}
namespace sound
{
class CSound;
}

// The in-house application framework's life cycle. The game's own start-up
// (top-level window, graphics device, COM) lives in the game; the tool
// overrides every operation it runs, and only the release sequence of Exit
// is shared.
class CApplicationMain
{
public:
    CApplicationMain();
    CApplicationMain(const CApplicationMain&) = delete;
    CApplicationMain& operator=(const CApplicationMain&) = delete;

    virtual ~CApplicationMain();
    virtual bool Init(HINSTANCE instance, WNDPROC procedure) = 0;
    virtual bool Update();
    virtual bool OnUserMessage1();
    virtual bool OnUserMessage2();
    virtual bool Render();
    virtual bool Exit();
    virtual LRESULT WindowProc(HWND window, UINT message, WPARAM wParam, LPARAM lParam) = 0;
    virtual const char* GetClassName() const;

protected:
    // Deletes what is still held, each pointer cleared afterwards, so that the
    // sequence may run twice; the timer resolution is restored once.
    void ReleaseBase();

    CSystem* system_;
    void* graphicsDevice_;
    input::CInput* input_;
    sound::CSound* sound_;
    void* comObject_;
    void* textInput_;
    bool timerRaised_;
};
