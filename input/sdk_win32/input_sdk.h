#pragma once

// The DirectInput 8 and XInput declarations of the Windows SDK. Elsewhere a
// header of the same name supplies the same structures.

#define DIRECTINPUT_VERSION 0x0800

#include <dinput.h>
#include "base/win32.h"
#include <xinput.h>
