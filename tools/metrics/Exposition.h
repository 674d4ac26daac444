// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The text that Prometheus scrapes. prometheus-cpp serialises it.

#pragma once

#include <compare>
#include <cstddef>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace Tools {

enum class ExpositionForm {
    text,        // the text format 0.0.4 of Prometheus
    openMetrics, // OpenMetrics 1.0.0
};

class Labels {
public:
    // Adds a label. Bytes of the value that are no UTF-8 become U+FFFD.
    Labels& add(std::string_view name, std::string_view value);

    const std::vector<std::pair<std::string, std::string>>& all() const { return all_; }

    auto operator<=>(const Labels&) const = default;

private:
    std::vector<std::pair<std::string, std::string>> all_; // names and values
};

struct Series {
    Labels labels;
    double value;
};

struct MetricFamily {
    enum class Type { gauge, counter };

    std::string_view name; // that of a counter ends in "_total"
    std::string_view help; // without backslashes, quotes and line feeds
    Type type = Type::gauge;
    std::string_view unit = {}; // the end of the name, if it is a unit
};

// Returns a line for each series, which is the same in both forms.
std::string linesOf(const MetricFamily& family, const std::vector<Series>& series);

class Exposition {
public:
    // `expectedSize` saves reallocations; a text may exceed it.
    explicit Exposition(ExpositionForm form, std::size_t expectedSize = 0) : form_(form)
    {
        text_.reserve(expectedSize);
    }

    // Begins a family. REQUIRES: the exposition has no other one of the name.
    void begin(const MetricFamily& family);
    // Adds lines of the family, or parts of them.
    void append(std::string_view lines) { text_ += lines; }

    // Adds a whole family.
    void add(const MetricFamily& family, const std::vector<Series>& series);

    // Returns the text.
    std::string finish() &&;

private:
    ExpositionForm form_;
    std::string text_;
};

} // namespace Tools
