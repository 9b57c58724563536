#include "cli/settings_change.h"

#include "cli/encoding.h"
#include "config/field_table.h"

#include <cstdint>
#include <cstring>

namespace cli
{
namespace
{

using config::FieldKind;
using Operation = SettingChange::Operation;

std::string Allowed(const config::FieldDescription& field)
{
    return "; allowed: " + Utf8FromCp932(config::AllowedValues(field));
}

bool Refuse(std::string* refusal, const std::string& name, const std::string& problem,
            const config::FieldDescription& field)
{
    *refusal = name + ": " + problem + Allowed(field);
    return false;
}

std::string Quoted(const std::string& text)
{
    return "\"" + text + "\"";
}

bool ToCp932(const std::string& utf8, std::string* cp932, const std::string& name,
             const config::FieldDescription& field, std::string* refusal)
{
    if (Cp932FromUtf8(utf8, cp932))
        return true;
    // Not quoted: a console could not show the character either.
    return Refuse(refusal, name, "the text holds a character that code page 932 has no form for",
                  field);
}

bool ReadAddress(const std::string& text, bool emptyAllowed, config::IpEntry* entry,
                 const std::string& name, const config::FieldDescription& field,
                 std::string* refusal)
{
    std::string cp932;
    if (!ToCp932(text, &cp932, name, field, refusal))
        return false;
    if (config::ParseAddress(cp932, emptyAllowed, entry))
        return true;
    return Refuse(refusal, name, Quoted(text) + " is not an address", field);
}

bool SameEntry(const config::IpEntry& a, const config::IpEntry& b)
{
    return std::memcmp(&a, &b, sizeof a) == 0;
}

bool AddEntry(config::CSaveConfig& record, FieldKind kind, const config::IpEntry& entry)
{
    if (kind == FieldKind::ConnectList)
        return record.AddConnectEntry(entry);
    return kind == FieldKind::AllowList ? record.AddAllowEntry(entry) : record.AddDenyEntry(entry);
}

bool RemoveEntry(config::CSaveConfig& record, FieldKind kind, int index)
{
    if (kind == FieldKind::ConnectList)
        return record.RemoveConnectEntry(index);
    return kind == FieldKind::AllowList ? record.RemoveAllowEntry(index)
                                        : record.RemoveDenyEntry(index);
}

bool ChangeList(config::CSaveConfig& record, const config::FieldDescription& field,
                const SettingChange& change, std::string* refusal)
{
    const std::string& name = change.name;
    const FieldKind kind = field.kind;
    const bool connect = kind == FieldKind::ConnectList;
    if (change.operation == Operation::Set)
        return Refuse(refusal, name, "a list is changed by += or -=", field);

    if (change.operation == Operation::ReplaceList)
    {
        if (connect && change.items.size() > config::kConnectSlotCount)
            return Refuse(refusal, name,
                          std::to_string(change.items.size()) + " addresses are too many", field);
        std::vector<config::IpEntry> entries(change.items.size());
        for (std::size_t i = 0; i < entries.size(); ++i)
        {
            if (!ReadAddress(change.items[i], connect, &entries[i], name, field, refusal))
                return false;
        }
        if (connect)
        {
            // Slot by slot, as show lists them: a slot that reads as empty
            // stays where it was.
            config::ConfigNetwork& network = *record.Network();
            std::memset(network.connectList, 0, sizeof network.connectList);
            for (std::size_t slot = 0; slot < entries.size(); ++slot)
                network.connectList[slot] = entries[slot];
            return true;
        }
        for (std::size_t left = config::ReadList(record, kind).size(); left > 0; --left)
        {
            if (!RemoveEntry(record, kind, static_cast<int>(left - 1)))
                return Refuse(refusal, name, "the list cannot shrink (out of memory)", field);
        }
        for (const config::IpEntry& entry : entries)
        {
            if (!AddEntry(record, kind, entry))
                return Refuse(refusal, name, "the list cannot grow (out of memory)", field);
        }
        return true;
    }

    config::IpEntry entry{};
    if (!ReadAddress(change.text, false, &entry, name, field, refusal))
        return false;
    if (change.operation == Operation::Add)
    {
        if (AddEntry(record, kind, entry))
            return true;
        return Refuse(refusal, name,
                      connect ? "all " + std::to_string(config::kConnectSlotCount) +
                                    " slots are taken (" +
                                    Utf8FromCp932("接続IPアドレスの登録は２４件までです。") + ")"
                              : "the list cannot grow (out of memory)",
                      field);
    }
    const std::vector<config::IpEntry> entries = config::ReadList(record, kind);
    for (std::size_t i = 0; i < entries.size(); ++i)
    {
        if (!SameEntry(entries[i], entry))
            continue;
        if (RemoveEntry(record, kind, static_cast<int>(i)))
            return true;
        return Refuse(refusal, name, "the list cannot shrink (out of memory)", field);
    }
    std::string held;
    for (const config::IpEntry& listed : entries)
        held += (held.empty() ? "" : ", ") + Utf8FromCp932(config::AddressText(listed));
    return Refuse(refusal, name,
                  Utf8FromCp932(config::AddressText(entry)) + " is not in the list (" +
                      (held.empty() ? "it is empty" : "it holds " + held) + ")",
                  field);
}

bool ChangeValue(config::CSaveConfig& record, const config::FieldAt& at,
                 const SettingChange& change, std::string* refusal)
{
    const config::FieldDescription& field = *at.field;
    const std::string& name = change.name;
    if (change.operation != Operation::Set)
        return Refuse(refusal, name, "+= and -= are for the address lists", field);
    if (field.kind == FieldKind::Text)
    {
        if (change.hasNumber)
            return Refuse(refusal, name, "a number where a text belongs", field);
        std::string cp932;
        if (!ToCp932(change.text, &cp932, name, field, refusal))
            return false;
        if (!config::FitsText(field, cp932))
            return Refuse(refusal, name,
                          Quoted(change.text) + " is " + std::to_string(cp932.size()) +
                              " bytes in code page 932",
                          field);
        config::WriteText(record, at, cp932);
        return true;
    }
    std::int64_t value = change.number;
    if (change.hasNumber)
    {
        if (!config::IsAllowed(field, value))
            return Refuse(refusal, name, std::to_string(value) + " is not allowed", field);
    }
    else
    {
        std::string cp932;
        if (!ToCp932(change.text, &cp932, name, field, refusal))
            return false;
        if (!config::ParseValue(at, cp932, &value))
            return Refuse(refusal, name, Quoted(change.text) + " is not allowed", field);
    }
    // What show prints of an element no page changes comes back unchanged.
    const std::int64_t present = config::ReadNumber(record, at);
    if (!config::IsOffered(at) && value != present)
        return Refuse(refusal, name,
                      "no page changes this one: it stays " + std::to_string(present), field);
    config::WriteNumber(record, at, value);
    return true;
}

// The key pages never leave one key or button on two actions: a code given
// here must not stay on another action (give both to exchange them).
bool CheckCodesStayApart(const config::CSaveConfig& record,
                         const std::vector<config::FieldAt>& changed, std::string* refusal)
{
    for (const config::FieldAt& at : changed)
    {
        const int last = config::IndexCount(*at.field) - 1;
        config::FieldAt other = at;
        for (other.index[last] = 0; other.index[last] < at.field->counts[last]; ++other.index[last])
        {
            if (other.index[last] == at.index[last] ||
                config::ReadNumber(record, other) != config::ReadNumber(record, at))
                continue;
            const std::int64_t code = config::ReadNumber(record, at);
            *refusal = config::FieldName(at) + " (" +
                       Utf8FromCp932(config::ValueMeaning(at, code)) + ") and " +
                       config::FieldName(other) + " (" +
                       Utf8FromCp932(config::ValueMeaning(other, code)) +
                       ") would have the same code, " + std::to_string(code) +
                       "; the key pages never give one code to two actions: give the other a "
                       "new code as well to exchange them" +
                       Allowed(*at.field);
            return false;
        }
    }
    return true;
}

bool Leaf(const Json& value, const std::string& name, const config::FieldDescription& field,
          std::vector<SettingChange>* changes, std::string* refusal)
{
    const Json* given = &value;
    if (value.is_object())
    {
        const auto found = value.find("value");
        given = found != value.end() ? &*found : nullptr;
        for (const auto& [member, ignored] : value.items())
        {
            if (member != "value" && member != "meaning")
                given = nullptr;
        }
        if (given == nullptr)
            return Refuse(refusal, name, "an object of a value holds \"value\" and \"meaning\"",
                          field);
    }
    SettingChange change;
    change.name = name;
    if (config::IsListKind(field.kind))
    {
        if (!given->is_array())
            return Refuse(refusal, name, "a list of addresses expected", field);
        change.operation = Operation::ReplaceList;
        for (const Json& item : *given)
        {
            const Json* address = &item;
            if (item.is_object())
            {
                const auto found = item.find("value");
                address = found != item.end() ? &*found : nullptr;
            }
            if (address == nullptr || !address->is_string())
                return Refuse(refusal, name, "an address is a text", field);
            change.items.push_back(address->get<std::string>());
        }
    }
    else if (given->is_string())
    {
        change.text = given->get<std::string>();
    }
    else if (given->is_number() && config::IsNumberKind(field.kind))
    {
        if (given->is_number_float())
            return Refuse(refusal, name, given->dump() + " is not a whole number", field);
        // Beyond the signed range is beyond every field's range too.
        change.hasNumber = true;
        change.number =
            given->is_number_unsigned() && given->get<std::uint64_t>() > std::uint64_t(INT64_MAX)
                ? INT64_MAX
                : given->get<std::int64_t>();
    }
    else
    {
        return Refuse(refusal, name,
                      config::IsNumberKind(field.kind) ? "a number or a text expected"
                                                       : "a text expected",
                      field);
    }
    changes->push_back(std::move(change));
    return true;
}

bool Walk(const Json& value, const std::string& path, std::vector<SettingChange>* changes,
          std::string* refusal)
{
    if (!path.empty())
    {
        config::FieldAt at;
        std::string reason;
        if (config::FindField(path, &at, &reason))
            return Leaf(value, path, *at.field, changes, refusal);
        if (!config::IsFieldGroup(path))
        {
            *refusal = reason;
            return false;
        }
    }
    if (value.is_object())
    {
        for (const auto& [member, item] : value.items())
        {
            if (path.empty() && (member == "file" || member == "version"))
                continue;
            if (!Walk(item, path.empty() ? member : path + "." + member, changes, refusal))
                return false;
        }
        return true;
    }
    if (value.is_array() && !path.empty())
    {
        for (std::size_t i = 0; i < value.size(); ++i)
        {
            if (!Walk(value[i], path + "[" + std::to_string(i) + "]", changes, refusal))
                return false;
        }
        return true;
    }
    *refusal = path.empty() ? "the settings are not a JSON object"
                            : path + ": a group of settings, not one value";
    return false;
}

bool ApplyInOrder(config::CSaveConfig& record, const std::vector<SettingChange>& changes,
                  std::string* refusal)
{
    std::vector<config::FieldAt> codes;
    for (const SettingChange& change : changes)
    {
        config::FieldAt at;
        if (!config::FindField(change.name, &at, refusal))
            return false;
        const bool changed = config::IsListKind(at.field->kind)
                                 ? ChangeList(record, *at.field, change, refusal)
                                 : ChangeValue(record, at, change, refusal);
        if (!changed)
            return false;
        if (at.field->kind == FieldKind::KeyCode || at.field->kind == FieldKind::PadButton)
            codes.push_back(at);
    }
    return CheckCodesStayApart(record, codes, refusal);
}

} // namespace

bool ReadAssignment(const std::string& argument, SettingChange* change)
{
    const std::size_t equals = argument.find('=');
    if (equals == std::string::npos || equals == 0)
        return false;
    std::size_t nameEnd = equals;
    change->operation = Operation::Set;
    if (argument[equals - 1] == '+' || argument[equals - 1] == '-')
    {
        change->operation = argument[equals - 1] == '+' ? Operation::Add : Operation::Remove;
        --nameEnd;
    }
    change->name = argument.substr(0, nameEnd);
    change->text = argument.substr(equals + 1);
    change->hasNumber = false;
    return true;
}

bool ChangesFromJson(const Json& root, std::vector<SettingChange>* changes, std::string* refusal)
{
    return Walk(root, "", changes, refusal);
}

bool ApplyChanges(config::CSaveConfig& record, const std::vector<SettingChange>& changes,
                  std::string* refusal)
{
    // The record is changed in place; a refusal puts back its image.
    const std::vector<std::uint8_t> before = record.SaveToBytes();
    if (ApplyInOrder(record, changes, refusal))
        return true;
    record.LoadFromBytes(before.data(), before.size());
    return false;
}

} // namespace cli
