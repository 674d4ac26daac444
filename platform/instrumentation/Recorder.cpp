// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/Recorder.h"

#include "platform/instrumentation/Instrumentation.h"
#include "platform/instrumentation/machinefile/MachineFileWriter.h"

#include <set>

namespace Vorn {

using NodeLexicon::NodeType;
using NodeLexicon::Properties;

namespace {

template <typename Value>
void fetch(Instrumentation& cursor, Properties property, std::optional<Value>& to)
{
    Value value{};
    if (cursor.getProperty(property, value))
        to = std::move(value);
}

NodeReading readingOf(Instrumentation& cursor)
{
    NodeReading values;
    values.status = cursor.getNodeStatus();
    fetch(cursor, Properties::Reading, values.reading);
    fetch(cursor, Properties::LowerNonCritical, values.lowerNonCritical);
    fetch(cursor, Properties::UpperNonCritical, values.upperNonCritical);
    fetch(cursor, Properties::LowerCritical, values.lowerCritical);
    fetch(cursor, Properties::UpperCritical, values.upperCritical);
    fetch(cursor, Properties::LowerFatal, values.lowerFatal);
    fetch(cursor, Properties::UpperFatal, values.upperFatal);
    fetch(cursor, Properties::BaseUnits, values.baseUnits);
    fetch(cursor, Properties::PossibleStates, values.possibleStates);
    return values;
}

std::string uniquePath(const std::string& path, std::set<std::string>& known)
{
    std::string candidate = path;
    for (unsigned number = 2; !known.insert(candidate).second; ++number)
        candidate = path + "#" + std::to_string(number);
    return candidate;
}

} // namespace

std::string recordMachineFile()
{
    MachineFile machine;
    std::set<std::string> paths;
    for (const NodeType type : {NodeType::Temperature, NodeType::Voltage, NodeType::Tachometer}) {
        Instrumentation cursor;
        for (cursor.selectNode(type); cursor; ++cursor)
            machine.nodes.push_back({type, uniquePath(cursor.getPathToNode(), paths),
                cursor.getNodeDescription(), cursor.getSensorType(), readingOf(cursor)});
    }
    return writeMachineFile(machine);
}

} // namespace Vorn
