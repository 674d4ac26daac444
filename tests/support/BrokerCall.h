// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The calls of a broker that can fail, and the manners in which they fail.

#pragma once

#include <cstddef>
#include <span>
#include <string>

namespace Testing {

// The slots that can fail, by their names in the tables.
enum class BrokerCall {
    newObjectPath,
    newInstance,
    newString,
    newArray,
    trace,
    enumerateInstanceNames,
    enumerateInstances,
    getInstance,
    getCharPtr,
    setElementAt,
    getNameSpace,
    getClassName,
    getHostname,
    setNameSpace,
    setHostname,
    addKey,
    getKey,
    getKeyAt,
    getKeyCount,
    setProperty,
    setPropertyFilter,
    getProperty,
    getObjectPath,
    hasNext,
    getNext,
    returnInstance,
    returnObjectPath,
    returnDone,
};
inline constexpr std::size_t brokerCallCount = static_cast<std::size_t>(BrokerCall::returnDone) + 1;

std::span<const BrokerCall> allBrokerCalls();
std::string nameOf(BrokerCall call);

enum class FaultManner {
    // The call returns a null pointer, a null value, 0 or false, and has no effect.
    nullResult,
    // The call returns an object whose handle is null, which its functions accept.
    handleless,
    // The call returns its result with a status that reports a failure. A call that returns nothing
    // but a status has no effect.
    errorStatus,
    // The call succeeds; afterwards the object on which it was made has no handle.
    lostHandle,
};

// Returns the manners in which a call can fail.
std::span<const FaultManner> mannersOf(BrokerCall call);
std::string nameOf(FaultManner manner);

} // namespace Testing
