#include "tests/cli/xml_reader.h"

#include <cctype>

namespace cli_testing
{
namespace
{

bool IsNameStart(char c)
{
    return std::isalpha(static_cast<unsigned char>(c)) || c == '_' || c == ':' ||
           static_cast<unsigned char>(c) >= 0x80;
}

bool IsNameChar(char c)
{
    return IsNameStart(c) || std::isdigit(static_cast<unsigned char>(c)) || c == '-' || c == '.';
}

class Reader
{
public:
    Reader(const std::string& text, std::vector<XmlElement>* elements)
        : text_(text), elements_(elements)
    {
    }

    bool Document(std::string* error)
    {
        if (text_.compare(0, 5, "<?xml") == 0 && !Skip("?>"))
            return Fail(error, "unterminated declaration");
        bool rootSeen = false;
        std::vector<std::string> open;
        while (position_ < text_.size())
        {
            if (text_.compare(position_, 4, "<!--") == 0)
            {
                if (!Skip("-->"))
                    return Fail(error, "unterminated comment");
                continue;
            }
            const char c = text_[position_];
            if (c != '<')
            {
                if (open.empty() && !std::isspace(static_cast<unsigned char>(c)))
                    return Fail(error, "text outside the root element");
                if (!CharacterData('<'))
                    return Fail(error, "bad character data");
                continue;
            }
            ++position_;
            if (Peek() == '/')
            {
                ++position_;
                const std::string name = Name();
                if (open.empty() || name != open.back() || !Take('>'))
                    return Fail(error, "mismatched end tag </" + name + ">");
                open.pop_back();
                continue;
            }
            if (open.empty() && rootSeen)
                return Fail(error, "a second root element");
            XmlElement element;
            element.name = Name();
            if (element.name.empty())
                return Fail(error, "bad element name");
            for (;;)
            {
                const bool blank = Blanks();
                if (Peek() == '/' || Peek() == '>')
                    break;
                const std::string attribute = Name();
                if (!blank || attribute.empty() || element.attributes.count(attribute) != 0 ||
                    !Take('='))
                    return Fail(error, "bad attribute in <" + element.name + ">");
                const char quote = Peek();
                if (quote != '"' && quote != '\'')
                    return Fail(error, "unquoted attribute " + attribute);
                ++position_;
                const std::size_t start = position_;
                if (!CharacterData(quote) || !Take(quote))
                    return Fail(error, "bad attribute value of " + attribute);
                element.attributes[attribute] = text_.substr(start, position_ - 1 - start);
            }
            rootSeen = true;
            const bool empty = Take('/');
            if (!Take('>'))
                return Fail(error, "unterminated tag <" + element.name + ">");
            if (!empty)
                open.push_back(element.name);
            elements_->push_back(std::move(element));
        }
        if (!open.empty())
            return Fail(error, "<" + open.back() + "> is never closed");
        return rootSeen || Fail(error, "no root element");
    }

private:
    static bool Fail(std::string* error, const std::string& why)
    {
        *error = why;
        return false;
    }

    char Peek() const { return position_ < text_.size() ? text_[position_] : '\0'; }

    bool Take(char c)
    {
        if (Peek() != c)
            return false;
        ++position_;
        return true;
    }

    bool Blanks()
    {
        const std::size_t start = position_;
        while (std::isspace(static_cast<unsigned char>(Peek())))
            ++position_;
        return position_ > start;
    }

    bool Skip(const char* end)
    {
        const std::size_t found = text_.find(end, position_);
        if (found == std::string::npos)
            return false;
        position_ = found + std::string(end).size();
        return true;
    }

    std::string Name()
    {
        const std::size_t start = position_;
        if (!IsNameStart(Peek()))
            return std::string();
        while (IsNameChar(Peek()))
            ++position_;
        return text_.substr(start, position_ - start);
    }

    // Text up to `stop`: no markup, no stray "&", no control characters.
    bool CharacterData(char stop)
    {
        while (position_ < text_.size() && text_[position_] != stop)
        {
            const char c = text_[position_];
            if (c == '<' || (static_cast<unsigned char>(c) < 0x20 && !std::isspace(c)))
                return false;
            if (c == '&' && !Reference())
                return false;
            if (c != '&')
                ++position_;
        }
        return true;
    }

    bool Reference()
    {
        const std::size_t end = text_.find(';', position_);
        if (end == std::string::npos)
            return false;
        const std::string name = text_.substr(position_ + 1, end - position_ - 1);
        const bool named =
            name == "amp" || name == "lt" || name == "gt" || name == "quot" || name == "apos";
        bool numeric = name.size() > 1 && name[0] == '#';
        for (std::size_t i = 1; numeric && i < name.size(); ++i)
            numeric =
                std::isxdigit(static_cast<unsigned char>(name[i])) || (i == 1 && name[i] == 'x');
        position_ = end + 1;
        return named || numeric;
    }

    const std::string& text_;
    std::vector<XmlElement>* elements_;
    std::size_t position_ = 0;
};

} // namespace

bool ReadXml(const std::string& text, std::vector<XmlElement>* elements, std::string* error)
{
    elements->clear();
    return Reader(text, elements).Document(error);
}

} // namespace cli_testing
