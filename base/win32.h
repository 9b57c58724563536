#pragma once

// The one way Windows files take in the Win32 API. <windows.h> renames
// GetClassName to GetClassNameA, which would turn every class's own
// GetClassName into another function in the files that include it; the API
// function is called by its explicit name GetClassNameA instead.
#include <windows.h>

#undef GetClassName
