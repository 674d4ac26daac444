// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Functions that the handlers of all four providers share: marks, keys and results.

#pragma once

#include "diagnostics/TracedOperation.h"

#include <cmpidt.h>

#include <atomic>
#include <cstdint>
#include <vector>

namespace Vorn::SensorProfileProvider {

// The broker of a module. It is atomic since a factory may write it while requests run: an object
// manager creates an association MI at the first request for associations.
using ModuleBroker = std::atomic<const CMPIBroker*>;

// Writes the trace points of one handler.
class HandlerMarks {
public:
    HandlerMarks(const TraceModule& module, const char* function)
        : module_(module), function_(function)
    {
    }

    // A line number that is not given is that of the call.
    void entry(unsigned line = __builtin_LINE()) const
    {
        markProviderEntry(module_.component, function_, module_.file, line);
    }

    void failure(const char* text, unsigned line = __builtin_LINE()) const
    {
        traceMessage(module_, function_, line, text);
    }

    void exit(unsigned line = __builtin_LINE()) const
    {
        markProviderExit(module_.component, function_, module_.file, line);
    }

private:
    TraceModule module_;
    const char* function_;
};

inline constexpr const char* noKeyPassed = "At least one key should be passed";

// In the functions below, `status` is passed on to the broker and, except in textKey(), may be
// null.

// Returns the number of keys of the request's path, 0 when the path is not usable.
CMPICount keyCountOf(const CMPIObjectPath* ref, CMPIStatus* status);

// Returns the string of a key, or null when it is absent: missing, null, of another type, or
// without a handle. Some object managers report a missing key through the status, which is then
// reset to OK.
CMPIString* textKey(const CMPIObjectPath* ref, const char* name, CMPIStatus* status);

// Visits as many elements as their count truncated to 16 bits. Only lists of pairs or of objects of
// other providers can be longer: a factory has fewer than 65,536 objects of a class.
template <typename Object, typename Visit>
void forEachCounted(const std::vector<Object*>& objects, const Visit& visit)
{
    const auto count = static_cast<std::uint16_t>(objects.size());
    for (std::uint16_t i = 0; i < count; ++i)
        visit(objects.at(i));
}

// Returns the instances to the object manager in order, also null ones.
void returnInstances(const CMPIResult* rslt, const std::vector<CMPIInstance*>& instances);

// Returns the paths to the object manager in order, each with the namespace of the request.
void returnPaths(const CMPIResult* rslt, const CMPIObjectPath* ref,
    const std::vector<CMPIObjectPath*>& paths, CMPIStatus* status);

// Returns the first instance whose object path equals the request's to the object manager, if it is
// within the count truncated to 16 bits.
void returnInstanceAt(const CMPIResult* rslt, const CMPIObjectPath* ref,
    const std::vector<CMPIInstance*>& instances, bool comparesReferences, CMPIStatus* status);

} // namespace Vorn::SensorProfileProvider
