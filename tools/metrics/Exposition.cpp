// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/metrics/Exposition.h"

#include "platform/text/Utf8.h"

#include <prometheus/metric_family.h>
#include <prometheus/text_serializer.h>

namespace Tools {

namespace {

constexpr std::string_view suffixOfCounters = "_total";

// Returns the family in the text format. Without series, this is its comments.
std::string serialised(const MetricFamily& family, std::vector<prometheus::ClientMetric> metrics)
{
    const bool isCounter = family.type == MetricFamily::Type::counter;
    std::vector<prometheus::MetricFamily> families(1);
    families.front().name = family.name;
    families.front().help = family.help;
    families.front().type =
        isCounter ? prometheus::MetricType::Counter : prometheus::MetricType::Gauge;
    families.front().metric = std::move(metrics);
    return prometheus::TextSerializer().Serialize(families);
}

prometheus::ClientMetric metricOf(const Series& series, MetricFamily::Type type)
{
    prometheus::ClientMetric metric;
    metric.label.reserve(series.labels.all().size());
    for (const auto& [name, value] : series.labels.all())
        metric.label.push_back({name, value});
    (type == MetricFamily::Type::counter ? metric.counter.value : metric.gauge.value) =
        series.value;
    return metric;
}

} // namespace

Labels& Labels::add(std::string_view name, std::string_view value)
{
    all_.emplace_back(name, Text::toValidUtf8(value));
    return *this;
}

std::string linesOf(const MetricFamily& family, const std::vector<Series>& series)
{
    std::vector<prometheus::ClientMetric> metrics;
    metrics.reserve(series.size());
    for (const Series& each : series)
        metrics.push_back(metricOf(each, family.type));
    std::string text = serialised(family, std::move(metrics));
    std::size_t comments = 0;
    while (text.compare(comments, 1, "#") == 0)
        comments = text.find('\n', comments) + 1;
    text.erase(0, comments);
    return text;
}

void Exposition::begin(const MetricFamily& family)
{
    if (form_ == ExpositionForm::text) {
        append(serialised(family, {}));
        return;
    }
    const bool isCounter = family.type == MetricFamily::Type::counter;
    // In OpenMetrics, only the series of a counter have the suffix.
    std::string name(family.name);
    name.resize(name.size() - (isCounter ? suffixOfCounters.size() : 0));
    const auto comment = [&](std::string_view keyword, std::string_view text) {
        text_.append("# ").append(keyword).append(" ").append(name).append(" ");
        text_.append(text).append("\n");
    };
    comment("HELP", family.help);
    comment("TYPE", isCounter ? "counter" : "gauge");
    if (!family.unit.empty())
        comment("UNIT", family.unit);
}

void Exposition::add(const MetricFamily& family, const std::vector<Series>& series)
{
    begin(family);
    append(linesOf(family, series));
}

std::string Exposition::finish() &&
{
    if (form_ == ExpositionForm::openMetrics)
        append("# EOF\n");
    return std::move(text_);
}

} // namespace Tools
