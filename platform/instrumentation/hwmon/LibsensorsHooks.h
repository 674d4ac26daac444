// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <string>
#include <vector>

namespace Vorn::Hwmon {

// Keeps libsensors from printing and from ending the process. It reports through global function
// pointers; by default they print to standard error, and the one for fatal errors calls exit(). An
// object replaces them during its lifetime and then restores them.
//
// The fatal error is a lack of memory. Its hook must not return, so it throws std::bad_alloc
// through libsensors, which holds no locks and whose unwind tables let exceptions pass; what
// the interrupted function had allocated is lost.
class LibsensorsHooks {
public:
    LibsensorsHooks();
    ~LibsensorsHooks();
    LibsensorsHooks(const LibsensorsHooks&) = delete;
    LibsensorsHooks& operator=(const LibsensorsHooks&) = delete;

    struct ParseError {
        std::string text;
        int line; // 0 when the error has no line
    };

    // Collects the errors in the configuration during its lifetime. REQUIRES: only one object
    // exists at a time in the process.
    class ParseErrors {
    public:
        ParseErrors();
        ~ParseErrors();
        ParseErrors(const ParseErrors&) = delete;
        ParseErrors& operator=(const ParseErrors&) = delete;

        const std::vector<ParseError>& list() const { return list_; }

    private:
        std::vector<ParseError> list_;
    };

private:
    void (*parseError_)(const char*, const char*, int);
    void (*fatalError_)(const char*, const char*);
};

} // namespace Vorn::Hwmon
