// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Reads the text format of Prometheus.

#pragma once

#include "tests/support/Texts.h"

#include <map>
#include <stdexcept>
#include <string>
#include <vector>

namespace Testing {

inline const std::string acceptOfPrometheus =
    "Accept: application/openmetrics-text;version=1.0.0,application/openmetrics-text;version=0.0.1;"
    "q=0.75,text/plain;version=0.0.4;q=0.5,*/*;q=0.1\r\n";

// A Python program that prints how many series the file of its argument has, as OpenMetrics.
inline const std::string openMetricsParser =
    "import sys\n"
    "from prometheus_client.openmetrics.parser import text_string_to_metric_families\n"
    "families = text_string_to_metric_families(open(sys.argv[1], encoding='utf-8').read())\n"
    "print(sum(len(family.samples) for family in families))\n";

struct Series {
    std::string name;
    std::map<std::string, std::string> labels;
    double value;
};

inline Series seriesOf(const std::string& line)
{
    std::size_t at = line.find_first_of("{ ");
    Series series{line.substr(0, at), {}, 0};
    while (line.at(at) != ' ') {
        const std::size_t equals = line.find("=\"", at);
        std::string& value = series.labels[line.substr(at + 1, equals - at - 1)];
        for (at = equals + 2; line.at(at) != '"'; ++at)
            if (line.at(at) != '\\')
                value += line.at(at);
            else
                value += line.at(++at) == 'n' ? '\n' : line.at(at);
        if (line.at(++at) == '}')
            ++at;
    }
    series.value = std::stod(line.substr(at));
    return series;
}

// Returns the series of an exposition, in its order.
inline std::vector<Series> seriesIn(const std::string& text)
{
    std::vector<Series> all;
    for (const std::string& line : linesOf(text))
        if (!line.starts_with('#'))
            all.push_back(seriesOf(line));
    return all;
}

// Returns the lines of an exposition that are the same each time, in each folder and version.
inline std::string comparable(const std::string& text)
{
    std::string result;
    for (const std::string& line : linesOf(text))
        if (!line.starts_with("sensor_profile_harvest_duration_seconds ") &&
            !line.starts_with("sensor_profile_source_up{source=\"model:") &&
            !line.starts_with("sensor_profile_build_info{"))
            result += line + "\n";
    return result;
}

} // namespace Testing
