// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A loaded CMPI provider library, and the management interfaces (MIs) that it created.

#pragma once

#include <cmpidt.h>
#include <cmpift.h>

#include <memory>
#include <string>
#include <vector>

namespace Host {

class Broker;

// Created and destroyed by one thread; the MIs may be used from any thread.
class ProviderLibrary {
public:
    // Loads the file with local symbols (RTLD_LOCAL). The broker must outlive the library. Throws
    // std::runtime_error with the loader's reason, which names the file.
    ProviderLibrary(const Broker& broker, const std::string& file);
    // Calls the cleanup of every MI and unloads the library, unless an MI refuses to be unloaded:
    // then it stays loaded until the process ends.
    ~ProviderLibrary();
    ProviderLibrary(const ProviderLibrary&) = delete;
    ProviderLibrary& operator=(const ProviderLibrary&) = delete;

    // Create the MI of the provider with that name, which belongs to the library and lasts as long
    // as this object. Throw std::runtime_error naming the file when the library exports no such
    // factory and when the factory fails.
    CMPIInstanceMI& createInstanceMI(const std::string& provider);
    CMPIAssociationMI& createAssociationMI(const std::string& provider);

private:
    struct Unload {
        void operator()(void* library) const noexcept;
    };

    template <typename MI>
    MI* create(const std::string& factory) const;
    bool cleanUp() noexcept;

    const Broker& broker_;
    std::string file_;
    std::unique_ptr<void, Unload> library_;
    std::vector<CMPIInstanceMI*> instanceMIs_;
    std::vector<CMPIAssociationMI*> associationMIs_;
};

// Returns the message of a status; empty when there is none.
std::string messageOf(const CMPIStatus& status);

// Returns the code and message of a status: "code 1: At least one key should be passed".
std::string describe(const CMPIStatus& status);

} // namespace Host
