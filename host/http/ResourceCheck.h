// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/http/RequestHead.h"

#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace Host::Http {

// Throws HttpError with the answer to a request by another method than GET and HEAD, and to one
// through a loopback address whose Host is not this machine: a page in a browser of this machine
// could read the resource by a name of its own that it has resolve to the address (DNS rebinding).
void checkResourceRequest(const RequestHead& head, bool isLoopback);

// Returns the largest weight that the request gives to a media type by its name, without a version
// or with this one (RFC 9110, 12.4.2 and 12.5.1); 0 where it does not name it.
double weightOf(const RequestHead& head, std::string_view mediaType, std::string_view version);

struct WeightedElement {
    std::string_view value;
    double weight;
};

// Returns the elements of a field such as Accept-Language (RFC 9110, 12.4.2). They refer to the
// head.
std::vector<WeightedElement> weightedElements(const RequestHead& head, std::string_view field);

// Returns the names and values in the query of the target, decoded as forms are encoded: a plus
// sign is a blank.
std::vector<std::pair<std::string, std::string>> queryOf(const RequestHead& head);

} // namespace Host::Http
