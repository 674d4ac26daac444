// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/metrics/Exposition.h"

#include "platform/text/Utf8.h"

#include <array>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <utility>

namespace Tools {

namespace {

constexpr std::string_view suffixOfCounters = "_total";

void appendEscaped(std::string& out, std::string_view text, bool escapesQuotes)
{
    for (const char character : text)
        if (character == '\n')
            out += "\\n";
        else if (character == '\\' || (character == '"' && escapesQuotes))
            (out += '\\') += character;
        else
            out += character;
}

} // namespace

Labels& Labels::add(std::string_view name, std::string_view value)
{
    (text_ += text_.empty() ? "" : ",").append(name) += "=\"";
    appendEscaped(text_, Text::toValidUtf8(value), true);
    text_ += '"';
    return *this;
}

void Exposition::begin(const MetricFamily& family)
{
    name_ = family.name;
    const bool isCounter = family.type == MetricFamily::Type::counter;
    // In OpenMetrics, only the series of a counter have the suffix.
    std::string_view name = family.name;
    if (isCounter && form_ == ExpositionForm::openMetrics)
        name.remove_suffix(suffixOfCounters.size());
    addComment("HELP", name, family.help);
    addComment("TYPE", name, isCounter ? "counter" : "gauge");
    if (!family.unit.empty() && form_ == ExpositionForm::openMetrics)
        addComment("UNIT", name, family.unit);
}

void Exposition::addComment(std::string_view keyword, std::string_view name, std::string_view text)
{
    text_.append("# ").append(keyword).append(" ").append(name) += ' ';
    appendEscaped(text_, text, form_ == ExpositionForm::openMetrics);
    text_ += '\n';
}

void Exposition::add(const Labels& labels, double value)
{
    text_ += name_;
    if (!labels.text().empty())
        text_.append("{").append(labels.text()) += '}';
    addNumber(value);
}

void Exposition::add(
    const Labels& labels, std::string_view name, std::string_view value, double number)
{
    text_.append(name_).append("{").append(labels.text()) += ',';
    text_.append(name).append("=\"").append(value) += "\"}";
    addNumber(number);
}

void Exposition::addNumber(double number)
{
    constexpr double greatestWhole = 1e15;
    std::array<char, 32> digits{};
    char* const end = digits.data() + digits.size();
    // Most numbers are whole, and an integer takes less time.
    const bool isWhole = std::abs(number) < greatestWhole && std::trunc(number) == number;
    const auto written = isWhole
                             ? std::to_chars(digits.data(), end, static_cast<std::int64_t>(number))
                             : std::to_chars(digits.data(), end, number);
    (text_ += ' ').append(digits.data(), written.ptr) += '\n';
}

std::string Exposition::finish() &&
{
    if (form_ == ExpositionForm::openMetrics)
        text_ += "# EOF\n";
    return std::move(text_);
}

} // namespace Tools
