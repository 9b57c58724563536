#pragma once

#include "base/win32.h"

// The tool's whole run: the application object, its start-up, the message
// loop and its release; returns the process's exit code. `firstIdle`, when
// given, is called the first time the loop finds no message waiting, that
// is once the dialog is shown and every page filled: the start-up benchmark
// takes its time there.
int RunTool(HINSTANCE instance, void (*firstIdle)());
