#pragma once

// The device structures the input layer reads: the SDK's own on Windows, the
// compatibility header of the same layout elsewhere (the build picks the
// folder that holds "input_sdk.h").
#include "input_sdk.h"

static_assert(sizeof(DIJOYSTATE2) == 272);
static_assert(sizeof(XINPUT_STATE) == 16);
static_assert(sizeof(DIMOUSESTATE2) == 20);
static_assert(sizeof(DIDEVICEINSTANCEA) == 580);
static_assert(sizeof(XINPUT_VIBRATION) == 4);
