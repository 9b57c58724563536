#include "cli/json.h"

#include <new>
#include <unordered_set>
#include <vector>

namespace cli
{
namespace
{

// Thrown from the parser's callback, which can only keep or drop a value.
struct Refusal
{
    std::string reason;
};

} // namespace

bool ReadJson(std::string_view text, Json* value, std::string* error)
{
    if (text.size() > kMaxJsonBytes)
    {
        *error = "it is larger than " + std::to_string(kMaxJsonBytes >> 20) + " MiB";
        return false;
    }
    // The member names of each object being read, innermost last.
    std::vector<std::unordered_set<std::string>> names;
    int depth = 0;
    const auto check = [&](int, Json::parse_event_t event, Json& parsed)
    {
        switch (event)
        {
        case Json::parse_event_t::object_start:
        case Json::parse_event_t::array_start:
            if (++depth > kMaxJsonDepth)
                throw Refusal{"nested deeper than " + std::to_string(kMaxJsonDepth) +
                              " levels, deeper than any settings tree"};
            if (event == Json::parse_event_t::object_start)
                names.emplace_back();
            break;
        case Json::parse_event_t::object_end:
            names.pop_back();
            --depth;
            break;
        case Json::parse_event_t::array_end:
            --depth;
            break;
        case Json::parse_event_t::key:
            if (!names.back().insert(parsed.get<std::string>()).second)
                throw Refusal{"the member \"" + parsed.get<std::string>() + "\" is given twice"};
            break;
        case Json::parse_event_t::value:
            break;
        }
        return true;
    };
    try
    {
        *value = Json::parse(text.begin(), text.end(), check);
        return true;
    }
    catch (const Refusal& refusal)
    {
        *error = refusal.reason;
    }
    // A syntax error, or a number beyond a double (out_of_range).
    catch (const Json::exception& exception)
    {
        // "[json.exception.parse_error.101] parse error at line 1, column 3: ...;
        // last read: '...'", without the bytes read, which need not be text.
        std::string what = exception.what();
        const std::size_t start = what.find("] ");
        what = start == std::string::npos ? what : what.substr(start + 2);
        if (what.starts_with("parse error at "))
            what = what.substr(std::string_view("parse error at ").size());
        *error = what.substr(0, what.find("; last read:"));
    }
    catch (const std::bad_alloc&)
    {
        *error = "out of memory for its values";
    }
    return false;
}

std::string WriteJson(const Json& value)
{
    return value.dump(2, ' ', true, Json::error_handler_t::replace);
}

} // namespace cli
