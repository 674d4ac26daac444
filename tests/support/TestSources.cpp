// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/support/TestSources.h"

#include "platform/instrumentation/OpenSource.h"

#include <map>
#include <mutex>
#include <stdexcept>
#include <utility>

namespace Testing {

namespace {

std::mutex mutex;
std::map<std::string, SourceFactory> factories;

} // namespace

void provideSource(const std::string& scheme, SourceFactory factory)
{
    const std::lock_guard lock(mutex);
    factories[scheme] = std::move(factory);
}

} // namespace Testing

namespace Vorn {

std::unique_ptr<Source> openSource(const SourceEntry& entry)
{
    std::unique_lock lock(Testing::mutex);
    const auto found = Testing::factories.find(entry.scheme);
    if (found == Testing::factories.end())
        throw std::runtime_error("no test provides the source \"" + entry.text + "\"");
    const Testing::SourceFactory factory = found->second;
    lock.unlock();
    return factory();
}

} // namespace Vorn
