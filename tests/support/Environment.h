// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Sets an environment variable during its lifetime. REQUIRES: no other thread runs.

#pragma once

#include <cstdlib>
#include <optional>
#include <string>

namespace Testing {

class EnvironmentVariable {
public:
    EnvironmentVariable(std::string name, const std::string& value) : name_(std::move(name))
    {
        if (const char* const before = std::getenv(name_.c_str()))
            before_ = before;
        ::setenv(name_.c_str(), value.c_str(), 1);
    }
    ~EnvironmentVariable()
    {
        if (before_)
            ::setenv(name_.c_str(), before_->c_str(), 1);
        else
            ::unsetenv(name_.c_str());
    }
    EnvironmentVariable(const EnvironmentVariable&) = delete;
    EnvironmentVariable& operator=(const EnvironmentVariable&) = delete;

private:
    std::string name_;
    std::optional<std::string> before_;
};

} // namespace Testing
