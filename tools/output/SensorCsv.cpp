// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/output/SensorCsv.h"

#include "tools/output/PrintableText.h"

namespace Tools {

namespace {

void appendField(std::string& line, std::string_view text)
{
    if (!line.empty())
        line += ',';
    if (text.find_first_of(",\"") == std::string_view::npos) {
        line += printable(text);
        return;
    }
    line += '"';
    for (const char c : printable(text))
        line.append(c == '"' ? 2 : 1, c);
    line += '"';
}

} // namespace

void writeCsv(Output& out, const Sensors& sensors)
{
    std::string titles = "chip,device,label,kind,value,unit,state";
    for (const LimitKind& limit : limitKinds)
        appendField(titles, limit.member);
    out.write(titles + ",deviceId\n");
    for (const Sensor& sensor : sensors) {
        std::string line;
        for (const std::string_view field : {std::string_view(sensor.chip),
                 std::string_view(sensor.device), std::string_view(sensor.label), sensor.kind})
            appendField(line, field);
        appendField(line, sensor.reading ? sensor.reading->text() : "");
        appendField(line, sensor.unit);
        appendField(line, sensor.state.word);
        for (const auto& limit : sensor.limits)
            appendField(line, limit ? limit->text() : "");
        appendField(line, sensor.deviceId);
        out.write(line + "\n");
    }
}

} // namespace Tools
