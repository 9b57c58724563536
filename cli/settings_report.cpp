#include "cli/settings_report.h"

#include "cli/encoding.h"
#include "cli/json.h"
#include "config/field_table.h"
#include "config/ip_address.h"

#include <cstdio>

namespace cli
{
namespace
{

using Kind = Setting::Kind;

Setting Node(Kind kind, std::string name)
{
    Setting setting;
    setting.kind = kind;
    setting.name = std::move(name);
    return setting;
}

Setting Text(std::string name, std::string utf8, std::string meaning = std::string())
{
    Setting setting = Node(Kind::Text, std::move(name));
    setting.text = std::move(utf8);
    setting.meaning = std::move(meaning);
    return setting;
}

Setting& Child(Setting& parent, Kind kind, const std::string& name)
{
    for (Setting& child : parent.children)
    {
        if (child.name == name)
            return child;
    }
    parent.children.push_back(Node(kind, name));
    return parent.children.back();
}

Setting& Element(Setting& list, int index)
{
    while (static_cast<int>(list.children.size()) <= index)
        list.children.push_back(Node(Kind::Group, ""));
    return list.children[static_cast<std::size_t>(index)];
}

// Puts a value where its name says: "keys.padConfigs[1].buttons[14]" is
// element 14 of list "buttons" in element 1 of list "padConfigs" in group
// "keys".
void Place(Setting& root, const config::FieldAt& at, Setting leaf)
{
    const std::string pattern = at.field->name;
    Setting* node = &root;
    int dimension = 0;
    std::size_t start = 0;
    while (true)
    {
        const std::size_t dot = pattern.find('.', start);
        std::string part = pattern.substr(start, dot == std::string::npos ? dot : dot - start);
        const bool last = dot == std::string::npos;
        const bool indexed = part.size() > 2 && part.compare(part.size() - 2, 2, "[]") == 0;
        if (indexed)
            part.resize(part.size() - 2);
        if (last && !indexed)
        {
            leaf.name = part;
            node->children.push_back(std::move(leaf));
            return;
        }
        if (!indexed)
        {
            node = &Child(*node, Kind::Group, part);
            start = dot + 1;
            continue;
        }
        Setting& list = Child(*node, Kind::List, part);
        Setting& element = Element(list, at.index[dimension++]);
        if (last)
        {
            leaf.name.clear();
            element = std::move(leaf);
            return;
        }
        node = &element;
        start = dot + 1;
    }
}

// The 接続 list shows a slot by its numbers; one that reads as all zero is
// not listed and takes the next address.
std::string ConnectMeaning(const config::IpEntry& slot)
{
    return config::IsConnectSlotEmpty(slot) ? "empty: not listed, the next address takes it"
                                            : config::ConnectLine(slot);
}

Setting Describe(const config::CSaveConfig& record, const config::FieldAt& at)
{
    const config::FieldDescription& field = *at.field;
    if (config::IsListKind(field.kind))
    {
        Setting list = Node(Kind::List, "");
        for (const config::IpEntry& entry : config::ReadList(record, field.kind))
        {
            list.children.push_back(Text("", Utf8FromCp932(config::AddressText(entry)),
                                         field.kind == config::FieldKind::ConnectList
                                             ? ConnectMeaning(entry)
                                             : std::string()));
        }
        return list;
    }
    if (field.kind == config::FieldKind::Text)
        return Text("", Utf8FromCp932(config::ReadText(record, at)),
                    Utf8FromCp932(config::TextMeaning(at)));
    Setting number = Node(Kind::Number, "");
    number.number = config::ReadNumber(record, at);
    number.meaning = Utf8FromCp932(config::ValueMeaning(at, number.number));
    return number;
}

// Control characters would break a line.
void AppendEscaped(std::string& out, const std::string& text)
{
    for (const char c : text)
    {
        const auto byte = static_cast<unsigned char>(c);
        if (c == '\n')
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
            std::snprintf(escape, sizeof escape, "\\x%02x", byte);
            out += escape;
        }
        else
        {
            out += c;
        }
    }
}

std::string ValueText(const Setting& leaf)
{
    if (leaf.kind == Kind::Number)
        return std::to_string(leaf.number);
    std::string quoted = "\"";
    AppendEscaped(quoted, leaf.text);
    return quoted + "\"";
}

void WriteText(std::string& out, const Setting& setting, const std::string& path)
{
    if (setting.kind == Kind::Number || setting.kind == Kind::Text)
    {
        out += path + " = " + ValueText(setting);
        if (!setting.meaning.empty())
        {
            out += " (";
            AppendEscaped(out, setting.meaning);
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

Json ToJson(const Setting& setting)
{
    if (setting.kind == Kind::Number || setting.kind == Kind::Text)
    {
        Json value = setting.kind == Kind::Number ? Json(setting.number) : Json(setting.text);
        if (setting.meaning.empty())
            return value;
        return Json{{"value", std::move(value)}, {"meaning", setting.meaning}};
    }
    Json node = setting.kind == Kind::List ? Json::array() : Json::object();
    for (const Setting& child : setting.children)
    {
        if (setting.kind == Kind::List)
            node.push_back(ToJson(child));
        else
            node[child.name] = ToJson(child);
    }
    return node;
}

} // namespace

Setting DescribeSettings(const config::CSaveConfig& record, const std::string& path,
                         std::uint32_t version)
{
    char hex[16];
    std::snprintf(hex, sizeof hex, "0x%08X", static_cast<unsigned>(version));
    Setting root = Node(Kind::Group, "");
    root.children.push_back(Text("file", Utf8FromNative(path)));
    Setting versionSetting = Node(Kind::Number, "version");
    versionSetting.number = version;
    versionSetting.meaning = hex;
    root.children.push_back(std::move(versionSetting));
    for (const config::FieldDescription& field : config::Fields())
    {
        const int indices = config::IndexCount(field);
        config::FieldAt at{&field, {0, 0}};
        for (at.index[0] = 0; at.index[0] < (indices > 0 ? field.counts[0] : 1); ++at.index[0])
        {
            for (at.index[1] = 0; at.index[1] < (indices > 1 ? field.counts[1] : 1); ++at.index[1])
                Place(root, at, Describe(record, at));
        }
    }
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
    return WriteJson(ToJson(root)) + "\n";
}

} // namespace cli
