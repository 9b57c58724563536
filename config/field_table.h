#pragma once

// Every setting of the record, described once: the name vekcfg gives it, its
// kind, its default, the values the tool's controls allow and what each
// value means. The defaults, the pages' option texts and every vekcfg
// command work from this table. Texts here are code page 932, as every text
// of the tool.

#include "config/save_config.h"

#include <cstddef>
#include <cstdint>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace config
{

// The option texts of the pages' combo boxes, by the index the record
// stores.
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

enum class FieldKind
{
    // A combo box: the index of one of the field's options.
    Choice,
    // A check box: 1 checked, 0 cleared.
    Switch,
    // A replay's ロック box: 1 locked.
    Lock,
    // A 全体 box, stored the other way round: 0 when checked.
    Recipient,
    // A volume slider, in hundredths of a decibel.
    Volume,
    // The PORT edit.
    Port,
    // The 使用パッド list: a controller's number in enumeration order.
    Controller,
    // A key the keyboard page captured: its DirectInput code.
    KeyCode,
    // A button the controller page captured: its code.
    PadButton,
    // An edit's text.
    Text,
    // The 24 slots of the 接続 list.
    ConnectList,
    // The 許可 and 拒否 lists.
    AllowList,
    DenyList,
};

enum class Section
{
    Graphics,
    Game,
    Network,
    Replay,
    UserBgm,
    Keys,
    RadioChat,
};

// What the last index of a field stands for in the meaning of its values.
enum class FieldLabel
{
    None,
    Action,
    Replay,
    Player,
    FunctionKey,
};

enum class DefaultRule
{
    // `defaultValue`, or the empty text.
    Constant,
    // The field's last index: controller codes by action, controllers by
    // player.
    LastIndex,
    // The keyboard's default key of each action.
    KeyboardTable,
};

struct FieldDescription
{
    // As vekcfg names it, with "[]" for each index:
    // "keys.padConfigs[].buttons[]".
    const char* name;
    FieldKind kind;
    Section section;
    // Of the first element within the section, and its width: 1, 2 or 4
    // bytes for a number, the capacity for a text.
    std::size_t offset;
    std::size_t size;
    // Elements and their distance in bytes for each "[]", outermost first.
    int counts[2];
    std::size_t strides[2];
    std::span<const char* const> options;
    // The longest text the field takes.
    std::size_t textLimit;
    FieldLabel label;
    DefaultRule defaultRule;
    std::int64_t defaultValue;
    // The values of the last index a page changes, one bit each; the others
    // keep what they hold.
    std::uint32_t offered;
};

std::span<const FieldDescription> Fields();

// Sets every field whose name begins with `prefix` to its default; other
// bytes keep theirs. `firstIndex` limits indexed fields to one element of
// their first index (-1: all). The two heap lists are the record's own to
// reset.
void ResetFields(CSaveConfig& record, std::string_view prefix, int firstIndex = -1);

// One field with its indices.
struct FieldAt
{
    const FieldDescription* field = nullptr;
    int index[2] = {};
};

// The field that `name` names ("keys.padConfigs[1].buttons[14]"). False with
// the reason when there is none.
bool FindField(std::string_view name, FieldAt* at, std::string* reason);
// Whether `name` leads to fields without naming one ("keys",
// "keys.padConfigs", "keys.padConfigs[1]").
bool IsFieldGroup(std::string_view name);
std::string FieldName(const FieldAt& at);
int IndexCount(const FieldDescription& field);
// Whether a page changes this element.
bool IsOffered(const FieldAt& at);

bool IsListKind(FieldKind kind);
bool IsNumberKind(FieldKind kind);

// Numbers as stored (the volumes signed, everything else unsigned).
std::int64_t ReadNumber(const CSaveConfig& record, const FieldAt& at);
void WriteNumber(CSaveConfig& record, const FieldAt& at, std::int64_t value);
std::string ReadText(const CSaveConfig& record, const FieldAt& at);
// The text as the field keeps it (FitsText tells whether that is all).
void WriteText(CSaveConfig& record, const FieldAt& at, std::string_view text);
bool FitsText(const FieldDescription& field, std::string_view text);

// What a stored number means, as vekcfg shows it; empty for the port.
std::string ValueMeaning(const FieldAt& at, std::int64_t value);
// What a text field is, as vekcfg shows it beside the text ("F1"); empty
// when its name says enough.
std::string TextMeaning(const FieldAt& at);

bool IsAllowed(const FieldDescription& field, std::int64_t value);
// The values the tool's controls allow, in words.
std::string AllowedValues(const FieldDescription& field);
// A value as a user writes it: what it means as ValueMeaning gives it
// (ASCII letters in any case; for a resolution also with "x" for "×"; for a
// key also with "DIK_" before its name), or else the stored number. False
// when the field does not allow it.
bool ParseValue(const FieldAt& at, std::string_view text, std::int64_t* value);

// The address lists. An address reads as its four octets as stored
// ("192.168.001.*"); an all-zero 接続 slot as "".
std::vector<IpEntry> ReadList(const CSaveConfig& record, FieldKind kind);
std::string AddressText(const IpEntry& entry);
// The 接続 slots up to the last one that holds any byte.
std::vector<IpEntry> StoredConnectSlots(const ConfigNetwork& network);
// Four octets by the rules of the IP entry dialog ("1", "001", "*"; at most
// three characters each), or "" for an all-zero 接続 slot when
// `emptyAllowed`.
bool ParseAddress(std::string_view text, bool emptyAllowed, IpEntry* entry);

} // namespace config
