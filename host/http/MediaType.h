// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <string_view>

namespace Host::Http {

// Whether a Content-Type is application/xml or text/xml, without charset or with that of UTF-8.
bool isXmlInUtf8(std::string_view contentType);

} // namespace Host::Http
