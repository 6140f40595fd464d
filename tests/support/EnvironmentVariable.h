#pragma once

#include <ctime>

#include <cstdlib>
#include <optional>
#include <string>

namespace ktr::test {

/// Sets an environment variable for as long as it lives.
class EnvironmentVariable {
  public:
    EnvironmentVariable(std::string name, const char* value) : name_(std::move(name)) {
        if (const char* before = std::getenv(name_.c_str())) {
            before_ = before;
        }
        set(value);
    }
    ~EnvironmentVariable() { set(before_ ? before_->c_str() : nullptr); }
    EnvironmentVariable(const EnvironmentVariable&) = delete;
    EnvironmentVariable& operator=(const EnvironmentVariable&) = delete;

  private:
    void set(const char* value) {
        if (value) {
            ::setenv(name_.c_str(), value, 1);
        } else {
            ::unsetenv(name_.c_str());
        }
        ::tzset();
    }

    std::string name_;
    std::optional<std::string> before_;
};

}  // namespace ktr::test
