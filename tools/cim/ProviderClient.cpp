// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/cim/ProviderClient.h"

#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Refusal.h"
#include "host/manager/SensorProfile.h"
#include "tools/cim/Classes.h"
#include "tools/cim/PathText.h"

#include <stdexcept>

namespace Tools {

namespace {

[[noreturn]] void fail(const Host::Refusal& refusal)
{
    throw std::runtime_error(
        std::string(refusal.what()) + " (code " + std::to_string(refusal.code()) + ")");
}

} // namespace

ProviderClient::ProviderClient(const ProviderFiles& files)
    : classes_(compileClasses()),
      manager_(*classes_, Host::sensorProfileProviders(files.sensors, files.computerSystem))
{
    for (const auto& provider : Host::sensorProfileProviders({}, std::string()))
        if (provider.servesAssociations)
            associations_.push_back(provider.className);
    beginRequest();
}

std::optional<std::string> ProviderClient::declaredClass(std::string_view className) const
{
    for (const auto& each : classes_->namespaces())
        if (const Host::ClassDeclaration* const declared = each->findClass(className))
            return declared->name;
    return std::nullopt;
}

void ProviderClient::beginRequest()
{
    request_.emplace(manager_.broker());
}

Instances ProviderClient::instances(const std::string& className, const char** properties)
{
    Host::CollectedResult answer;
    try {
        if (classes_->findClass(nameSpace, className) == nullptr) // it is one of root/interop
            throw Host::Refusal(
                CMPI_RC_ERR_NOT_SUPPORTED, "no provider serves the class " + className);
        answer = manager_.enumerateInstances(
            request_->context(), request_->makePath(nameSpace, className), properties);
    } catch (const Host::Refusal& refusal) {
        fail(refusal);
    }
    if (answer.refused() != 0)
        throw std::runtime_error("the provider could not build " +
                                 std::to_string(answer.refused()) + " of the instances");
    return answer.instances();
}

const Host::Instance* ProviderClient::instance(const Host::ObjectPath& path)
{
    try {
        return &manager_.getInstance(request_->context(), path, nullptr);
    } catch (const Host::Refusal& refusal) {
        if (refusal.code() == CMPI_RC_ERR_NOT_FOUND)
            return nullptr;
        fail(refusal);
    }
}

const Host::ClassDeclaration* ProviderClient::classOf(const Host::Instance& object) const
{
    return classes_->findClass(object.nameSpace(), object.className());
}

const Host::ObjectPath* ProviderClient::readPath(std::string_view text) const
{
    return Tools::readPath(request_->arena(), *classes_, text);
}

} // namespace Tools
