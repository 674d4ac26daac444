// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What the request handlers of all four providers share: their marks, the reading of a key and
// the handing over of results.

#pragma once

#include "diagnostics/TracedOperation.h"

#include <cmpidt.h>

#include <atomic>
#include <cstdint>
#include <vector>

namespace Vorn::SensorProfileProvider {

// A module's broker. Its factories write it while requests may run already: an object manager
// makes an association MI when it is first asked for associations. A request reads it once.
using ModuleBroker = std::atomic<const CMPIBroker*>;

// The trace points of one handler.
class HandlerMarks {
public:
    HandlerMarks(const TraceModule& module, const char* function)
        : module_(module), function_(function)
    {
    }

    // A line that is not given is the caller's.
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

// How many keys the request's path has, 0 when it cannot say.
CMPICount keyCountOf(const CMPIObjectPath* ref, CMPIStatus* status);

// The key's string, or null when it is absent: not there, null, of another type, or without a
// handle. Some object managers report an absent key through the status; it is OK afterwards.
CMPIString* textKey(const CMPIObjectPath* ref, const char* name, CMPIStatus* status);

// Visits as many elements as a count cut to 16 bits says. A factory holds fewer than 65,536 objects
// of a class, so only what comes from pairs or from other providers can be more.
template <typename Object, typename Visit>
void forEachCounted(const std::vector<Object*>& objects, const Visit& visit)
{
    const auto count = static_cast<std::uint16_t>(objects.size());
    for (std::uint16_t i = 0; i < count; ++i)
        visit(objects.at(i));
}

// Hands over the instances in order, null ones included.
void returnInstances(const CMPIResult* rslt, const std::vector<CMPIInstance*>& instances);

// Hands over the paths in order, each with the namespace of the request.
void returnPaths(const CMPIResult* rslt, const CMPIObjectPath* ref,
    const std::vector<CMPIObjectPath*>& paths, CMPIStatus* status);

// Hands over the first instance whose object path names the same instance as the request's path,
// if there is one among as many as a count cut to 16 bits says. `status` goes to the broker and
// may be null.
void returnInstanceAt(const CMPIResult* rslt, const CMPIObjectPath* ref,
    const std::vector<CMPIInstance*>& instances, bool comparesReferences, CMPIStatus* status);

} // namespace Vorn::SensorProfileProvider
