/// \file
/// An environment variable that is set or taken away for a while, then put back.
#pragma once

#include <cstdlib>
#include <ctime>
#include <optional>
#include <string>

namespace Support {

class EnvironmentVariable {
public:
    /// \param value null takes the variable away.
    EnvironmentVariable(const char* name, const char* value) : name_(name) {
        if (const char* present = std::getenv(name)) {
            former_ = present;
        }
        Set(value);
    }
    EnvironmentVariable(const EnvironmentVariable&) = delete;
    EnvironmentVariable& operator=(const EnvironmentVariable&) = delete;
    ~EnvironmentVariable() { Set(former_ ? former_->c_str() : nullptr); }

private:
    void Set(const char* value) {
        if (value == nullptr) {
            unsetenv(name_.c_str());
        } else {
            setenv(name_.c_str(), value, 1);
        }
        tzset();
    }

    std::string name_;
    std::optional<std::string> former_;
};

} // namespace Support
