// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The text that Prometheus scrapes.

#pragma once

#include <compare>
#include <cstddef>
#include <string>
#include <string_view>

namespace Tools {

enum class ExpositionForm {
    text,        // the text format 0.0.4 of Prometheus
    openMetrics, // OpenMetrics 1.0.0
};

// The labels of a series, as they are in both forms.
class Labels {
public:
    // Adds a label. Bytes of the value that are no UTF-8 become U+FFFD.
    Labels& add(std::string_view name, std::string_view value);

    const std::string& text() const { return text_; } // with commas between them

    auto operator<=>(const Labels&) const = default;

private:
    std::string text_;
};

struct MetricFamily {
    enum class Type { gauge, counter };

    std::string_view name; // that of a counter ends in "_total"
    std::string_view help;
    Type type = Type::gauge;
    std::string_view unit = {}; // the end of the name, if it is a unit
};

class Exposition {
public:
    // `expectedSize` saves reallocations; a text may exceed it.
    explicit Exposition(ExpositionForm form, std::size_t expectedSize = 0) : form_(form)
    {
        text_.reserve(expectedSize);
    }

    // Begins a family. REQUIRES: the exposition has no other one of the name.
    void begin(const MetricFamily& family);

    // Add a series to the family, the second with one label more, whose value needs no escapes.
    void add(const Labels& labels, double value);
    void add(const Labels& labels, std::string_view name, std::string_view value, double number);

    // Returns the text.
    std::string finish() &&;

private:
    void addComment(std::string_view keyword, std::string_view name, std::string_view text);
    void addNumber(double number);

    ExpositionForm form_;
    std::string name_; // of the series
    std::string text_;
};

} // namespace Tools
