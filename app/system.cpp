#include "app/system.h"

#include "base/cp932.h"
#include "base/window_text_win32.h"

#include <commdlg.h>
#include <cstdlib>
#include <cstring>
#include <mmsystem.h>
#include <optional>
#include <string>

CSystem::CSystem()
    : instance_(nullptr), window_(nullptr), name_(nullptr), directory_(), width_(0), height_(0),
      style_(0)
{
}

CSystem::~CSystem()
{
    std::free(name_);
    name_ = nullptr;
}

const char* CSystem::GetClassName() const
{
    return "CSystem";
}

bool CSystem::CreateDialogWindow(HINSTANCE instance, int dialogTemplate, int x, int y, UINT,
                                 DLGPROC procedure, HWND parent)
{
    if (instance == nullptr)
        return false;
    instance_ = instance;
    window_ = base::CreateDialogFromTemplate(instance, dialogTemplate, parent, procedure);
    if (window_ == nullptr)
        return false;
    RECT rect;
    GetWindowRect(window_, &rect);
    SetName("Dialog");
    const int width = std::abs(rect.right - rect.left);
    const int height = std::abs(rect.bottom - rect.top);
    width_ = width;
    height_ = height;
    if (x < 0)
        x = (GetSystemMetrics(SM_CXSCREEN) - width) / 2;
    if (y < 0)
        y = (GetSystemMetrics(SM_CYSCREEN) - height) / 2;
    MoveWindow(window_, x, y, width, height, TRUE);
    ShowWindow(window_, SW_SHOWNORMAL);
    UpdateWindow(window_);
    SetCurrentDir(nullptr);
    return true;
}

void CSystem::GrowWindow(int dx, int dy)
{
    width_ += dx;
    height_ += dy;
    const int width = static_cast<int>(width_);
    const int height = static_cast<int>(height_);
    MoveWindow(window_, (GetSystemMetrics(SM_CXSCREEN) - width) / 2,
               (GetSystemMetrics(SM_CYSCREEN) - height) / 2, width, height, TRUE);
}

void CSystem::SetName(const char* name)
{
    std::free(name_);
    name_ = nullptr;
    if (name == nullptr)
        return;
    const std::size_t size = std::strlen(name) + 1;
    name_ = static_cast<char*>(std::malloc(size));
    if (name_ == nullptr)
        return;
    std::memcpy(name_, name, size);
    base::SetWindowText932(window_, name_);
}

bool CSystem::GetModuleDir(char* buffer, std::uint32_t size) const
{
    if (size == 0)
        return false;
    const DWORD length = GetModuleFileNameA(instance_, buffer, size);
    // A name cut by the buffer is not terminated on every Windows version.
    buffer[length < size ? length : size - 1] = '\0';
    // Cut after the last backslash that is a character of its own, never the
    // trail byte of a double-byte one.
    const char* last = base::FindLastCharacter(buffer, '\\');
    buffer[last != nullptr ? last - buffer + 1 : 0] = '\0';
    return true;
}

bool CSystem::SetCurrentDir(const char* path)
{
    if (path != nullptr)
    {
        std::strncpy(directory_, path, sizeof directory_ - 1);
        directory_[sizeof directory_ - 1] = '\0';
    }
    else
    {
        GetModuleDir(directory_, sizeof directory_);
    }
    directoryWide_ = base::WideFromAnsi(directory_);
    if (path == nullptr)
    {
        // Read wide: a folder whose name the system's ANSI code page cannot
        // hold would otherwise come back with '?' and never be entered.
        wchar_t module[MAX_PATH] = {};
        const DWORD length = GetModuleFileNameW(instance_, module, MAX_PATH);
        directoryWide_.assign(module, length < MAX_PATH ? length : 0);
        directoryWide_.erase(directoryWide_.find_last_of(L'\\') + 1);
    }
    return SetCurrentDirectoryW(directoryWide_.c_str()) != 0;
}

CSystem::FileChoice CSystem::OpenFileDialog(char* file, const char* title, const char* filter,
                                            const char* defaultExtension)
{
    // The pairs end at an empty description: the list is taken with its zeros.
    const char* end = filter;
    while (*end != '\0')
        end += std::strlen(end) + 1;
    const std::wstring filters = base::WideFrom932({filter, std::size_t(end - filter + 1)});
    const std::wstring caption = base::WideFrom932(title);
    const std::wstring extension = base::WideFrom932(defaultExtension);
    std::wstring chosenPath = base::WideFromAnsi(file);
    chosenPath.resize(MAX_PATH);

    OPENFILENAMEW dialog = {};
    dialog.lStructSize = sizeof dialog;
    dialog.hwndOwner = window_;
    dialog.lpstrFilter = filters.c_str();
    dialog.lpstrFile = chosenPath.data();
    dialog.nMaxFile = MAX_PATH;
    dialog.lpstrTitle = caption.c_str();
    dialog.Flags = OFN_FILEMUSTEXIST;
    dialog.lpstrDefExt = extension.c_str();
    const BOOL chosen = GetOpenFileNameW(&dialog);
    // Browsing may have moved the current directory away from the program's.
    SetCurrentDirectoryW(directoryWide_.c_str());
    if (!chosen)
        return FileChoice::Cancelled;
    const std::optional<std::string> path = base::AnsiFrom(chosenPath.c_str());
    if (!path)
        return FileChoice::NotInCodePage;
    std::strncpy(file, path->c_str(), MAX_PATH - 1);
    file[MAX_PATH - 1] = '\0';
    return FileChoice::Chosen;
}

void BeginFrameTimer(CSystem*, std::uint32_t)
{
    timeBeginPeriod(1);
}

void EndFrameTimer()
{
    timeEndPeriod(1);
}
