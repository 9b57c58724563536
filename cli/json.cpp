#include "cli/json.h"

#include <charconv>
#include <utility>

namespace cli
{
namespace
{

// Deep enough for any settings tree, shallow enough for the stack.
constexpr int kMaxDepth = 64;

class Reader
{
public:
    explicit Reader(std::string_view text) : text_(text) {}

    bool Document(JsonValue* value)
    {
        if (!Value(value, 0))
            return false;
        Blanks();
        return position_ == text_.size() || Fail("more text after the value");
    }

    const std::string& Error() const { return error_; }

private:
    bool Fail(const std::string& what)
    {
        if (!error_.empty())
            return false;
        std::size_t line = 1;
        std::size_t column = 1;
        for (std::size_t i = 0; i < position_ && i < text_.size(); ++i)
        {
            if (text_[i] == '\n')
            {
                ++line;
                column = 1;
            }
            else if ((static_cast<unsigned char>(text_[i]) & 0xC0) != 0x80)
            {
                ++column;
            }
        }
        error_ =
            "line " + std::to_string(line) + ", column " + std::to_string(column) + ": " + what;
        return false;
    }

    bool AtEnd() const { return position_ >= text_.size(); }
    char Peek() const { return AtEnd() ? '\0' : text_[position_]; }

    void Blanks()
    {
        while (!AtEnd() && (Peek() == ' ' || Peek() == '\n' || Peek() == '\r' || Peek() == '\t'))
            ++position_;
    }

    bool Value(JsonValue* value, int depth)
    {
        if (depth > kMaxDepth)
            return Fail("nested too deeply");
        Blanks();
        switch (Peek())
        {
        case '{':
            return Object(value, depth);
        case '[':
            return Array(value, depth);
        case '"':
            value->kind = JsonValue::Kind::String;
            return String(&value->string);
        case 't':
            value->kind = JsonValue::Kind::Boolean;
            value->boolean = true;
            return Word("true");
        case 'f':
            value->kind = JsonValue::Kind::Boolean;
            return Word("false");
        case 'n':
            value->kind = JsonValue::Kind::Null;
            return Word("null");
        default:
            if (Peek() == '-' || (Peek() >= '0' && Peek() <= '9'))
                return Number(value);
            return Fail(AtEnd() ? "the text ends where a value should be" : "a value expected");
        }
    }

    bool Word(std::string_view word)
    {
        if (text_.substr(position_, word.size()) != word)
            return Fail("a value expected");
        position_ += word.size();
        return true;
    }

    bool Digits()
    {
        const std::size_t start = position_;
        while (Peek() >= '0' && Peek() <= '9')
            ++position_;
        return position_ > start;
    }

    bool Number(JsonValue* value)
    {
        const std::size_t start = position_;
        if (Peek() == '-')
            ++position_;
        if (Peek() == '0')
            ++position_;
        else if (!Digits())
            return Fail("a digit expected");
        bool whole = true;
        if (Peek() == '.')
        {
            ++position_;
            whole = false;
            if (!Digits())
                return Fail("a digit expected after the decimal point");
        }
        if (Peek() == 'e' || Peek() == 'E')
        {
            ++position_;
            whole = false;
            if (Peek() == '+' || Peek() == '-')
                ++position_;
            if (!Digits())
                return Fail("a digit expected in the exponent");
        }
        value->kind = JsonValue::Kind::Number;
        value->number = std::string(text_.substr(start, position_ - start));
        if (whole)
        {
            const char* first = text_.data() + start;
            const char* last = text_.data() + position_;
            const auto [end, error] = std::from_chars(first, last, value->integer);
            value->whole = error == std::errc() && end == last;
        }
        return true;
    }

    bool Hex4(std::uint32_t* unit)
    {
        *unit = 0;
        for (int i = 0; i < 4; ++i, ++position_)
        {
            const char c = Peek();
            int digit;
            if (c >= '0' && c <= '9')
                digit = c - '0';
            else if (c >= 'a' && c <= 'f')
                digit = c - 'a' + 10;
            else if (c >= 'A' && c <= 'F')
                digit = c - 'A' + 10;
            else
                return Fail("four hexadecimal digits expected after \\u");
            *unit = *unit * 16 + static_cast<std::uint32_t>(digit);
        }
        return true;
    }

    static void AppendUtf8(std::string* out, std::uint32_t code)
    {
        if (code < 0x80)
        {
            *out += static_cast<char>(code);
        }
        else if (code < 0x800)
        {
            *out += static_cast<char>(0xC0 | (code >> 6));
            *out += static_cast<char>(0x80 | (code & 0x3F));
        }
        else if (code < 0x10000)
        {
            *out += static_cast<char>(0xE0 | (code >> 12));
            *out += static_cast<char>(0x80 | ((code >> 6) & 0x3F));
            *out += static_cast<char>(0x80 | (code & 0x3F));
        }
        else
        {
            *out += static_cast<char>(0xF0 | (code >> 18));
            *out += static_cast<char>(0x80 | ((code >> 12) & 0x3F));
            *out += static_cast<char>(0x80 | ((code >> 6) & 0x3F));
            *out += static_cast<char>(0x80 | (code & 0x3F));
        }
    }

    bool Escape(std::string* out)
    {
        const char c = Peek();
        ++position_;
        switch (c)
        {
        case '"':
        case '\\':
        case '/':
            *out += c;
            return true;
        case 'b':
            *out += '\b';
            return true;
        case 'f':
            *out += '\f';
            return true;
        case 'n':
            *out += '\n';
            return true;
        case 'r':
            *out += '\r';
            return true;
        case 't':
            *out += '\t';
            return true;
        case 'u':
            break;
        default:
            --position_;
            return Fail("an unknown escape");
        }
        std::uint32_t code = 0;
        if (!Hex4(&code))
            return false;
        if (code >= 0xDC00 && code <= 0xDFFF)
            return Fail("a low surrogate without its high one");
        if (code >= 0xD800 && code <= 0xDBFF)
        {
            std::uint32_t low = 0;
            if (text_.substr(position_, 2) != "\\u")
                return Fail("a high surrogate without its low one");
            position_ += 2;
            if (!Hex4(&low))
                return false;
            if (low < 0xDC00 || low > 0xDFFF)
                return Fail("a high surrogate without its low one");
            code = 0x10000 + ((code - 0xD800) << 10) + (low - 0xDC00);
        }
        AppendUtf8(out, code);
        return true;
    }

    bool String(std::string* out)
    {
        ++position_;
        out->clear();
        while (true)
        {
            if (AtEnd())
                return Fail("the text ends inside a string");
            const char c = Peek();
            if (c == '"')
            {
                ++position_;
                return true;
            }
            if (static_cast<unsigned char>(c) < 0x20)
                return Fail("a control character inside a string");
            ++position_;
            if (c != '\\')
                *out += c;
            else if (!Escape(out))
                return false;
        }
    }

    bool Array(JsonValue* value, int depth)
    {
        value->kind = JsonValue::Kind::Array;
        ++position_;
        Blanks();
        if (Peek() == ']')
        {
            ++position_;
            return true;
        }
        while (true)
        {
            value->items.emplace_back();
            if (!Value(&value->items.back(), depth + 1))
                return false;
            Blanks();
            if (Peek() == ']')
            {
                ++position_;
                return true;
            }
            if (Peek() != ',')
                return Fail("',' or ']' expected");
            ++position_;
        }
    }

    bool Object(JsonValue* value, int depth)
    {
        value->kind = JsonValue::Kind::Object;
        ++position_;
        Blanks();
        if (Peek() == '}')
        {
            ++position_;
            return true;
        }
        while (true)
        {
            Blanks();
            if (Peek() != '"')
                return Fail("a member name expected");
            std::string name;
            if (!String(&name))
                return false;
            if (value->Member(name) != nullptr)
                return Fail("the member \"" + name + "\" is given twice");
            Blanks();
            if (Peek() != ':')
                return Fail("':' expected");
            ++position_;
            value->members.push_back(JsonMember{std::move(name), JsonValue()});
            if (!Value(&value->members.back().value, depth + 1))
                return false;
            Blanks();
            if (Peek() == '}')
            {
                ++position_;
                return true;
            }
            if (Peek() != ',')
                return Fail("',' or '}' expected");
            ++position_;
        }
    }

    std::string_view text_;
    std::size_t position_ = 0;
    std::string error_;
};

} // namespace

const JsonValue* JsonValue::Member(std::string_view name) const
{
    for (const auto& [memberName, member] : members)
    {
        if (memberName == name)
            return &member;
    }
    return nullptr;
}

bool ReadJson(std::string_view text, JsonValue* value, std::string* error)
{
    Reader reader(text);
    *value = JsonValue();
    if (reader.Document(value))
        return true;
    *error = reader.Error();
    return false;
}

} // namespace cli
