#include "tests/cli/json_reader.h"

#include <cstdlib>

namespace cli_testing
{
namespace
{

class Reader
{
public:
    explicit Reader(const std::string& text) : text_(text) {}

    bool Document(JsonValue* value)
    {
        return Value(value, 0) && (Blanks(), position_ == text_.size());
    }

private:
    void Blanks()
    {
        while (position_ < text_.size() && (text_[position_] == ' ' || text_[position_] == '\n' ||
                                            text_[position_] == '\r' || text_[position_] == '\t'))
            ++position_;
    }

    bool Take(char c)
    {
        Blanks();
        if (position_ < text_.size() && text_[position_] == c)
        {
            ++position_;
            return true;
        }
        return false;
    }

    bool Word(const char* word)
    {
        const std::string expected(word);
        if (text_.compare(position_, expected.size(), expected) != 0)
            return false;
        position_ += expected.size();
        return true;
    }

    // The escapes vekcfg writes are of control characters only.
    bool ControlEscape(std::string* out)
    {
        if (position_ + 4 > text_.size() || text_.compare(position_, 2, "00") != 0)
            return false;
        char* end = nullptr;
        const std::string digits = text_.substr(position_ + 2, 2);
        *out += char(std::strtoul(digits.c_str(), &end, 16));
        position_ += 4;
        return end == digits.c_str() + 2;
    }

    bool String(std::string* out)
    {
        if (!Take('"'))
            return false;
        while (position_ < text_.size())
        {
            const char c = text_[position_++];
            if (c == '"')
                return true;
            if (static_cast<unsigned char>(c) < 0x20)
                return false;
            if (c != '\\')
            {
                *out += c;
                continue;
            }
            if (position_ >= text_.size())
                return false;
            const char escape = text_[position_++];
            const std::string simple = "\"\\/bfnrt";
            const std::string meant = "\"\\/\b\f\n\r\t";
            if (const std::size_t at = simple.find(escape); at != std::string::npos)
            {
                *out += meant[at];
                continue;
            }
            if (escape != 'u' || !ControlEscape(out))
                return false;
        }
        return false;
    }

    bool Value(JsonValue* value, int depth)
    {
        Blanks();
        if (depth > 64 || position_ >= text_.size())
            return false;
        const char c = text_[position_];
        if (c == '"')
        {
            value->kind = JsonValue::Kind::String;
            return String(&value->string);
        }
        if (c == '[')
        {
            ++position_;
            value->kind = JsonValue::Kind::Array;
            if (Take(']'))
                return true;
            do
            {
                value->items.emplace_back();
                if (!Value(&value->items.back(), depth + 1))
                    return false;
            } while (Take(','));
            return Take(']');
        }
        if (c == '{')
        {
            ++position_;
            value->kind = JsonValue::Kind::Object;
            if (Take('}'))
                return true;
            do
            {
                std::string name;
                Blanks();
                if (!String(&name) || !Take(':'))
                    return false;
                value->members.emplace_back(name, JsonValue());
                if (!Value(&value->members.back().second, depth + 1))
                    return false;
            } while (Take(','));
            return Take('}');
        }
        if (Word("true") || Word("false"))
        {
            value->kind = JsonValue::Kind::Boolean;
            value->boolean = c == 't';
            return true;
        }
        if (Word("null"))
            return true;
        const char* start = text_.c_str() + position_;
        char* end = nullptr;
        value->number = std::strtod(start, &end);
        if (end == start)
            return false;
        value->kind = JsonValue::Kind::Number;
        position_ += std::size_t(end - start);
        return true;
    }

    const std::string& text_;
    std::size_t position_ = 0;
};

} // namespace

const JsonValue* JsonValue::Member(const std::string& name) const
{
    for (const auto& [key, value] : members)
    {
        if (key == name)
            return &value;
    }
    return nullptr;
}

bool ParseJson(const std::string& text, JsonValue* value)
{
    return Reader(text).Document(value);
}

} // namespace cli_testing
