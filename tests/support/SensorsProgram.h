// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What the program `sensors` reads on the machine, with which the product must agree.

#pragma once

#include <nlohmann/json.hpp>

#include <array>
#include <cstdio>
#include <map>
#include <memory>
#include <stdexcept>
#include <string>
#include <utility>

namespace Testing {

// An administrator's configuration that concerns sensors of every captured machine.
inline constexpr const char* sensorsConfiguration = "chip \"*-*\"\n"
                                                    "  label temp1 \"First\"\n"
                                                    "  label fan1 \"Front fan\"\n"
                                                    "  compute temp1 @*2-1.5, (@+1.5)/2\n"
                                                    "  compute in0 @*(1+10/3.3), @/(1+10/3.3)\n"
                                                    "  ignore temp2\n"
                                                    "  ignore fan2\n";

// One channel in the output of `sensors -j`: subfeatures by the part of their name after "temp1_".
struct SensorsChannel {
    std::string label;
    std::map<std::string, double> values;

    bool isSet(const std::string& subfeature) const
    {
        const auto found = values.find(subfeature);
        return found != values.end() && found->second != 0;
    }
};

// Returns what `sensors -j` prints on standard output.
inline nlohmann::json sensorsOutput()
{
    const std::unique_ptr<FILE, int (*)(FILE*)> pipe(
        popen("/usr/bin/sensors -j 2>/dev/null", "r"), &pclose);
    if (pipe == nullptr)
        throw std::runtime_error("popen failed");
    std::string text;
    for (std::array<char, 4096> block; fgets(block.data(), block.size(), pipe.get()) != nullptr;)
        text += block.data();
    return nlohmann::json::parse(text);
}

// Returns a channel without the values that the product leaves out: the reading of a faulty
// channel, and pairs of limits that are both 0.
inline SensorsChannel sensorsChannelOf(const std::string& label, const nlohmann::json& subfeatures)
{
    SensorsChannel channel{label, {}};
    for (const auto& [name, value] : subfeatures.items())
        channel.values[name.substr(name.find('_') + 1)] = value.get<double>();
    if (channel.isSet("fault"))
        channel.values.erase("input");
    for (const auto& [lower, upper] : {std::pair("min", "max"), {"lcrit", "crit"}})
        if (!channel.isSet(lower) && !channel.isSet(upper)) {
            channel.values.erase(lower);
            channel.values.erase(upper);
        }
    return channel;
}

// Returns the channels of temperatures, voltages and fans by the path of their node.
inline std::map<std::string, SensorsChannel> sensorsChannels()
{
    std::map<std::string, SensorsChannel> found;
    const nlohmann::json document = sensorsOutput();
    for (const auto& [chip, features] : document.items())
        for (const auto& [label, subfeatures] : features.items()) {
            if (label == "Adapter" || subfeatures.empty())
                continue;
            const std::string name = subfeatures.begin().key();
            const std::string kind = name.substr(0, name.find_first_of("0123456789"));
            if (kind == "temp" || kind == "in" || kind == "fan")
                found["/hwmon/" + chip + "/" + name.substr(0, name.find('_'))] =
                    sensorsChannelOf(label, subfeatures);
        }
    return found;
}

} // namespace Testing
