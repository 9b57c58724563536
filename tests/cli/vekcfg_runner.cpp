#include "tests/cli/vekcfg_runner.h"

namespace cli_testing
{

std::string Utf8(const char8_t* text)
{
    return reinterpret_cast<const char*>(text);
}

} // namespace cli_testing
