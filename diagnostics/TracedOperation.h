// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The trace points of one function: its entering and exiting lines and its failures.

#pragma once

#include "diagnostics/Trace.h"

#include <string>
#include <utility>

namespace Vorn {

// The module whose name and component its trace lines carry.
struct TraceModule {
    const std::string& component;
    const char* file;
};

// The line numbers of an operation's entering and exiting lines, where these are fixed.
struct OperationLines {
    unsigned entry;
    unsigned exit;
};

// Labels and values one after the other, as a parameter list prints them.
template <typename... LabelsAndValues>
std::string parameterList(const LabelsAndValues&... items)
{
    RynLog::RynMessageBuffer buffer;
    (buffer << ... << items);
    return buffer.str();
}

// Writes a failure's message line.
inline void traceMessage(
    const TraceModule& module, const char* function, unsigned line, const char* text)
{
    emit({function, module.file, line}, module.component, failureLevel,
        [&] { return trace(text, module.file, line, Message); });
}

// Entering and exiting lines of an operation whose arguments are traced. `Parameters` returns
// the parameter list and is called only when a line is wanted.
template <typename Parameters>
class TracedOperation {
public:
    TracedOperation(const TraceModule& module, const char* function, Parameters parameters)
        : module_(module), function_(function), parameters_(std::move(parameters))
    {
    }

    void entering(unsigned line = __builtin_LINE()) const { mark(Entering, line); }
    void exiting(unsigned line = __builtin_LINE()) const { mark(Exiting, line); }

private:
    void mark(MessageType type, unsigned line) const
    {
        emit({function_, module_.file, line}, module_.component, markWithParametersLevel,
            [&] { return tracepara(function_, module_.file, line, parameters_().c_str(), type); });
    }

    TraceModule module_;
    const char* function_;
    Parameters parameters_;
};

// The same for an operation without traced arguments.
class PlainTracedOperation {
public:
    PlainTracedOperation(const TraceModule& module, const char* function)
        : module_(module), function_(function)
    {
    }

    void entering(unsigned line = __builtin_LINE()) const { mark(Entering, line); }
    void exiting(unsigned line = __builtin_LINE()) const { mark(Exiting, line); }

private:
    void mark(MessageType type, unsigned line) const
    {
        emit({function_, module_.file, line}, module_.component, markLevel,
            [&] { return trace(function_, module_.file, line, type); });
    }

    TraceModule module_;
    const char* function_;
};

} // namespace Vorn
