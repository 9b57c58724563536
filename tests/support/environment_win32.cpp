#include "base/win32.h"
#include "tests/support/environment.h"

#include <cstdlib>

namespace testing_support
{

void SetEnvironment(const char* name, const char* value)
{
    ::_putenv_s(name, value);
    ::SetEnvironmentVariableA(name, value);
}

void ClearEnvironment(const char* name)
{
    ::_putenv_s(name, "");
    ::SetEnvironmentVariableA(name, nullptr);
}

} // namespace testing_support
