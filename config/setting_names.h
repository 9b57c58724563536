#pragma once

// What each stored choice means to the user: the option texts the pages show
// for a field's values, by the index the record stores, and the label of
// each key assignment action. The dialog and the command line show the same.

#include "config/config_sections.h"

namespace config
{

inline constexpr const char* kResolutionNames[kResolutionCount] = {
    "640×480",  "800×600",  "1024×768",  "1280×960", "1600×1200", "720×480",
    "1024×600", "1280×720", "1920×1080", "1440×900", "1680×1050", "1920×1200",
};
inline constexpr const char* kHdrLevelNames[] = {"なし", "LEVEL1", "LEVEL2", "LEVEL3", "LEVEL4"};
inline constexpr const char* kTrailQualityNames[] = {"なし", "低", "中", "高", "最高"};
inline constexpr const char* kLockOnTypeNames[] = {"距離優先", "キャラ正面優先", "カメラ正面優先",
                                                   "順送り"};
inline constexpr const char* kRadarTypeNames[] = {"固定", "回転"};
inline constexpr const char* kCameraPositionNames[] = {"左", "右"};
inline constexpr const char* kGuardCorrectionNames[] = {"OFF", "ON"};
inline constexpr const char* kArcadeDifficultyNames[] = {"Easy", "Normal", "Hard", "Lunatic"};
inline constexpr const char* kKeyResponseNames[] = {"1", "2", "3", "4", "5"};

// The key assignment pages' label of each action slot.
inline constexpr const char* kActionLabels[kActionCount] = {
    "使用しない",
    "使用しない",
    "使用しない",
    "使用しない",
    "移動上",
    "移動下",
    "移動左",
    "移動右",
    "カメラ正面",
    "使用しない",
    "使用しない",
    "使用しない",
    "使用しない",
    "使用しない",
    "スライド/決定",
    "ガード/キャンセル",
    "射撃",
    "近接攻撃",
    "ロック変更",
    "上昇",
    "トリガー",
    "下降",
    "メニュー/スタート",
    "命令変更",
};

} // namespace config
