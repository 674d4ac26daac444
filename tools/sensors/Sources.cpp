// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/sensors/Sources.h"

#include "platform/instrumentation/Instrumentation.h"
#include "platform/instrumentation/OpenSource.h"
#include "platform/instrumentation/Source.h"
#include "platform/instrumentation/ipmi/IpmiSource.h"

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <exception>

namespace Tools {

std::vector<Vorn::SourceEntry> configuredSources()
{
    const char* const list = std::getenv("VORN_INSTRUMENTATION");
    return Vorn::parseSourceList(
        list == nullptr || *list == '\0' ? Vorn::Instrumentation::defaultSources : list);
}

bool readsHwmon()
{
    const auto entries = configuredSources();
    return std::any_of(entries.begin(), entries.end(),
        [](const Vorn::SourceEntry& entry) { return entry.scheme == "hwmon"; });
}

std::string ageOfCollection()
{
    double oldest = -1;
    for (const Vorn::SourceEntry& entry : configuredSources())
        try {
            if (entry.scheme == "ipmi")
                oldest = std::max(oldest, Vorn::IpmiSource(entry.argument).age().value_or(-1));
        } catch (const std::exception&) { // the library has reported the reason
        }
    return oldest < 0 ? "" : "read " + std::to_string(std::lround(oldest)) + " s ago";
}

std::vector<std::string> failuresOfSources(bool areChipsListed)
{
    std::vector<std::string> reasons;
    for (const Vorn::SourceEntry& entry : configuredSources())
        try {
            if (entry.scheme != "hwmon" || !areChipsListed)
                Vorn::openSource(entry)->nodes(Vorn::NodeLexicon::NodeType::Temperature);
        } catch (const std::exception& error) {
            reasons.emplace_back(error.what());
        }
    return reasons;
}

} // namespace Tools
