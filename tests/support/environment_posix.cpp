#include "tests/support/environment.h"

#include <cstdlib>

namespace testing_support
{

void SetEnvironment(const char* name, const char* value)
{
    ::setenv(name, value, 1);
}

void ClearEnvironment(const char* name)
{
    ::unsetenv(name);
}

} // namespace testing_support
