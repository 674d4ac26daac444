// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The trace points of one operation: its entering and exiting lines and its failures.

#pragma once

#include "diagnostics/Trace.h"

#include <string>
#include <type_traits>
#include <utility>

namespace Vorn {

// The module that trace lines name, and its logger component.
struct TraceModule {
    const std::string& component;
    const char* file;
};

// The line numbers of an operation's entering and exiting lines, where these are fixed.
struct OperationLines {
    unsigned entry;
    unsigned exit;
};

// Returns the labels and values, each printed as by a stream, in one text.
template <typename... LabelsAndValues>
std::string parameterList(const LabelsAndValues&... items)
{
    RynLog::RynMessageBuffer buffer;
    (buffer << ... << items);
    return buffer.str();
}

// Writes the message line of a failure.
inline void traceMessage(
    const TraceModule& module, const char* function, unsigned line, const char* text)
{
    emit({function, module.file, line}, module.component, failureLevel,
        [&] { return trace(text, module.file, line, Message); });
}

struct NoParameters {};

// Writes the entering and exiting lines of an operation. `Parameters` returns the parameter list
// and is called only when a line is wanted; without it the lines have none.
template <typename Parameters = NoParameters>
class TracedOperation {
public:
    TracedOperation(const TraceModule& module, const char* function, Parameters parameters = {})
        : module_(module), function_(function), parameters_(std::move(parameters))
    {
    }

    // A line number that is not given is that of the call.
    void entering(unsigned line = __builtin_LINE()) const { mark(Entering, line); }
    void exiting(unsigned line = __builtin_LINE()) const { mark(Exiting, line); }

private:
    void mark(MessageType type, unsigned line) const
    {
        const TraceLocation at = {function_, module_.file, line};
        if constexpr (std::is_same_v<Parameters, NoParameters>)
            emit(at, module_.component, markLevel,
                [&] { return trace(function_, module_.file, line, type); });
        else
            emit(at, module_.component, markWithParametersLevel, [&] {
                return tracepara(function_, module_.file, line, parameters_().c_str(), type);
            });
    }

    TraceModule module_;
    const char* function_;
    Parameters parameters_;
};

} // namespace Vorn
