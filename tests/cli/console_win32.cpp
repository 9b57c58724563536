// Windows prints in the console's code page, the Japanese one where the
// tests run (tools/wine-run), with CR LF.
#include "cli/encoding.h"

namespace cli_testing
{
std::string Utf8FromConsole(const std::string& printed)
{
    std::string lines = cli::Utf8FromCp932(printed);
    for (std::size_t crlf; (crlf = lines.find("\r\n")) != std::string::npos;)
        lines.erase(crlf, 1);
    return lines;
}
} // namespace cli_testing
