// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/model/ModelCache.h"

#include "platform/instrumentation/RegularFile.h"
#include "platform/instrumentation/model/ModelReader.h"

#include <stdexcept>

namespace Vorn {

namespace {

// A process serves one machine, a test a few.
constexpr std::size_t mostFiles = 8;

// A million sensors; more is a mistake.
constexpr std::size_t mostBytes = std::size_t{256} << 20U;

} // namespace

ModelCache& ModelCache::instance()
{
    static ModelCache cache;
    return cache;
}

std::shared_ptr<const Model> ModelCache::load(const std::string& path)
{
    try {
        const Outcome outcome = find(path);
        if (outcome.model == nullptr)
            throw std::runtime_error(outcome.failure);
        return outcome.model;
    } catch (const std::runtime_error& error) {
        throw std::runtime_error("model file " + path + ": " + error.what());
    }
}

ModelCache::Outcome ModelCache::find(const std::string& path)
{
    const FileStamp present = stampOfRegularFile(path);
    {
        const std::lock_guard lock(mutex_);
        const auto known = outcomes_.find(path);
        if (known != outcomes_.end() && known->second.stamp == present)
            return known->second;
    }
    const Outcome outcome = read(path);
    if (isSettled(outcome.stamp))
        keep(path, outcome);
    return outcome;
}

ModelCache::Outcome ModelCache::read(const std::string& path)
{
    const FileContent file = readRegularFile(path, mostBytes);
    try {
        return {file.stamp, std::make_shared<const Model>(readModel(file.text)), {}};
    } catch (const std::runtime_error& error) {
        return {file.stamp, nullptr, error.what()};
    }
}

void ModelCache::keep(const std::string& path, const Outcome& outcome)
{
    const std::lock_guard lock(mutex_);
    if (outcomes_.size() >= mostFiles && !outcomes_.contains(path))
        outcomes_.clear();
    outcomes_[path] = outcome;
}

} // namespace Vorn
