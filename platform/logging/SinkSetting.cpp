// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/logging/SinkSetting.h"

#include <string_view>

namespace RynLog {

std::optional<SinkSetting> parseSinkSetting(const std::string& text)
{
    constexpr std::string_view filePrefix = "file:";
    if (text == "off")
        return SinkSetting{SinkSetting::Kind::off};
    if (text == "syslog")
        return SinkSetting{SinkSetting::Kind::syslog};
    if (text == "stderr")
        return SinkSetting{SinkSetting::Kind::standardError};
    if (text.starts_with(filePrefix) && text.size() > filePrefix.size())
        return SinkSetting{SinkSetting::Kind::file, text.substr(filePrefix.size())};
    return std::nullopt;
}

} // namespace RynLog
