#include "config/field_table.h"

#include "base/cp932.h"
#include "base/input_codes.h"
#include "config/fixed_text.h"
#include "config/ip_address.h"
#include "config/volume.h"

#include <charconv>
#include <cstdio>
#include <cstring>

namespace config
{
namespace
{

constexpr std::int64_t kDefaultKeyboardKeys[kActionCount] = {
    0x50, 0x48, 0x4B, 0x4D, 0xC8, 0xD0, 0xCB, 0xCD, 0x11, 0x4F, 0x51, 0x47,
    0x49, 0x4C, 0x2C, 0x2F, 0x2D, 0x2E, 0x10, 0x1F, 0x1E, 0x20, 0x1C, 0x39,
};

constexpr std::int64_t kLowestSliderVolume = kSliderMinimumVolume + 1;
constexpr std::size_t kOctetCount = 4;

constexpr FieldDescription Field(const char* name, FieldKind kind, Section section,
                                 std::size_t offset, std::size_t size, std::int64_t defaultValue,
                                 std::span<const char* const> options = {})
{
    return {name,
            kind,
            section,
            offset,
            size,
            {0, 0},
            {0, 0},
            options,
            0,
            FieldLabel::None,
            DefaultRule::Constant,
            defaultValue,
            ~std::uint32_t(0)};
}

constexpr FieldDescription TextField(const char* name, Section section, std::size_t offset,
                                     std::size_t capacity, std::size_t limit)
{
    FieldDescription field = Field(name, FieldKind::Text, section, offset, capacity, 0);
    field.textLimit = limit;
    return field;
}

constexpr FieldDescription Indexed(FieldDescription field, int count, std::size_t stride,
                                   FieldLabel label,
                                   DefaultRule defaultRule = DefaultRule::Constant)
{
    const int dimension = field.counts[0] == 0 ? 0 : 1;
    field.counts[dimension] = count;
    field.strides[dimension] = stride;
    field.label = label;
    field.defaultRule = defaultRule;
    return field;
}

using G = ConfigGraphics;
using M = ConfigGame;
using N = ConfigNetwork;
using K = ConfigKeys;
using FK = FieldKind;

// The controller page never assigns a stick direction: neither a capture
// nor an exchange moves the codes of actions 4 to 7 and 9 to 12.
constexpr std::uint32_t kStickDirectionActions = 0xF0 | 0x1E00;

constexpr FieldDescription Offering(FieldDescription field, std::uint32_t offered)
{
    field.offered = offered;
    return field;
}

constexpr std::size_t kButtonsOffset = offsetof(K, padConfigs) + offsetof(PadConfig, buttons);
constexpr std::size_t kDeviceOffset = offsetof(K, padConfigs) + offsetof(PadConfig, device);

// In the order vekcfg shows them.
const FieldDescription kFields[] = {
    Field("graphics.screenSize", FK::Choice, Section::Graphics, offsetof(G, screenSize), 1, 2,
          kResolutionNames),
    Field("graphics.fullScreen", FK::Switch, Section::Graphics, offsetof(G, fullScreen), 4, 0),
    Field("graphics.showMovie", FK::Switch, Section::Graphics, offsetof(G, showMovie), 4, 1),
    Field("graphics.hdrLevel", FK::Choice, Section::Graphics, offsetof(G, hdrLevel), 1, 0,
          kHdrLevelNames),
    Field("graphics.trailQuality", FK::Choice, Section::Graphics, offsetof(G, trailQuality), 4, 1,
          kTrailQualityNames),

    Field("game.screenShake", FK::Switch, Section::Game, offsetof(M, screenShake), 4, 1),
    Field("game.padVibration", FK::Switch, Section::Game, offsetof(M, padVibration), 4, 1),
    Field("game.bgmVolume", FK::Volume, Section::Game, offsetof(M, bgmVolume), 4, 0),
    Field("game.seVolume", FK::Volume, Section::Game, offsetof(M, seVolume), 4, 0),
    Field("game.voiceVolume", FK::Volume, Section::Game, offsetof(M, voiceVolume), 4, 0),
    Field("game.voicePlayback", FK::Switch, Section::Game, offsetof(M, voicePlayback), 4, 1),
    Field("game.lockOnType", FK::Choice, Section::Game, offsetof(M, lockOnType), 4, 0,
          kLockOnTypeNames),
    Field("game.radarType", FK::Choice, Section::Game, offsetof(M, radarType), 1, 0,
          kRadarTypeNames),
    Field("game.cameraPosition", FK::Choice, Section::Game, offsetof(M, cameraPosition), 1, 1,
          kCameraPositionNames),
    Field("game.guardCorrection", FK::Choice, Section::Game, offsetof(M, guardCorrection), 1, 1,
          kGuardCorrectionNames),
    Field("game.arcadeDifficulty", FK::Choice, Section::Game, offsetof(M, arcadeDifficulty), 1, 1,
          kArcadeDifficultyNames),
    Field("game.captureEnabled", FK::Switch, Section::Game, offsetof(M, captureEnabled), 4, 0),
    Field("game.captureSize", FK::Choice, Section::Game, offsetof(M, captureSize), 1, 0,
          kResolutionNames),

    Field("network.port", FK::Port, Section::Network, offsetof(N, port), 2, 18000),
    Field("network.useUpnp", FK::Switch, Section::Network, offsetof(N, useUpnp), 4, 0),
    Field("network.keyResponse", FK::Choice, Section::Network, offsetof(N, keyResponse), 1, 1,
          kKeyResponseNames),
    TextField("network.lobbyId", Section::Network, offsetof(N, lobbyId), kIdCapacity, kIdTextLimit),
    TextField("network.directId", Section::Network, offsetof(N, directId), kIdCapacity,
              kIdTextLimit),
    Field("network.connectList", FK::ConnectList, Section::Network, offsetof(N, connectList),
          sizeof(N::connectList), 0),
    Field("network.allowList", FK::AllowList, Section::Network, offsetof(N, allowCount), 4, 0),
    Field("network.denyList", FK::DenyList, Section::Network, offsetof(N, denyCount), 4, 0),
    Field("network.playBgm", FK::Switch, Section::Network, offsetof(N, playBgm), 4, 1),

    Field("replay.saveReplays", FK::Switch, Section::Replay, offsetof(ConfigReplay, saveReplays), 4,
          1),
    Indexed(Field("replay.replayLock[]", FK::Lock, Section::Replay,
                  offsetof(ConfigReplay, replayLock), 4, 0),
            kReplayCount, 4, FieldLabel::Replay),

    Indexed(TextField("userBgm.rows[].musicPath", Section::UserBgm, offsetof(UserBgmRow, musicPath),
                      kPathCapacity, kPathTextLimit),
            kUserBgmRowCount, sizeof(UserBgmRow), FieldLabel::None),
    Indexed(TextField("userBgm.rows[].tensionPath", Section::UserBgm,
                      offsetof(UserBgmRow, tensionPath), kPathCapacity, kPathTextLimit),
            kUserBgmRowCount, sizeof(UserBgmRow), FieldLabel::None),

    Indexed(
        Field("keys.keyboardKeys[]", FK::KeyCode, Section::Keys, offsetof(K, keyboardKeys), 4, 0),
        kActionCount, 4, FieldLabel::Action, DefaultRule::KeyboardTable),
    Offering(Indexed(Indexed(Field("keys.padConfigs[].buttons[]", FK::PadButton, Section::Keys,
                                   kButtonsOffset, 4, 0),
                             kPlayerCount, sizeof(PadConfig), FieldLabel::None),
                     kActionCount, 4, FieldLabel::Action, DefaultRule::LastIndex),
             ~kStickDirectionActions),
    Indexed(Field("keys.padConfigs[].device", FK::Controller, Section::Keys, kDeviceOffset, 1, 0),
            kPlayerCount, sizeof(PadConfig), FieldLabel::Player, DefaultRule::LastIndex),

    Indexed(TextField("radioChat.entries[].text", Section::RadioChat,
                      offsetof(RadioChatEntry, text), kRadioChatTextCapacity, kRadioChatTextLimit),
            kRadioChatCount, sizeof(RadioChatEntry), FieldLabel::FunctionKey),
    Indexed(Field("radioChat.entries[].notToAll", FK::Recipient, Section::RadioChat,
                  offsetof(RadioChatEntry, notToAll), 1, 0),
            kRadioChatCount, sizeof(RadioChatEntry), FieldLabel::FunctionKey),
};

std::uint8_t* SectionBytes(CSaveConfig& record, Section section)
{
    switch (section)
    {
    case Section::Graphics:
        return reinterpret_cast<std::uint8_t*>(record.Graphics());
    case Section::Game:
        return reinterpret_cast<std::uint8_t*>(record.Game());
    case Section::Network:
        return reinterpret_cast<std::uint8_t*>(record.Network());
    case Section::Replay:
        return reinterpret_cast<std::uint8_t*>(record.Replay());
    case Section::UserBgm:
        return reinterpret_cast<std::uint8_t*>(record.UserBgm());
    case Section::Keys:
        return reinterpret_cast<std::uint8_t*>(record.Keys());
    case Section::RadioChat:
        return reinterpret_cast<std::uint8_t*>(record.RadioChat());
    }
    return nullptr;
}

std::uint8_t* ElementBytes(CSaveConfig& record, const FieldAt& at)
{
    const FieldDescription& field = *at.field;
    return SectionBytes(record, field.section) + field.offset + at.index[0] * field.strides[0] +
           at.index[1] * field.strides[1];
}

const std::uint8_t* ElementBytes(const CSaveConfig& record, const FieldAt& at)
{
    return ElementBytes(const_cast<CSaveConfig&>(record), at);
}

std::string Decimal(std::int64_t value)
{
    return std::to_string(value);
}

// The name of the field's last index in the meaning of its values.
std::string Label(const FieldAt& at)
{
    const int last = IndexCount(*at.field) - 1;
    const int index = last >= 0 ? at.index[last] : 0;
    switch (at.field->label)
    {
    case FieldLabel::None:
        break;
    case FieldLabel::Action:
        return kActionLabels[index];
    case FieldLabel::Replay:
        return std::string("リプレイ") + Decimal(index + 1);
    case FieldLabel::Player:
        return Decimal(index + 1) + "P";
    case FieldLabel::FunctionKey:
        return std::string("F") + Decimal(index + 1);
    }
    return std::string();
}

std::string Labelled(const FieldAt& at, const std::string& rest)
{
    return Label(at) + ": " + rest;
}

bool ReadInteger(std::string_view text, std::int64_t* value)
{
    if (text.empty() || (text[0] != '-' && (text[0] < '0' || text[0] > '9')))
        return false;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), *value);
    return error == std::errc() && end == text.data() + text.size();
}

char Folded(char c)
{
    return c >= 'a' && c <= 'z' ? static_cast<char>(c - 'a' + 'A') : c;
}

// Equal but for the case of ASCII letters; the trail byte of a double-byte
// character may look like a letter and is compared as it is.
bool SameIgnoringCase(std::string_view a, std::string_view b)
{
    if (a.size() != b.size())
        return false;
    for (std::size_t i = 0; i < a.size(); ++i)
    {
        if (base::IsLeadByte(static_cast<std::uint8_t>(a[i])) && i + 1 < a.size())
        {
            if (a[i] != b[i] || a[i + 1] != b[i + 1])
                return false;
            ++i;
        }
        else if (Folded(a[i]) != Folded(b[i]))
        {
            return false;
        }
    }
    return true;
}

// The forms a user may write a value's meaning in: the whole meaning, the
// part after this field's label, that part without its note in brackets.
std::vector<std::string> MeaningForms(const FieldAt& at, std::int64_t value)
{
    const std::string meaning = ValueMeaning(at, value);
    std::vector<std::string> forms{meaning};
    const std::string label = Label(at) + ": ";
    std::string rest = meaning;
    if (at.field->label != FieldLabel::None && meaning.rfind(label, 0) == 0)
    {
        rest = meaning.substr(label.size());
        forms.push_back(rest);
    }
    const std::size_t note = rest.find(" (");
    if (note != std::string::npos && note > 0)
        forms.push_back(rest.substr(0, note));
    if (at.field->kind == FieldKind::KeyCode)
        forms.push_back(std::string("DIK_") + rest);
    if (at.field->kind == FieldKind::Choice)
    {
        // "1280×960" may be written "1280x960".
        const std::string_view sign = "×";
        std::string plain;
        for (std::size_t i = 0; i < meaning.size();)
        {
            if (meaning.compare(i, sign.size(), sign) == 0)
            {
                plain += 'x';
                i += sign.size();
            }
            else
            {
                plain += meaning[i++];
            }
        }
        forms.push_back(plain);
    }
    return forms;
}

constexpr const char* kSwitchNames[] = {"off", "on"};
constexpr const char* kLockNames[] = {"unlocked", "locked"};
constexpr const char* kRecipientNames[] = {"to everyone (全体 checked)",
                                           "not to everyone (全体 cleared)"};

std::string VolumeName(std::int64_t value)
{
    if (value == kSilentVolume)
        return "silent";
    char decibels[32];
    std::snprintf(decibels, sizeof decibels, "%.2f dB", static_cast<double>(value) / 100.0);
    return decibels;
}

std::string ControllerName(std::int64_t value)
{
    return "game controller " + Decimal(value) + " in enumeration order";
}

// Only the low byte of a stored code names it, as on the key pages.
std::string KeyCodeName(std::int64_t value)
{
    return input::KeyName(static_cast<std::uint8_t>(value));
}

std::string PadButtonCodeName(std::int64_t value)
{
    return input::PadButtonName(static_cast<std::uint8_t>(value));
}

bool IsVolumeLevel(std::int64_t value)
{
    return value == kSilentVolume || value >= kLowestSliderVolume;
}

bool IsFreeKey(std::int64_t value)
{
    return !input::IsReservedKey(static_cast<int>(value));
}

// Highest of a choice: its last option.
constexpr std::int64_t kLastOption = -1;

// What one kind of field stores and what its values mean: the range the
// controls allow, the names of the values, and the allowed values in words.
struct KindRules
{
    FieldKind kind;
    std::int64_t lowest;
    std::int64_t highest;
    // Values inside the range the controls never store; null: none.
    bool (*allows)(std::int64_t);
    // The names of the values from 0 (a choice's are its options); a flag's
    // second name stands for any value but 0.
    std::span<const char* const> names;
    bool flag;
    // Names made from the value; empty where it has none.
    std::string (*name)(std::int64_t);
    // Whether a meaning begins with the label of the field's last index.
    bool labelled;
    // Null: the range, then the names.
    const char* allowed;
};

constexpr KindRules kKindRules[] = {
    {FK::Choice, 0, kLastOption, nullptr, {}, false, nullptr, false, nullptr},
    {FK::Switch, 0, 1, nullptr, kSwitchNames, true, nullptr, false, nullptr},
    {FK::Lock, 0, 1, nullptr, kLockNames, true, nullptr, true, nullptr},
    {FK::Recipient, 0, 1, nullptr, kRecipientNames, true, nullptr, true, nullptr},
    {FK::Volume,
     kSilentVolume,
     0,
     IsVolumeLevel,
     {},
     false,
     VolumeName,
     false,
     "-2999 to 0 (hundredths of a decibel), or -10000 for silence; or the meaning, such as "
     "-12.50 dB or silent"},
    {FK::Port, 0, 65535, nullptr, {}, false, nullptr, false, nullptr},
    {FK::Controller,
     0,
     255,
     nullptr,
     {},
     false,
     ControllerName,
     true,
     "0 to 255, the controller's number in enumeration order"},
    {FK::KeyCode,
     1,
     255,
     IsFreeKey,
     {},
     false,
     KeyCodeName,
     true,
     "a key name such as UP, Z or 2 (also DIK_UP), or a key code 1 to 255; never ESCAPE or F1 to "
     "F12"},
    {FK::PadButton,
     0,
     input::kPadFrameSize - 1,
     nullptr,
     {},
     false,
     PadButtonCodeName,
     true,
     "a button name such as BUTTON3 or DP_UP, or a code 0 to 47"},
    {FK::Text, 1, 0, nullptr, {}, false, nullptr, false, nullptr},
    {FK::ConnectList,
     1,
     0,
     nullptr,
     {},
     false,
     nullptr,
     false,
     "NAME+=ADDRESS or NAME-=ADDRESS, at most 24 addresses; an address is four octets, each 0 "
     "to 255 or *, such as 192.168.1.*"},
    {FK::AllowList,
     1,
     0,
     nullptr,
     {},
     false,
     nullptr,
     false,
     "NAME+=ADDRESS or NAME-=ADDRESS; an address is four octets, each 0 to 255 or *, such as "
     "192.168.1.*"},
    {FK::DenyList,
     1,
     0,
     nullptr,
     {},
     false,
     nullptr,
     false,
     "NAME+=ADDRESS or NAME-=ADDRESS; an address is four octets, each 0 to 255 or *, such as "
     "192.168.1.*"},
};

constexpr bool InKindOrder()
{
    for (std::size_t i = 0; i < std::size(kKindRules); ++i)
    {
        if (static_cast<std::size_t>(kKindRules[i].kind) != i)
            return false;
    }
    return true;
}
static_assert(InKindOrder(), "one row per kind, in the order of FieldKind");

const KindRules& RulesOf(FieldKind kind)
{
    return kKindRules[static_cast<std::size_t>(kind)];
}

std::span<const char* const> NamesOf(const FieldDescription& field, const KindRules& rules)
{
    return rules.highest == kLastOption ? field.options : rules.names;
}

std::int64_t Highest(const FieldDescription& field, const KindRules& rules)
{
    return rules.highest == kLastOption ? static_cast<std::int64_t>(field.options.size()) - 1
                                        : rules.highest;
}

// The values whose meanings a text is compared with: every allowed value
// that has a name.
std::vector<std::int64_t> NamedValues(const FieldDescription& field)
{
    const KindRules& rules = RulesOf(field.kind);
    std::vector<std::int64_t> values;
    if (rules.name == nullptr && NamesOf(field, rules).empty())
        return values;
    for (std::int64_t v = rules.lowest; v <= Highest(field, rules); ++v)
    {
        if (IsAllowed(field, v) && (rules.name == nullptr || !rules.name(v).empty()))
            values.push_back(v);
    }
    return values;
}

std::string ChoiceList(std::span<const char* const> options)
{
    std::string list;
    for (const char* option : options)
        list += (list.empty() ? "" : ", ") + std::string(option);
    return list;
}

} // namespace

std::span<const FieldDescription> Fields()
{
    return kFields;
}

int IndexCount(const FieldDescription& field)
{
    return field.counts[0] == 0 ? 0 : field.counts[1] == 0 ? 1 : 2;
}

bool IsOffered(const FieldAt& at)
{
    const int indices = IndexCount(*at.field);
    const int last = indices == 0 ? 0 : at.index[indices - 1];
    return (at.field->offered >> last & 1) != 0;
}

bool IsListKind(FieldKind kind)
{
    return kind == FieldKind::ConnectList || kind == FieldKind::AllowList ||
           kind == FieldKind::DenyList;
}

bool IsNumberKind(FieldKind kind)
{
    return kind != FieldKind::Text && !IsListKind(kind);
}

void ResetFields(CSaveConfig& record, std::string_view prefix, int firstIndex)
{
    for (const FieldDescription& field : kFields)
    {
        if (std::string_view(field.name).substr(0, prefix.size()) != prefix ||
            field.kind == FieldKind::AllowList || field.kind == FieldKind::DenyList)
            continue;
        FieldAt at{&field, {0, 0}};
        const int indices = IndexCount(field);
        const int outerFirst = firstIndex >= 0 ? firstIndex : 0;
        const int outerEnd = indices == 0 ? 1 : firstIndex >= 0 ? firstIndex + 1 : field.counts[0];
        const int innerEnd = indices == 2 ? field.counts[1] : 1;
        for (at.index[0] = outerFirst; at.index[0] < outerEnd; ++at.index[0])
        {
            for (at.index[1] = 0; at.index[1] < innerEnd; ++at.index[1])
            {
                if (field.kind == FieldKind::Text)
                {
                    WriteText(record, at, "");
                    continue;
                }
                if (field.kind == FieldKind::ConnectList)
                {
                    std::memset(ElementBytes(record, at), 0, field.size);
                    continue;
                }
                const int last = at.index[indices > 0 ? indices - 1 : 0];
                switch (field.defaultRule)
                {
                case DefaultRule::Constant:
                    WriteNumber(record, at, field.defaultValue);
                    break;
                case DefaultRule::LastIndex:
                    WriteNumber(record, at, last);
                    break;
                case DefaultRule::KeyboardTable:
                    WriteNumber(record, at, kDefaultKeyboardKeys[last]);
                    break;
                }
            }
        }
    }
}

bool FindField(std::string_view name, FieldAt* at, std::string* reason)
{
    // The name without its indices is the table's; the indices come apart.
    std::string pattern;
    int indices[2] = {};
    int found = 0;
    for (std::size_t i = 0; i < name.size(); ++i)
    {
        if (name[i] != '[')
        {
            pattern += name[i];
            continue;
        }
        const std::size_t close = name.find(']', i);
        std::int64_t index = -1;
        if (close == std::string_view::npos || found == 2 ||
            !ReadInteger(name.substr(i + 1, close - i - 1), &index) || index < 0 ||
            name[i + 1] == '-' || index > 0xFFFF)
        {
            *reason = "no setting is named \"" + std::string(name) + "\"";
            return false;
        }
        pattern += "[]";
        indices[found++] = static_cast<int>(index);
        i = close;
    }
    for (const FieldDescription& field : kFields)
    {
        if (pattern != field.name)
            continue;
        for (int d = 0; d < found; ++d)
        {
            if (indices[d] >= field.counts[d])
            {
                *reason = "no setting is named \"" + std::string(name) + "\": index " +
                          Decimal(indices[d]) + " is past the last, " +
                          Decimal(field.counts[d] - 1);
                return false;
            }
        }
        at->field = &field;
        at->index[0] = indices[0];
        at->index[1] = indices[1];
        return true;
    }
    *reason = "no setting is named \"" + std::string(name) + "\" (vekcfg show prints every name)";
    return false;
}

bool IsFieldGroup(std::string_view name)
{
    FieldAt at;
    std::string reason;
    if (FindField(name, &at, &reason))
        return false;
    // Strip the indices as FindField does and compare with every field's
    // beginning.
    std::string pattern;
    for (std::size_t i = 0; i < name.size(); ++i)
    {
        if (name[i] == '[')
        {
            const std::size_t close = name.find(']', i);
            if (close == std::string_view::npos)
                return false;
            pattern += "[]";
            i = close;
        }
        else
        {
            pattern += name[i];
        }
    }
    for (const FieldDescription& field : kFields)
    {
        const std::string_view full(field.name);
        if (full.size() > pattern.size() && full.substr(0, pattern.size()) == pattern &&
            (full[pattern.size()] == '.' || full[pattern.size()] == '['))
            return true;
    }
    return false;
}

std::string FieldName(const FieldAt& at)
{
    std::string name;
    int dimension = 0;
    for (const char* c = at.field->name; *c != '\0'; ++c)
    {
        if (c[0] == '[' && c[1] == ']')
        {
            // Appended piece by piece: GCC 12 warns of an overlap that is not
            // there in the optimised concatenation of three strings.
            name += '[';
            name += Decimal(at.index[dimension++]);
            name += ']';
            ++c;
        }
        else
        {
            name += *c;
        }
    }
    return name;
}

std::int64_t ReadNumber(const CSaveConfig& record, const FieldAt& at)
{
    const std::uint8_t* bytes = ElementBytes(record, at);
    switch (at.field->size)
    {
    case 1:
        return bytes[0];
    case 2:
    {
        std::uint16_t value;
        std::memcpy(&value, bytes, sizeof value);
        return value;
    }
    default:
        if (at.field->kind == FieldKind::Volume)
        {
            std::int32_t value;
            std::memcpy(&value, bytes, sizeof value);
            return value;
        }
        std::uint32_t value;
        std::memcpy(&value, bytes, sizeof value);
        return value;
    }
}

void WriteNumber(CSaveConfig& record, const FieldAt& at, std::int64_t value)
{
    std::uint8_t* bytes = ElementBytes(record, at);
    const auto stored = static_cast<std::uint32_t>(value);
    switch (at.field->size)
    {
    case 1:
        bytes[0] = static_cast<std::uint8_t>(stored);
        break;
    case 2:
    {
        const auto narrow = static_cast<std::uint16_t>(stored);
        std::memcpy(bytes, &narrow, sizeof narrow);
        break;
    }
    default:
        std::memcpy(bytes, &stored, sizeof stored);
        break;
    }
}

std::string ReadText(const CSaveConfig& record, const FieldAt& at)
{
    return FieldText(reinterpret_cast<const char*>(ElementBytes(record, at)), at.field->size);
}

void WriteText(CSaveConfig& record, const FieldAt& at, std::string_view text)
{
    StoreFieldText(reinterpret_cast<char*>(ElementBytes(record, at)), at.field->size,
                   at.field->textLimit, text);
}

bool FitsText(const FieldDescription& field, std::string_view text)
{
    return KeptTextLength(text, field.textLimit) == text.size();
}

std::string ValueMeaning(const FieldAt& at, std::int64_t value)
{
    const KindRules& rules = RulesOf(at.field->kind);
    const std::span<const char* const> names = NamesOf(*at.field, rules);
    std::string meaning;
    if (rules.name != nullptr)
    {
        meaning = rules.name(value);
        if (meaning.empty())
            meaning = "(no name)";
    }
    else if (!names.empty())
    {
        const std::int64_t index = rules.flag ? value != 0 : value;
        meaning = index >= 0 && index < static_cast<std::int64_t>(names.size())
                      ? std::string(names[static_cast<std::size_t>(index)])
                      : std::string("no such choice");
    }
    else
    {
        return meaning;
    }
    return rules.labelled ? Labelled(at, meaning) : meaning;
}

std::string TextMeaning(const FieldAt& at)
{
    return Label(at);
}

bool IsAllowed(const FieldDescription& field, std::int64_t value)
{
    const KindRules& rules = RulesOf(field.kind);
    return IsNumberKind(field.kind) && value >= rules.lowest && value <= Highest(field, rules) &&
           (rules.allows == nullptr || rules.allows(value));
}

std::string AllowedValues(const FieldDescription& field)
{
    const KindRules& rules = RulesOf(field.kind);
    if (field.kind == FieldKind::Text)
        return "a text of at most " + Decimal(static_cast<std::int64_t>(field.textLimit)) +
               " bytes in code page 932";
    if (rules.allowed != nullptr)
        return rules.allowed;
    const std::span<const char* const> names = NamesOf(field, rules);
    return Decimal(rules.lowest) + " to " + Decimal(Highest(field, rules)) +
           (names.empty() ? "" : ", or one of " + ChoiceList(names));
}

bool ParseValue(const FieldAt& at, std::string_view text, std::int64_t* value)
{
    // A meaning first: the key response "2" and the key 2 are what the
    // pages show, where their stored numbers are not.
    for (const std::int64_t candidate : NamedValues(*at.field))
    {
        for (const std::string& form : MeaningForms(at, candidate))
        {
            if (SameIgnoringCase(form, text))
            {
                *value = candidate;
                return true;
            }
        }
    }
    std::int64_t number = 0;
    if (!ReadInteger(text, &number))
        return false;
    *value = number;
    return IsAllowed(*at.field, number);
}

std::vector<IpEntry> ReadList(const CSaveConfig& record, FieldKind kind)
{
    std::vector<IpEntry> entries;
    const ConfigNetwork& network = *record.Network();
    if (kind == FieldKind::ConnectList)
        return StoredConnectSlots(network);
    if (kind == FieldKind::AllowList)
    {
        for (std::uint32_t i = 0; i < network.allowCount; ++i)
            entries.push_back(*record.GetAllowEntry(i));
    }
    else if (kind == FieldKind::DenyList)
    {
        for (std::uint32_t i = 0; i < network.denyCount; ++i)
            entries.push_back(*record.GetDenyEntry(i));
    }
    return entries;
}

std::string AddressText(const IpEntry& entry)
{
    static const IpEntry zero{};
    return std::memcmp(&entry, &zero, sizeof entry) == 0 ? std::string() : ListedLine(entry);
}

std::vector<IpEntry> StoredConnectSlots(const ConfigNetwork& network)
{
    static const IpEntry zero{};
    int used = kConnectSlotCount;
    while (used > 0 && std::memcmp(&network.connectList[used - 1], &zero, sizeof zero) == 0)
        --used;
    return std::vector<IpEntry>(network.connectList, network.connectList + used);
}

bool ParseAddress(std::string_view text, bool emptyAllowed, IpEntry* entry)
{
    IpEntry parsed{};
    if (text.empty())
    {
        *entry = parsed;
        return emptyAllowed;
    }
    std::size_t start = 0;
    for (std::size_t octet = 0; octet < kOctetCount; ++octet)
    {
        const std::size_t dot = text.find('.', start);
        const bool last = octet + 1 == kOctetCount;
        if (last != (dot == std::string_view::npos))
            return false;
        const std::string part(text.substr(start, last ? std::string_view::npos : dot - start));
        if (part.size() > kOctetTextLimit || !ReadOctet(part.c_str(), parsed.octets[octet]))
            return false;
        start = dot + 1;
    }
    *entry = parsed;
    return true;
}

} // namespace config
