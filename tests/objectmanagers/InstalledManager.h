// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Controls the object managers, which a test program has for itself where in-namespaces runs it.

#pragma once

#include "tests/packaging/Installation.h"

#include <filesystem>
#include <map>
#include <string>
#include <vector>

namespace Testing {

inline const std::vector<std::string> servedClasses = {"ZUMLO_NumericSensor",
    "ZUMLO_ComputerSystem", "ZUMLO_SensorEnabledLogicalElementCapabilities",
    "ZUMLO_SensorSystemDevice", "ZUMLO_SensorElementCapabilities",
    "ZUMLO_SensorElementConformsToProfile", "ZUMLO_SensorRegisteredProfile"};

// Functions that run a command throw std::runtime_error with what it printed when it fails.
class InstalledManager {
public:
    static const InstalledManager& openPegasus();
    static const InstalledManager& sfcb();

    // Returns its name, as sensor-profile-register takes it.
    const std::string& name() const { return name_; }
    const std::string& folder() const { return folder_; }
    unsigned port() const { return port_; }
    // Returns the namespace of registered profiles.
    std::string interop() const
    {
        return this == &openPegasus() ? "root/PG_InterOp" : "root/interop";
    }
    std::string url(const std::string& object, const std::string& space) const;
    // Returns the URL of an object in the namespace that it is registered in by default.
    std::string url(const std::string& object) const
    {
        return url(object, isInterop(object) ? interop() : "root/cimv2");
    }
    // Returns whether the object or class is in the namespace of registered profiles.
    static bool isInterop(const std::string& object)
    {
        return object.starts_with("ZUMLO_SensorRegisteredProfile");
    }

    // Starts it; its providers inherit the variables. Returns when it answers.
    void start(const std::map<std::string, std::string>& environment) const;
    void stop() const;
    // Stops it and makes it what it was when it was installed.
    void reset() const;
    // Starts it with the providers registered.
    void startWithProviders(const std::map<std::string, std::string>& environment) const;

    // Runs one of its commands; returns what it printed.
    std::string command(const std::string& program, std::vector<std::string> arguments) const;

    // Runs sensor-profile-register of an installation, with the folders of this object manager
    // unless the arguments name others. Returns what it printed.
    std::string runRegister(std::vector<std::string> arguments,
        const std::filesystem::path& installation = movedInstallation()) const;

private:
    InstalledManager(std::string name, unsigned port, std::vector<std::string> registerOptions);

    std::string name_;
    unsigned port_;
    std::string folder_ = "/opt/" + name_;
    std::vector<std::string> registerOptions_;
};

} // namespace Testing
