// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A CMPI provider library in memory, and the management interfaces (MIs) it was asked for.

#pragma once

#include <cmpidt.h>
#include <cmpift.h>

#include <map>
#include <memory>
#include <mutex>
#include <string>

namespace Host {

class Broker;

// Used from any thread, and so are the MIs that it hands out.
class ProviderLibrary {
public:
    // Loads the file with its symbols kept to itself. The broker must outlive the library.
    // Throws std::runtime_error with the loader's reason, which names the file.
    ProviderLibrary(const Broker& broker, const std::string& file);
    // Lets every MI clean up and unloads the library, unless an MI answers that it must stay:
    // then it stays in memory until the process ends.
    ~ProviderLibrary();
    ProviderLibrary(const ProviderLibrary&) = delete;
    ProviderLibrary& operator=(const ProviderLibrary&) = delete;

    // The MI of the provider with that name, made at the first call; it belongs to the library
    // and lasts as long as this object. A factory may call up, and no lock is held meanwhile; those
    // that ask for the same MI wait for it. Throw std::runtime_error naming the file when the
    // library exports no such factory, when its factory refuses and where that asks, by itself or
    // through others, for what it is to make.
    CMPIInstanceMI& instanceMI(const std::string& provider);
    CMPIAssociationMI& associationMI(const std::string& provider);

private:
    struct Unload {
        void operator()(void* library) const noexcept;
    };

    template <typename MI>
    MI* findMade(const std::map<std::string, MI*>& made, const std::string& factory) const;
    template <typename MI>
    MI& mi(std::map<std::string, MI*>& made, const std::string& factory);
    template <typename MI>
    MI* create(const std::string& factory) const;
    bool cleanUp() noexcept;

    const Broker& broker_;
    std::string file_;
    std::unique_ptr<void, Unload> library_;
    mutable std::mutex mutex_; // of the maps
    std::map<std::string, CMPIInstanceMI*> instanceMIs_;
    std::map<std::string, CMPIAssociationMI*> associationMIs_;
};

// The message of a status; empty when there is none.
std::string messageOf(const CMPIStatus& status);

// The code and message of a status, for people: "code 1: At least one key should be passed".
std::string describe(const CMPIStatus& status);

} // namespace Host
