// Linux prints UTF-8 with LF.
#include <string>

namespace cli_testing
{
std::string Utf8FromConsole(const std::string& printed)
{
    return printed;
}
} // namespace cli_testing
