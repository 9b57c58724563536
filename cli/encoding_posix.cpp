// Linux: iconv for code page 932; the command line and the terminal are
// taken to be UTF-8.
#include "cli/encoding.h"

#include <cerrno>
#include <iconv.h>

namespace cli
{
namespace
{

constexpr char kReplacement[] = "\xEF\xBF\xBD";

} // namespace

std::string Utf8FromCp932(std::string_view text)
{
    std::string converted;
    converted.reserve(text.size() * 3 / 2);
    iconv_t converter = iconv_open("UTF-8", "CP932");
    if (converter == reinterpret_cast<iconv_t>(-1))
    {
        // Without the code page only ASCII can be trusted.
        for (std::size_t size; (size = Cp932CharacterSize(text)) != 0; text.remove_prefix(size))
        {
            if (size == 1 && static_cast<unsigned char>(text[0]) < 0x80)
                converted += text[0];
            else
                converted += kReplacement;
        }
        return converted;
    }
    // One character at a time: iconv's own error recovery cannot tell how
    // many bytes an unmapped character spans.
    while (!text.empty())
    {
        const std::size_t size = Cp932CharacterSize(text);
        char* in = const_cast<char*>(text.data());
        std::size_t inLeft = size;
        char out[8];
        char* outNext = out;
        std::size_t outLeft = sizeof out;
        if (iconv(converter, &in, &inLeft, &outNext, &outLeft) == static_cast<std::size_t>(-1))
        {
            iconv(converter, nullptr, nullptr, nullptr, nullptr);
            converted += kReplacement;
        }
        else
        {
            converted.append(out, static_cast<std::size_t>(outNext - out));
        }
        text.remove_prefix(size);
    }
    iconv_close(converter);
    return converted;
}

bool Cp932FromUtf8(std::string_view utf8, std::string* cp932)
{
    iconv_t converter = iconv_open("CP932", "UTF-8");
    if (converter == reinterpret_cast<iconv_t>(-1))
        return false;
    std::string converted(utf8.size() * 2 + 1, '\0');
    char* in = const_cast<char*>(utf8.data());
    std::size_t inLeft = utf8.size();
    char* out = converted.data();
    std::size_t outLeft = converted.size();
    // Two bytes at most for each character of one byte or more: room enough.
    const bool done =
        iconv(converter, &in, &inLeft, &out, &outLeft) != static_cast<std::size_t>(-1) &&
        inLeft == 0;
    iconv_close(converter);
    if (!done)
        return false;
    converted.resize(converted.size() - outLeft);
    // iconv maps some characters one way only (U+301C, U+00A5 and others to
    // forms of other characters), where Windows, asked for no near match,
    // refuses them: only what converts back unchanged is taken.
    if (Utf8FromCp932(converted) != utf8)
        return false;
    *cp932 = std::move(converted);
    return true;
}

bool NativeFromUtf8(std::string_view utf8, std::string* native)
{
    *native = std::string(utf8);
    return true;
}

std::string Utf8FromNative(std::string_view text)
{
    return std::string(text);
}

bool WriteConsoleText(std::FILE* stream, std::string_view utf8)
{
    const bool written = std::fwrite(utf8.data(), 1, utf8.size(), stream) == utf8.size();
    return std::fflush(stream) == 0 && written;
}

} // namespace cli
