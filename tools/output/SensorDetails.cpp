// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/output/SensorDetails.h"

#include "tools/output/PrintableText.h"
#include "tools/output/SensorCells.h"

namespace Tools {

namespace {

constexpr std::size_t valueColumn = 17;

class Details {
public:
    explicit Details(const TextStyle& style) : style_(style) {}

    void add(const std::string& name, const std::string& value, Emphasis emphasis = Emphasis::none)
    {
        if (value.empty())
            return;
        const std::string start = "  " + name;
        lines_.push_back({{start + std::string(valueColumn - start.size(), ' ')},
            {printable(value, style_.isUtf8), emphasis}});
    }

    std::string toText() const
    {
        std::string text;
        for (const Line& line : lines_)
            text += textOf(line, style_);
        return text;
    }

private:
    const TextStyle& style_;
    std::vector<Line> lines_;
};

} // namespace

std::string sensorDetails(const Sensor& sensor, const TextStyle& style)
{
    Details details(style);
    details.add("Reading", textWithUnit(sensor.reading, sensor));
    details.add("State", std::string(sensor.state.word), emphasisOf(sensor.state.urgency));
    for (std::size_t i = 0; i < limitKinds.size(); ++i)
        if (const auto& limit = sensor.limits.at(i))
            details.add(limitKinds.at(i).words, textWithUnit(limit, sensor));
    details.add("Kind", std::string(sensor.kind));
    details.add("Chip", sensor.chip);
    details.add("Device", sensor.device);
    details.add("Path", sensor.path);
    details.add("DeviceID", sensor.deviceId);
    const std::string label = printable(sensor.label, style.isUtf8);
    return emphasized(label, Emphasis::heading, style.isColored) + "\n" + details.toText();
}

} // namespace Tools
