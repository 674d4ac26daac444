// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/cim/ProviderClient.h"

#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Result.h"

#include <stdexcept>

namespace Tools {

namespace {

constexpr const char* providerName = "SensorProfileProvider";

// Calls the operation with a result and returns what it delivered.
template <typename Operation>
std::vector<const Host::Instance*> instancesFrom(Operation operation)
{
    Host::CollectedResult answer;
    Host::Result result(answer);
    const CMPIStatus status = operation(result.handle());
    if (status.rc != CMPI_RC_OK)
        throw std::runtime_error("the provider answers " + Host::describe(status));
    if (answer.refused() != 0)
        throw std::runtime_error("the provider could not build " +
                                 std::to_string(answer.refused()) + " of the instances");
    return answer.instances();
}

} // namespace

ProviderClient::ProviderClient(const std::string& providerFile) : library_(broker_, providerFile)
{
    classes_.add(
        sensorClass, {"CreationClassName", "DeviceID", "SystemCreationClassName", "SystemName"});
    broker_.setClassInformation(&classes_);
    request_.emplace(broker_, Host::RequestInfo{.nameSpace = nameSpace});
}

CMPIInstanceMI& ProviderClient::sensorMI()
{
    return library_.instanceMI(providerName);
}

std::vector<const Host::Instance*> ProviderClient::sensors()
{
    return instancesFrom([&](const CMPIResult* result) {
        CMPIInstanceMI& mi = sensorMI();
        const Host::ObjectPath& path = request_->makePath(nameSpace, sensorClass);
        return mi.ft->enumerateInstances(
            &mi, request_->context().handle(), result, path.handle(), nullptr);
    });
}

const Host::Instance* ProviderClient::sensor(std::string_view deviceId)
{
    const auto found = instancesFrom([&](const CMPIResult* result) {
        CMPIInstanceMI& mi = sensorMI();
        Host::ObjectPath& path = request_->makePath(nameSpace, sensorClass);
        path.addKey("DeviceID", Host::Value::text(request_->arena(), deviceId));
        return mi.ft->getInstance(
            &mi, request_->context().handle(), result, path.handle(), nullptr);
    });
    return found.empty() ? nullptr : found.front();
}

std::string pathOf(const Host::Instance& instance)
{
    return instance.objectPath().toText();
}

} // namespace Tools
