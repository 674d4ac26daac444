// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Keeps libsensors from printing and from ending the process.

#pragma once

#include <string>
#include <vector>

namespace Vorn::Hwmon {

// libsensors reports through function pointers that whoever uses it shares; by default they
// print to standard error, and the one for fatal errors calls exit(). While an object lives they
// lead here; then those that were there before come back.
//
// The fatal error is a lack of memory. Its hook must not return, so it throws std::bad_alloc
// through libsensors, which holds no locks and whose unwind tables let exceptions pass; what
// the interrupted function had allocated is lost. Ending the process of whoever loaded this
// library would be worse.
class LibsensorsHooks {
public:
    LibsensorsHooks();
    ~LibsensorsHooks();
    LibsensorsHooks(const LibsensorsHooks&) = delete;
    LibsensorsHooks& operator=(const LibsensorsHooks&) = delete;

    struct ParseError {
        std::string text;
        int line; // 0 when it is about no line
    };

    // Collects what is wrong in the configuration while it lives.
    // REQUIRES: one object at a time in the process.
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
