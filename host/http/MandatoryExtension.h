// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// M-POST: a POST that a server may only answer when it knows what the extension means.

#pragma once

#include <string>
#include <string_view>

namespace Host::Http {

struct RequestHead;

inline constexpr std::string_view mandatoryExtension = "http://www.dmtf.org/cim/mapping/http/v1.0";

// The digits that the header field Man declares to stand before the names of this extension's
// fields. Throws HttpError when Man is missing, makes no sense or declares another extension.
std::string mandatoryExtensionOf(const RequestHead& head);

} // namespace Host::Http
