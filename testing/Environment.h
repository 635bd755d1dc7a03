/// \file
/// Help for tests of what depends on the environment.
#ifndef TESTING_ENVIRONMENT_H
#define TESTING_ENVIRONMENT_H

#include <cstdlib>
#include <optional>
#include <string>

namespace Testing {

/// Sets an environment variable, or unsets it, until the object goes.
class Environment
{
public:
    Environment(const char* name, const std::optional<std::string>& value) : name_(name)
    {
        if (const char* const before = std::getenv(name))
            before_ = before;
        set(value);
    }
    ~Environment() { set(before_); }
    Environment(const Environment&) = delete;
    Environment& operator=(const Environment&) = delete;

    void set(const std::optional<std::string>& value) const
    {
        if (value)
            setenv(name_, value->c_str(), 1);
        else
            unsetenv(name_);
    }

private:
    const char* name_;
    std::optional<std::string> before_;
};

} // namespace Testing

#endif
