// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/hwmon/ChannelReader.h"

#include "platform/instrumentation/Thousandths.h"
#include "platform/instrumentation/hwmon/ChipList.h"
#include "platform/text/Trim.h"

#include <fcntl.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <charconv>
#include <cmath>
#include <string_view>

namespace Vorn::Hwmon {

namespace {

// Returns the number at the beginning of a file, whatever the process's locale is; nothing when it
// cannot be read.
std::optional<double> readNumber(int folder, const std::string& name)
{
    const Descriptor file(openat(folder, name.c_str(), O_RDONLY | O_CLOEXEC));
    std::array<char, 64> block;
    ssize_t count = 0;
    do
        count = read(file.number(), block.data(), block.size());
    while (count < 0 && errno == EINTR);
    if (count < 0)
        return std::nullopt;
    std::string_view text(block.data(), static_cast<std::size_t>(count));
    text.remove_prefix(std::min(text.find_first_not_of(Text::asciiBlanks), text.size()));
    if (text.starts_with('+'))
        text.remove_prefix(1);
    double number = 0.0;
    const char* const end = text.data() + text.size();
    const auto result = std::from_chars(text.data(), end, number);
    const bool isHexadecimal = result.ptr != end && (*result.ptr == 'x' || *result.ptr == 'X');
    return result.ec == std::errc() && !isHexadecimal ? std::optional(number) : std::nullopt;
}

// Returns nothing when the attribute cannot be read, and when its value, after a `compute` line, is
// not a finite number.
std::optional<double> valueOf(
    const Attribute& attribute, const Chip& chip, int folder, const Feature& feature)
{
    std::optional<double> value;
    if (attribute.isComputed)
        value = ChipList::instance().computedValue(chip, feature, attribute);
    else if ((value = readNumber(folder, attribute.file)))
        *value /= attribute.meaning->divisor;
    if (value && !std::isfinite(*value))
        value.reset();
    return value;
}

} // namespace

ChannelState readChannel(const Chip& chip, int folder, const Feature& feature)
{
    ChannelState channel;
    for (const Attribute& attribute : feature.attributes) {
        std::optional<double> value = valueOf(attribute, chip, folder, feature);
        if (value && feature.type == NodeLexicon::NodeType::Voltage)
            value = keepingThousandths(*value);
        attribute.meaning->store(channel, value);
    }
    channel.limits = withoutUnset(channel.limits);
    return channel;
}

} // namespace Vorn::Hwmon
