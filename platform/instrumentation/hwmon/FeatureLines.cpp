// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/hwmon/FeatureLines.h"

#include <algorithm>
#include <cctype>
#include <iterator>
#include <vector>

namespace Vorn::Hwmon {

namespace {

bool isOfWord(char character)
{
    return std::isalnum(static_cast<unsigned char>(character)) != 0 || character == '_';
}

// Removes blanks, comments and continued line ends from the beginning.
void removeBlanks(std::string_view& text)
{
    for (;;) {
        text.remove_prefix(std::min(text.find_first_not_of(" \t\f\r\v"), text.size()));
        const std::size_t lineEnd = std::min(text.find('\n'), text.size());
        if (text.starts_with('#'))
            text.remove_prefix(lineEnd);
        else if (text.starts_with('\\'))
            text.remove_prefix(std::min(lineEnd + 1, text.size()));
        else
            return;
    }
}

std::size_t sizeOfToken(std::string_view text)
{
    std::size_t size = 1;
    if (text.front() == '"') {
        while (size < text.size() && text[size] != '"')
            size += text[size] == '\\' ? 2 : 1;
        return std::min(size + 1, text.size());
    }
    while (isOfWord(text.front()) && size < text.size() && isOfWord(text[size]))
        ++size;
    return size;
}

// Removes the first statement and returns its tokens: words, texts in quotes and single characters.
// An empty line has none.
std::vector<std::string_view> removeStatement(std::string_view& text)
{
    std::vector<std::string_view> tokens;
    for (removeBlanks(text); !text.empty(); removeBlanks(text)) {
        const std::string_view token = text.substr(0, sizeOfToken(text));
        text.remove_prefix(token.size());
        if (token == "\n")
            break;
        tokens.push_back(token);
    }
    return tokens;
}

} // namespace

FeatureLines::FeatureLines(std::string_view configuration, bool hasErrors) : isUnclear_(hasErrors)
{
    Chips chips; // which the last `chip` line matches
    while (!configuration.empty() && !isUnclear_) {
        const auto statement = removeStatement(configuration);
        if (statement.size() < 2)
            continue;
        if (statement[0] == "chip") {
            chips.clear();
            for (auto token = std::next(statement.begin()); token != statement.end(); ++token)
                chips.merge(chipsOf(*token));
        } else if (statement[0] == "compute" || statement[0] == "label") {
            Features& features = statement[0] == "label" ? labelled_ : computed_;
            for (const sensors_chip_name* const chip : chips)
                features[chip].insert(nameOf(statement[1]));
        }
    }
}

std::string FeatureLines::nameOf(std::string_view token)
{
    if (token.find('\\') != std::string_view::npos) // the escapes of C are not decoded
        isUnclear_ = true;
    return std::string(token.starts_with('"') ? token.substr(1, token.size() - 2) : token);
}

FeatureLines::Chips FeatureLines::chipsOf(std::string_view token)
{
    Chips chips;
    sensors_chip_name pattern{};
    if (sensors_parse_chip_name(nameOf(token).c_str(), &pattern) != 0) {
        isUnclear_ = true;
        return chips;
    }
    // A `bus` line may give the adapter another number.
    if (pattern.bus.type == SENSORS_BUS_TYPE_I2C)
        pattern.bus.nr = SENSORS_BUS_NR_ANY;
    int position = 0;
    while (const sensors_chip_name* chip = sensors_get_detected_chips(&pattern, &position))
        chips.insert(chip);
    sensors_free_chip_name(&pattern);
    return chips;
}

bool FeatureLines::mayCompute(const sensors_chip_name& chip, const std::string& feature) const
{
    return isNamedIn(computed_, chip, feature);
}

bool FeatureLines::mayLabel(const sensors_chip_name& chip, const std::string& feature) const
{
    return isNamedIn(labelled_, chip, feature);
}

bool FeatureLines::isNamedIn(
    const Features& features, const sensors_chip_name& chip, const std::string& feature) const
{
    const auto found = features.find(&chip);
    return isUnclear_ || (found != features.end() && found->second.contains(feature));
}

} // namespace Vorn::Hwmon
