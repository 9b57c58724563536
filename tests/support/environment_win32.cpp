#include "base/win32.h"
#include "tests/support/environment.h"

#include <cstdlib>

namespace testing_support
{

// The C runtime keeps its own copy of the environment beside the process's.
void SetEnvironment(const char* name, const char* value)
{
    ::_putenv_s(name, value != nullptr ? value : "");
    ::SetEnvironmentVariableA(name, value);
}

} // namespace testing_support
