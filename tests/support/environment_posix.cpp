#include "tests/support/environment.h"

#include <cstdlib>

namespace testing_support
{

void SetEnvironment(const char* name, const char* value)
{
    value != nullptr ? ::setenv(name, value, 1) : ::unsetenv(name);
}

} // namespace testing_support
