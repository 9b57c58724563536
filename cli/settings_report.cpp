#include "cli/settings_report.h"

#include "cli/encoding.h"
#include "config/fixed_text.h"
#include "config/ip_address.h"
#include "config/setting_names.h"
#include "config/volume.h"
#include "input/name_tables.h"

#include <cstdio>

namespace cli
{
namespace
{

using Kind = Setting::Kind;

Setting Group(std::string name)
{
    Setting setting;
    setting.kind = Kind::Group;
    setting.name = std::move(name);
    return setting;
}

Setting List(std::string name)
{
    Setting setting = Group(std::move(name));
    setting.kind = Kind::List;
    return setting;
}

Setting Number(std::string name, long long value, std::string meaning = std::string())
{
    Setting setting;
    setting.kind = Kind::Number;
    setting.name = std::move(name);
    setting.number = value;
    setting.meaning = std::move(meaning);
    return setting;
}

Setting Text(std::string name, std::string utf8, std::string meaning = std::string())
{
    Setting setting;
    setting.kind = Kind::Text;
    setting.name = std::move(name);
    setting.text = std::move(utf8);
    setting.meaning = std::move(meaning);
    return setting;
}

template <std::size_t N> std::string Field(const char (&field)[N])
{
    return Utf8FromCp932(config::FieldText(field));
}

std::string OnOff(std::uint32_t value)
{
    return value != 0 ? "on" : "off";
}

template <std::size_t N>
Setting Choice(std::string name, long long value, const char* const (&choices)[N])
{
    const bool known = value >= 0 && value < static_cast<long long>(N);
    return Number(std::move(name), value,
                  known ? Utf8FromCp932(choices[value]) : std::string("no such choice"));
}

Setting Volume(std::string name, std::int32_t value)
{
    if (value == config::kSilentVolume)
        return Number(std::move(name), value, "silent");
    char decibels[32];
    std::snprintf(decibels, sizeof decibels, "%.2f dB", value / 100.0);
    return Number(std::move(name), value, decibels);
}

std::string ActionMeaning(int action, const char* name)
{
    const std::string label = Utf8FromCp932(config::kActionLabels[action]);
    return label + ": " + (*name != '\0' ? std::string(name) : std::string("(no name)"));
}

Setting Graphics(const config::ConfigGraphics& graphics)
{
    Setting group = Group("graphics");
    group.children.push_back(Choice("screenSize", graphics.screenSize, config::kResolutionNames));
    group.children.push_back(Number("fullScreen", graphics.fullScreen, OnOff(graphics.fullScreen)));
    group.children.push_back(Number("showMovie", graphics.showMovie, OnOff(graphics.showMovie)));
    group.children.push_back(Choice("hdrLevel", graphics.hdrLevel, config::kHdrLevelNames));
    group.children.push_back(
        Choice("trailQuality", graphics.trailQuality, config::kTrailQualityNames));
    return group;
}

Setting Game(const config::ConfigGame& game)
{
    Setting group = Group("game");
    auto& children = group.children;
    children.push_back(Number("screenShake", game.screenShake, OnOff(game.screenShake)));
    children.push_back(Number("padVibration", game.padVibration, OnOff(game.padVibration)));
    children.push_back(Volume("bgmVolume", game.bgmVolume));
    children.push_back(Volume("seVolume", game.seVolume));
    children.push_back(Volume("voiceVolume", game.voiceVolume));
    children.push_back(Number("voicePlayback", game.voicePlayback, OnOff(game.voicePlayback)));
    children.push_back(Choice("lockOnType", game.lockOnType, config::kLockOnTypeNames));
    children.push_back(Choice("radarType", game.radarType, config::kRadarTypeNames));
    children.push_back(Choice("cameraPosition", game.cameraPosition, config::kCameraPositionNames));
    children.push_back(
        Choice("guardCorrection", game.guardCorrection, config::kGuardCorrectionNames));
    children.push_back(
        Choice("arcadeDifficulty", game.arcadeDifficulty, config::kArcadeDifficultyNames));
    children.push_back(Number("captureEnabled", game.captureEnabled, OnOff(game.captureEnabled)));
    children.push_back(Choice("captureSize", game.captureSize, config::kResolutionNames));
    return group;
}

Setting Network(const config::CSaveConfig& record)
{
    const config::ConfigNetwork& network = *record.Network();
    Setting group = Group("network");
    auto& children = group.children;
    children.push_back(Number("port", network.port));
    children.push_back(Number("useUpnp", network.useUpnp, OnOff(network.useUpnp)));
    children.push_back(Choice("keyResponse", network.keyResponse, config::kKeyResponseNames));
    children.push_back(Text("lobbyId", Field(network.lobbyId)));
    children.push_back(Text("directId", Field(network.directId)));

    // The lists as the network page lists them: the filled 接続 slots in
    // slot order, then every 許可 and 拒否 entry.
    Setting connect = List("connectList");
    for (const config::IpEntry& entry : network.connectList)
    {
        if (!config::IsConnectSlotEmpty(entry))
            connect.children.push_back(Text("", config::ConnectLine(entry)));
    }
    children.push_back(std::move(connect));
    Setting allow = List("allowList");
    for (std::uint32_t i = 0; i < network.allowCount; ++i)
        allow.children.push_back(
            Text("", Utf8FromCp932(config::ListedLine(*record.GetAllowEntry(i)))));
    children.push_back(std::move(allow));
    Setting deny = List("denyList");
    for (std::uint32_t i = 0; i < network.denyCount; ++i)
        deny.children.push_back(
            Text("", Utf8FromCp932(config::ListedLine(*record.GetDenyEntry(i)))));
    children.push_back(std::move(deny));

    children.push_back(Number("playBgm", network.playBgm, OnOff(network.playBgm)));
    return group;
}

Setting Replay(const config::ConfigReplay& replay)
{
    Setting group = Group("replay");
    group.children.push_back(Number("saveReplays", replay.saveReplays, OnOff(replay.saveReplays)));
    Setting locks = List("replayLock");
    for (int i = 0; i < config::kReplayCount; ++i)
    {
        const std::uint32_t locked = replay.replayLock[i];
        locks.children.push_back(Number("", locked,
                                        Utf8FromCp932("リプレイ") + std::to_string(i + 1) + ": " +
                                            (locked != 0 ? "locked" : "unlocked")));
    }
    group.children.push_back(std::move(locks));
    return group;
}

Setting UserBgm(const config::ConfigUserBgm& userBgm)
{
    Setting group = Group("userBgm");
    Setting rows = List("rows");
    for (const config::UserBgmRow& stored : userBgm.rows)
    {
        Setting row = Group("");
        row.children.push_back(Text("musicPath", Field(stored.musicPath)));
        row.children.push_back(Text("tensionPath", Field(stored.tensionPath)));
        rows.children.push_back(std::move(row));
    }
    group.children.push_back(std::move(rows));
    return group;
}

// Only the low byte of a stored code names it, as on the key pages.
Setting Keys(const config::ConfigKeys& keys)
{
    Setting group = Group("keys");
    Setting keyboard = List("keyboardKeys");
    for (int action = 0; action < config::kActionCount; ++action)
    {
        const std::uint32_t code = keys.keyboardKeys[action];
        keyboard.children.push_back(Number(
            "", code, ActionMeaning(action, input::KeyName(static_cast<std::uint8_t>(code)))));
    }
    group.children.push_back(std::move(keyboard));

    Setting players = List("padConfigs");
    for (int player = 0; player < config::kPlayerCount; ++player)
    {
        const config::PadConfig& pad = keys.padConfigs[player];
        Setting assignment = Group("");
        Setting buttons = List("buttons");
        for (int action = 0; action < config::kActionCount; ++action)
        {
            const std::uint32_t code = pad.buttons[action];
            buttons.children.push_back(Number(
                "", code,
                ActionMeaning(action, input::PadButtonName(static_cast<std::uint8_t>(code)))));
        }
        assignment.children.push_back(std::move(buttons));
        assignment.children.push_back(Number("device", pad.device,
                                             std::to_string(player + 1) + "P: game controller " +
                                                 std::to_string(pad.device) +
                                                 " in enumeration order"));
        players.children.push_back(std::move(assignment));
    }
    group.children.push_back(std::move(players));
    return group;
}

Setting RadioChat(const config::ConfigRadioChat& radioChat)
{
    Setting group = Group("radioChat");
    Setting entries = List("entries");
    for (int i = 0; i < config::kRadioChatCount; ++i)
    {
        const config::RadioChatEntry& stored = radioChat.entries[i];
        std::string key = "F";
        key += std::to_string(i + 1);
        const std::string everyone = Utf8FromCp932("全体");
        Setting entry = Group("");
        entry.children.push_back(Text("text", Field(stored.text), key));
        entry.children.push_back(
            Number("notToAll", stored.notToAll,
                   key + (stored.notToAll == 0 ? ": to everyone (" + everyone + " checked)"
                                               : ": not to everyone (" + everyone + " cleared)")));
        entries.children.push_back(std::move(entry));
    }
    group.children.push_back(std::move(entries));
    return group;
}

// Control characters would break a line of the text form or a JSON string.
void AppendEscaped(std::string& out, const std::string& text, bool json)
{
    for (const char c : text)
    {
        const auto byte = static_cast<unsigned char>(c);
        if (json && (c == '"' || c == '\\'))
        {
            out += '\\';
            out += c;
        }
        else if (c == '\n')
        {
            out += "\\n";
        }
        else if (c == '\t')
        {
            out += "\\t";
        }
        else if (byte < 0x20 || byte == 0x7F)
        {
            char escape[8];
            std::snprintf(escape, sizeof escape, json ? "\\u%04x" : "\\x%02x", byte);
            out += escape;
        }
        else
        {
            out += c;
        }
    }
}

std::string ValueText(const Setting& leaf, bool json)
{
    if (leaf.kind == Kind::Number)
        return std::to_string(leaf.number);
    std::string quoted = "\"";
    AppendEscaped(quoted, leaf.text, json);
    return quoted + "\"";
}

void WriteText(std::string& out, const Setting& setting, const std::string& path)
{
    if (setting.kind == Kind::Number || setting.kind == Kind::Text)
    {
        out += path + " = " + ValueText(setting, false);
        if (!setting.meaning.empty())
        {
            out += " (";
            AppendEscaped(out, setting.meaning, false);
            out += ")";
        }
        out += "\n";
        return;
    }
    if (setting.kind == Kind::List && setting.children.empty())
    {
        out += path + " = (none)\n";
        return;
    }
    for (std::size_t i = 0; i < setting.children.size(); ++i)
    {
        const Setting& child = setting.children[i];
        std::string childPath;
        if (setting.kind == Kind::List)
            childPath = path + "[" + std::to_string(i) + "]";
        else
            childPath = path.empty() ? child.name : path + "." + child.name;
        WriteText(out, child, childPath);
    }
}

std::string JsonString(const std::string& text)
{
    std::string quoted = "\"";
    AppendEscaped(quoted, text, true);
    return quoted + "\"";
}

void WriteJson(std::string& out, const Setting& setting, int depth)
{
    const std::string indent(std::size_t(depth) * 2, ' ');
    const std::string inner(std::size_t(depth + 1) * 2, ' ');
    if (setting.kind == Kind::Number || setting.kind == Kind::Text)
    {
        if (setting.meaning.empty())
        {
            out += ValueText(setting, true);
            return;
        }
        out += "{\"value\": " + ValueText(setting, true) +
               ", \"meaning\": " + JsonString(setting.meaning) + "}";
        return;
    }
    const bool list = setting.kind == Kind::List;
    if (setting.children.empty())
    {
        out += list ? "[]" : "{}";
        return;
    }
    out += list ? "[\n" : "{\n";
    for (std::size_t i = 0; i < setting.children.size(); ++i)
    {
        const Setting& child = setting.children[i];
        out += inner;
        if (!list)
            out += JsonString(child.name) + ": ";
        WriteJson(out, child, depth + 1);
        out += i + 1 < setting.children.size() ? ",\n" : "\n";
    }
    out += indent + (list ? "]" : "}");
}

} // namespace

Setting DescribeSettings(const config::CSaveConfig& record, const std::string& path,
                         std::uint32_t version)
{
    char hex[16];
    std::snprintf(hex, sizeof hex, "0x%08X", static_cast<unsigned>(version));
    Setting root = Group("");
    root.children.push_back(Text("file", Utf8FromNative(path)));
    root.children.push_back(Number("version", version, hex));
    root.children.push_back(Graphics(*record.Graphics()));
    root.children.push_back(Game(*record.Game()));
    root.children.push_back(Network(record));
    root.children.push_back(Replay(*record.Replay()));
    root.children.push_back(UserBgm(*record.UserBgm()));
    root.children.push_back(Keys(*record.Keys()));
    root.children.push_back(RadioChat(*record.RadioChat()));
    return root;
}

std::string SettingsText(const Setting& root)
{
    std::string out;
    WriteText(out, root, "");
    return out;
}

std::string SettingsJson(const Setting& root)
{
    std::string out;
    WriteJson(out, root, 0);
    return out + "\n";
}

} // namespace cli
