// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/OpenSource.h"

#include "platform/instrumentation/hwmon/HwmonSource.h"
#include "platform/instrumentation/ipmi/IpmiSource.h"
#include "platform/instrumentation/machinefile/MachineFileSource.h"

#include <stdexcept>

namespace Vorn {

std::unique_ptr<Source> openSource(const SourceEntry& entry)
{
    if (entry.scheme == "hwmon") {
        if (entry.argument.empty())
            return std::make_unique<HwmonSource>(HwmonSource::Order::serial);
        if (entry.argument == "parallel")
            return std::make_unique<HwmonSource>(HwmonSource::Order::parallel);
        throw std::runtime_error(
            "source \"" + entry.text + "\": hwmon takes no argument but parallel");
    }
    if (entry.scheme == "ipmi")
        return std::make_unique<IpmiSource>(entry.argument);
    if (entry.scheme == "model") {
        if (entry.argument.empty())
            throw std::runtime_error("source \"model\" names no file: write model:FILE");
        return std::make_unique<MachineFileSource>(entry.argument);
    }
    throw std::runtime_error(
        "source \"" + entry.text + "\" is of an unknown kind (there are: hwmon, ipmi, model)");
}

} // namespace Vorn
