#pragma once

#include <optional>
#include <string>

namespace testing_support
{

// Sets an environment variable for the test's own process and puts the old
// value back at the end of the scope.
class ScopedEnvironment
{
public:
    ScopedEnvironment(const char* name, const char* value);
    ~ScopedEnvironment();
    ScopedEnvironment(const ScopedEnvironment&) = delete;
    ScopedEnvironment& operator=(const ScopedEnvironment&) = delete;

private:
    std::string name_;
    std::optional<std::string> previous_;
};

// A null value removes the variable.
void SetEnvironment(const char* name, const char* value);

} // namespace testing_support
