// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/support/BrokerCall.h"

#include <array>

namespace Testing {

namespace {

constexpr std::array callNames = {"newObjectPath", "newInstance", "newString", "newArray", "trace",
    "enumerateInstanceNames", "enumerateInstances", "getInstance", "getCharPtr", "setElementAt",
    "getNameSpace", "getClassName", "getHostname", "setNameSpace", "setHostname", "addKey",
    "getKey", "getKeyAt", "getKeyCount", "setProperty", "setPropertyFilter", "getProperty",
    "getObjectPath", "hasNext", "getNext", "returnInstance", "returnObjectPath", "returnDone"};
static_assert(callNames.size() == brokerCallCount);

} // namespace

std::span<const BrokerCall> allBrokerCalls()
{
    static const auto all = [] {
        std::array<BrokerCall, brokerCallCount> calls{};
        for (std::size_t i = 0; i < calls.size(); ++i)
            calls[i] = static_cast<BrokerCall>(i);
        return calls;
    }();
    return all;
}

std::string nameOf(BrokerCall call)
{
    return callNames[static_cast<std::size_t>(call)];
}

std::span<const FaultManner> mannersOf(BrokerCall call)
{
    static constexpr std::array object = {
        FaultManner::nullResult, FaultManner::handleless, FaultManner::errorStatus};
    static constexpr std::array plain = {FaultManner::nullResult, FaultManner::errorStatus};
    static constexpr std::array status = {FaultManner::errorStatus};
    static constexpr std::array keyed = {FaultManner::errorStatus, FaultManner::lostHandle};
    switch (call) {
    case BrokerCall::getCharPtr:
    case BrokerCall::getKeyCount:
    case BrokerCall::hasNext:
        return plain;
    case BrokerCall::trace:
    case BrokerCall::setElementAt:
    case BrokerCall::setNameSpace:
    case BrokerCall::setHostname:
    case BrokerCall::setProperty:
    case BrokerCall::setPropertyFilter:
    case BrokerCall::returnInstance:
    case BrokerCall::returnObjectPath:
    case BrokerCall::returnDone:
        return status;
    case BrokerCall::addKey:
        return keyed;
    default:
        return object;
    }
}

std::string nameOf(FaultManner manner)
{
    switch (manner) {
    case FaultManner::nullResult:
        return "nullResult";
    case FaultManner::handleless:
        return "handleless";
    case FaultManner::lostHandle:
        return "lostHandle";
    default:
        return "errorStatus";
    }
}

} // namespace Testing
