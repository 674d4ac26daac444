// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/machinefile/MachineFileCache.h"

#include "platform/instrumentation/RegularFile.h"
#include "platform/instrumentation/machinefile/MachineFileReader.h"

#include <stdexcept>

namespace Vorn {

namespace {

// A process uses one file as a rule, a test a few.
constexpr std::size_t maximumFiles = 8;

// The bound allows a kilobyte for each of 65,535 sensors.
constexpr std::size_t maximumBytes = std::size_t{64} << 20U;

} // namespace

MachineFileCache& MachineFileCache::instance()
{
    static MachineFileCache cache;
    return cache;
}

MachineFileCache::Content MachineFileCache::load(const std::string& path)
{
    try {
        const Outcome outcome = find(path);
        if (outcome.content == nullptr)
            throw std::runtime_error(outcome.failure);
        return outcome.content;
    } catch (const std::runtime_error& error) {
        throw std::runtime_error("model file " + path + ": " + error.what());
    }
}

MachineFileCache::Outcome MachineFileCache::find(const std::string& path)
{
    const FileStamp present = stampOfRegularFile(path);
    {
        const std::lock_guard lock(mutex_);
        const auto known = outcomes_.find(path);
        if (known != outcomes_.end() && known->second.stamp == present)
            return known->second;
    }
    Outcome outcome = read(path);
    if (isSettled(outcome.stamp))
        keep(path, outcome);
    return outcome;
}

MachineFileCache::Outcome MachineFileCache::read(const std::string& path)
{
    const FileContent file = readRegularFile(path, maximumBytes);
    try {
        return {
            file.stamp, std::make_shared<const ServedMachineFile>(readMachineFile(file.text)), {}};
    } catch (const std::runtime_error& error) {
        return {file.stamp, nullptr, error.what()};
    }
}

void MachineFileCache::keep(const std::string& path, const Outcome& outcome)
{
    const std::lock_guard lock(mutex_);
    if (outcomes_.size() >= maximumFiles && !outcomes_.contains(path))
        outcomes_.clear();
    outcomes_[path] = outcome;
}

} // namespace Vorn
