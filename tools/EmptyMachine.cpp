// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/EmptyMachine.h"

#include "platform/instrumentation/Instrumentation.h"
#include "tools/output/Output.h"

#include <stdexcept>

namespace Tools {

using Vorn::NodeLexicon::NodeType;

std::size_t countSensors()
{
    std::size_t count = 0;
    for (const NodeType type : {NodeType::Temperature, NodeType::Voltage, NodeType::Tachometer}) {
        Vorn::Instrumentation cursor;
        for (cursor.selectNode(type); cursor; ++cursor)
            ++count;
    }
    return count;
}

void checkMachineIsEmpty()
{
    if (const std::size_t count = countSensors(); count != 0)
        throw std::runtime_error("the machine has " + std::to_string(count) +
                                 " sensors, of which the provider shows none");
}

ExitCode complainOfEmptyMachine(const std::optional<std::string>& model)
{
    if (model)
        complain(*model + ": this machine has no sensors");
    else
        complain("this machine has no sensors (--model FILE shows one that a file describes)");
    return ExitCode::nothingFound;
}

} // namespace Tools
