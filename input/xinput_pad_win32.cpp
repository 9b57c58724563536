#include "input/xinput_pad.h"

#include <cstring>

namespace input
{
namespace
{

using GetStateFunction = DWORD(WINAPI*)(DWORD, XINPUT_STATE*);
using SetStateFunction = DWORD(WINAPI*)(DWORD, XINPUT_VIBRATION*);

struct XInputLibrary
{
    GetStateFunction getState;
    SetStateFunction setState;
};

// Linking XInput would keep the tool from starting on a system that lacks
// that one version; the first of these that is present serves instead.
constexpr const char* kXInputVersions[] = {"xinput1_3.dll", "xinput1_4.dll", "xinput9_1_0.dll"};

// Only the system's own copy: a library of the same name beside the program
// or in the current folder must never stand in for it. Systems without the
// search flag refuse it as a bad parameter; the full path serves there.
HMODULE LoadFromSystemFolder(const char* library)
{
    const HMODULE module = ::LoadLibraryExA(library, nullptr, LOAD_LIBRARY_SEARCH_SYSTEM32);
    if (module != nullptr || ::GetLastError() != ERROR_INVALID_PARAMETER)
        return module;
    char path[MAX_PATH];
    const UINT length = ::GetSystemDirectoryA(path, MAX_PATH);
    if (length == 0 || length + 1 + std::strlen(library) >= MAX_PATH)
        return nullptr;
    path[length] = '\\';
    std::strcpy(path + length + 1, library);
    return ::LoadLibraryA(path);
}

template <typename Function> Function Lookup(HMODULE module, const char* name)
{
    return reinterpret_cast<Function>(reinterpret_cast<void*>(::GetProcAddress(module, name)));
}

XInputLibrary LoadXInput()
{
    for (const char* version : kXInputVersions)
    {
        const HMODULE module = LoadFromSystemFolder(version);
        if (module == nullptr)
            continue;
        const XInputLibrary library = {Lookup<GetStateFunction>(module, "XInputGetState"),
                                       Lookup<SetStateFunction>(module, "XInputSetState")};
        if (library.getState != nullptr && library.setState != nullptr)
            return library;
        ::FreeLibrary(module);
    }
    return {nullptr, nullptr};
}

// Loaded once and kept for the life of the process.
const XInputLibrary& XInput()
{
    static const XInputLibrary library = LoadXInput();
    return library;
}

} // namespace

bool CXInputPad::Poll()
{
    if (XInput().getState == nullptr)
        return false;
    return XInput().getState(userIndex, &state) == ERROR_SUCCESS;
}

void CXInputPad::SendVibration()
{
    if (XInput().setState != nullptr)
        XInput().setState(userIndex, &vibration);
}

} // namespace input
