// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/SourceRegistry.h"

#include "platform/instrumentation/hwmon/HwmonSource.h"
#include "platform/instrumentation/machinefile/MachineFileSource.h"

#include <map>
#include <mutex>
#include <stdexcept>
#include <utility>

namespace Vorn {

namespace {

std::unique_ptr<Source> openHwmon(const std::string& argument)
{
    if (!argument.empty())
        throw std::runtime_error("source \"hwmon:" + argument + "\": hwmon takes no argument");
    return std::make_unique<HwmonSource>();
}

std::unique_ptr<Source> openModel(const std::string& argument)
{
    if (argument.empty())
        throw std::runtime_error("source \"model\" names no file: write model:FILE");
    return std::make_unique<MachineFileSource>(argument);
}

class Registry {
public:
    void add(const std::string& scheme, SourceFactory factory)
    {
        const std::lock_guard lock(mutex_);
        factories_[scheme] = std::move(factory);
    }

    SourceFactory find(const SourceEntry& entry) const
    {
        const std::lock_guard lock(mutex_);
        const auto found = factories_.find(entry.scheme);
        if (found == factories_.end())
            throw std::runtime_error(
                "source \"" + entry.text + "\" is of an unknown kind (there are: " + kinds() + ")");
        return found->second;
    }

private:
    std::string kinds() const
    {
        std::string text;
        for (const auto& [scheme, factory] : factories_)
            text += (text.empty() ? "" : ", ") + scheme;
        return text;
    }

    mutable std::mutex mutex_;
    std::map<std::string, SourceFactory> factories_{{"hwmon", openHwmon}, {"model", openModel}};
};

Registry& registry()
{
    static Registry instance;
    return instance;
}

} // namespace

void registerSource(const std::string& scheme, SourceFactory factory)
{
    registry().add(scheme, std::move(factory));
}

std::unique_ptr<Source> openSource(const SourceEntry& entry)
{
    return registry().find(entry)(entry.argument);
}

} // namespace Vorn
