// A stand-in that a careless search would load instead of the system's
// XInput: it claims that every pad is attached.
#include <windows.h>
#include <xinput.h>

extern "C" __declspec(dllexport) DWORD WINAPI XInputGetState(DWORD, XINPUT_STATE* state)
{
    ZeroMemory(state, sizeof *state);
    state->dwPacketNumber = 0x7E57;
    return ERROR_SUCCESS;
}

extern "C" __declspec(dllexport) DWORD WINAPI XInputSetState(DWORD, XINPUT_VIBRATION*)
{
    return ERROR_SUCCESS;
}
