// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The calls of a broker that can fail, and how.

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
    // Nothing comes back: a null pointer, a null value, 0 or false. The call is not made.
    nullResult,
    // An object comes back whose handle is null; its functions survive that.
    handleless,
    // The call is made and its result comes back, but the status says that it failed. A call
    // that answers with nothing but a status is not made.
    errorStatus,
    // The call is made and succeeds; the object it was made on has no handle afterwards.
    lostHandle,
};

// The manners in which a call can fail at all.
std::span<const FaultManner> mannersOf(BrokerCall call);
std::string nameOf(FaultManner manner);

} // namespace Testing
