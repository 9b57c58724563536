#pragma once

#include "base/win32.h"

#include <cstdint>
#include <string>

// The window object: owns the tool's one top-level window (the main dialog),
// remembers the program's directory and opens the file-open dialog.
class CSystem final
{
public:
    CSystem();
    ~CSystem();
    CSystem(const CSystem&) = delete;
    CSystem& operator=(const CSystem&) = delete;

    virtual const char* GetClassName() const;

    // Creates the modeless dialog from `dialogTemplate`; x or y below 0
    // centres it on the screen along that axis. The icon is accepted and not
    // applied.
    bool CreateDialogWindow(HINSTANCE instance, int dialogTemplate, int x, int y, UINT icon,
                            DLGPROC procedure, HWND parent);
    void SetName(const char* name);
    // Makes the window larger by the given amounts and centres it again on
    // the screen, as it was placed when created.
    void GrowWindow(int dx, int dy);
    HWND GetHwnd() const { return window_; }
    HINSTANCE GetInstance() const { return instance_; }
    bool GetModuleDir(char* buffer, std::uint32_t size) const;
    bool SetCurrentDir(const char* path);

    enum class FileChoice
    {
        Chosen,
        Cancelled, // or the dialog failed
        // The chosen path holds a character the system's ANSI code page
        // cannot, so the game could not open it.
        NotInCodePage,
    };

    // `file` is the caller's 260-byte buffer: the initial name on entry, the
    // chosen path on success, in the system's ANSI code page. The title and
    // the filter are code page 932 texts. Either way the program's directory
    // is the current directory again afterwards.
    FileChoice OpenFileDialog(char* file, const char* title, const char* filter,
                              const char* defaultExtension);

private:
    HINSTANCE instance_;
    HWND window_;
    char* name_;
    char directory_[MAX_PATH];
    std::wstring directoryWide_;
    std::uint32_t width_;
    std::uint32_t height_;
    std::uint32_t style_;
};

// The system timer runs at one millisecond for the application's lifetime;
// every raise is matched by exactly one restore.
void BeginFrameTimer(CSystem* window, std::uint32_t framesPerSecond);
void EndFrameTimer();
