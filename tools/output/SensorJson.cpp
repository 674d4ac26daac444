// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/output/SensorJson.h"

#include "tools/output/JsonText.h"

namespace Tools {

namespace {

// Appends a member with a string, or null for an empty one.
void appendMember(std::string& json, const char* name, std::string_view text)
{
    json.append(", \"").append(name).append("\": ");
    if (text.empty())
        json += "null";
    else
        appendString(json, text);
}

} // namespace

void appendSensorJson(std::string& json, const Sensor& sensor)
{
    json += "{\"chip\": ";
    appendString(json, sensor.chip);
    appendMember(json, "device", sensor.device);
    appendMember(json, "label", sensor.label);
    appendMember(json, "kind", sensor.kind);
    json += ", \"value\": " + (sensor.reading ? sensor.reading->text() : "null");
    appendMember(json, "unit", sensor.unit);
    appendMember(json, "state", sensor.state.word);
    json += ", \"limits\": {";
    const char* separator = "";
    for (std::size_t i = 0; i < limitKinds.size(); ++i)
        if (const auto& limit = sensor.limits.at(i)) {
            json.append(separator).append("\"").append(limitKinds.at(i).member);
            json.append("\": ").append(limit->text());
            separator = ", ";
        }
    json += '}';
    appendMember(json, "deviceId", sensor.deviceId);
    json += '}';
}

void writeSensorJson(Output& out, const Sensors& sensors)
{
    out.write("[");
    std::string json = "\n  ";
    for (const Sensor& sensor : sensors) {
        appendSensorJson(json, sensor);
        out.write(json);
        json = ",\n  ";
    }
    out.write(sensors.empty() ? "]\n" : "\n]\n");
}

} // namespace Tools
