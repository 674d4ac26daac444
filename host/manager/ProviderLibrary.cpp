// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/manager/ProviderLibrary.h"

#include "host/broker/Broker.h"
#include "host/broker/Request.h"

#include <dlfcn.h>

#include <exception>
#include <stdexcept>

namespace Host {

namespace {

// The oldest function table that still has the layout of the headers.
constexpr CMPIVersion oldestVersion = 100;

[[noreturn]] void fail(const std::string& file, const std::string& reason)
{
    throw std::runtime_error(file + ": " + reason);
}

// Calls the cleanup of each MI, also after one of them failed. Returns false when the library is to
// stay loaded.
template <typename MIs>
bool cleanUpAll(const MIs& mis, Context& context)
{
    bool mayUnload = true;
    for (auto* const mi : mis) {
        if (mi->ft->cleanup == nullptr)
            continue;
        const CMPIStatus status = mi->ft->cleanup(mi, context.handle(), true);
        if (status.rc == CMPI_RC_DO_NOT_UNLOAD || status.rc == CMPI_RC_NEVER_UNLOAD)
            mayUnload = false;
    }
    return mayUnload;
}

} // namespace

void ProviderLibrary::Unload::operator()(void* library) const noexcept
{
    ::dlclose(library);
}

ProviderLibrary::ProviderLibrary(const Broker& broker, const std::string& file)
    : broker_(broker), file_(file), library_(::dlopen(file.c_str(), RTLD_NOW | RTLD_LOCAL))
{
    if (library_ == nullptr)
        throw std::runtime_error(::dlerror());
}

ProviderLibrary::~ProviderLibrary()
{
    if (!cleanUp())
        (void)library_.release();
}

CMPIInstanceMI& ProviderLibrary::createInstanceMI(const std::string& provider)
{
    return *instanceMIs_.emplace_back(create<CMPIInstanceMI>(provider + "_Create_InstanceMI"));
}

CMPIAssociationMI& ProviderLibrary::createAssociationMI(const std::string& provider)
{
    return *associationMIs_.emplace_back(
        create<CMPIAssociationMI>(provider + "_Create_AssociationMI"));
}

template <typename MI>
MI* ProviderLibrary::create(const std::string& factory) const
{
    using Factory = MI* (*)(const CMPIBroker*, const CMPIContext*, CMPIStatus*);
    const auto call = reinterpret_cast<Factory>(::dlsym(library_.get(), factory.c_str()));
    if (call == nullptr)
        fail(file_, "no factory " + factory);
    Request request(broker_);
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    MI* const made = call(broker_.handle(), request.context().handle(), &status);
    if (status.rc != CMPI_RC_OK)
        fail(file_, factory + " answers " + describe(status));
    if (made == nullptr || made->ft == nullptr)
        fail(file_, factory + " answers with nothing");
    if (made->ft->ftVersion < oldestVersion)
        fail(file_, factory + " answers with a function table of version " +
                        std::to_string(made->ft->ftVersion));
    return made;
}

bool ProviderLibrary::cleanUp() noexcept
{
    try {
        Request request(broker_);
        const bool instancesDone = cleanUpAll(instanceMIs_, request.context());
        const bool associationsDone = cleanUpAll(associationMIs_, request.context());
        return instancesDone && associationsDone;
    } catch (const std::exception&) {
        return false; // what was not cleaned up may still be in use
    }
}

std::string messageOf(const CMPIStatus& status)
{
    if (status.msg == nullptr || status.msg->hdl == nullptr)
        return {};
    const char* const message = status.msg->ft->getCharPtr(status.msg, nullptr);
    return message == nullptr ? "" : message;
}

std::string describe(const CMPIStatus& status)
{
    const std::string code = "code " + std::to_string(status.rc);
    const std::string message = messageOf(status);
    return message.empty() ? code : code + ": " + message;
}

} // namespace Host
