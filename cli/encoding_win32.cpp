// Windows: the code pages through UTF-16; the console's own code page for
// what is printed.
#include "base/win32.h"
#include "cli/encoding.h"

#include <vector>

namespace cli
{
namespace
{

std::wstring Wide(std::string_view text, UINT codePage)
{
    if (text.empty())
        return std::wstring();
    const int length =
        MultiByteToWideChar(codePage, 0, text.data(), static_cast<int>(text.size()), nullptr, 0);
    std::wstring wide(static_cast<std::size_t>(length > 0 ? length : 0), L'\0');
    if (length > 0)
        MultiByteToWideChar(codePage, 0, text.data(), static_cast<int>(text.size()), wide.data(),
                            length);
    return wide;
}

// Never a near match: a character the code page lacks becomes its default
// character, '?'.
std::string Narrow(const std::wstring& wide, UINT codePage)
{
    if (wide.empty())
        return std::string();
    const DWORD flags = codePage == CP_UTF8 ? 0 : WC_NO_BEST_FIT_CHARS;
    const int length = WideCharToMultiByte(
        codePage, flags, wide.data(), static_cast<int>(wide.size()), nullptr, 0, nullptr, nullptr);
    std::string narrow(static_cast<std::size_t>(length > 0 ? length : 0), '\0');
    if (length > 0)
        WideCharToMultiByte(codePage, flags, wide.data(), static_cast<int>(wide.size()),
                            narrow.data(), length, nullptr, nullptr);
    return narrow;
}

} // namespace

std::string Utf8FromCp932(std::string_view text)
{
    // Character by character, for the same replacement as on Linux: one
    // U+FFFD per unmapped character.
    std::string converted;
    converted.reserve(text.size() * 3 / 2);
    for (std::size_t size; (size = Cp932CharacterSize(text)) != 0; text.remove_prefix(size))
    {
        const std::string_view character = text.substr(0, size);
        const int length = MultiByteToWideChar(932, MB_ERR_INVALID_CHARS, character.data(),
                                               static_cast<int>(size), nullptr, 0);
        if (length <= 0)
            converted += "\xEF\xBF\xBD";
        else
            converted += Narrow(Wide(character, 932), CP_UTF8);
    }
    return converted;
}

namespace
{

// Refuses what the code page cannot hold instead of a near match or '?'.
bool StrictlyFromUtf8(std::string_view utf8, UINT codePage, std::string* out)
{
    if (utf8.empty())
    {
        out->clear();
        return true;
    }
    const int length = MultiByteToWideChar(CP_UTF8, MB_ERR_INVALID_CHARS, utf8.data(),
                                           static_cast<int>(utf8.size()), nullptr, 0);
    if (length <= 0)
        return false;
    std::wstring wide(static_cast<std::size_t>(length), L'\0');
    MultiByteToWideChar(CP_UTF8, 0, utf8.data(), static_cast<int>(utf8.size()), wide.data(),
                        length);
    if (codePage == CP_UTF8)
    {
        *out = std::string(utf8);
        return true;
    }
    BOOL replaced = FALSE;
    const int bytes = WideCharToMultiByte(codePage, WC_NO_BEST_FIT_CHARS, wide.data(), length,
                                          nullptr, 0, nullptr, &replaced);
    if (bytes <= 0 || replaced)
        return false;
    std::string converted(static_cast<std::size_t>(bytes), '\0');
    WideCharToMultiByte(codePage, WC_NO_BEST_FIT_CHARS, wide.data(), length, converted.data(),
                        bytes, nullptr, &replaced);
    if (replaced)
        return false;
    *out = std::move(converted);
    return true;
}

} // namespace

bool Cp932FromUtf8(std::string_view utf8, std::string* cp932)
{
    return StrictlyFromUtf8(utf8, 932, cp932);
}

bool NativeFromUtf8(std::string_view utf8, std::string* native)
{
    return StrictlyFromUtf8(utf8, GetACP(), native);
}

std::string Utf8FromNative(std::string_view text)
{
    return Narrow(Wide(text, CP_ACP), CP_UTF8);
}

bool WriteConsoleText(std::FILE* stream, std::string_view utf8)
{
    // Without a console (output to a file from a detached process) the
    // ANSI code page stands in for it.
    UINT codePage = GetConsoleOutputCP();
    if (codePage == 0)
        codePage = GetACP();
    const std::string bytes =
        codePage == CP_UTF8 ? std::string(utf8) : Narrow(Wide(utf8, CP_UTF8), codePage);
    const bool written = std::fwrite(bytes.data(), 1, bytes.size(), stream) == bytes.size();
    return std::fflush(stream) == 0 && written;
}

} // namespace cli
