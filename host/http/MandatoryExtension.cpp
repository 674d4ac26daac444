// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/MandatoryExtension.h"

#include "host/broker/Names.h"
#include "host/http/RequestHead.h"

#include <algorithm>

namespace Host::Http {

namespace {

constexpr std::size_t digitsOfPrefix = 2;

bool isPrefix(std::string_view text)
{
    return text.size() == digitsOfPrefix &&
           std::all_of(text.begin(), text.end(), [](char c) { return c >= '0' && c <= '9'; });
}

} // namespace

std::string mandatoryExtensionOf(const RequestHead& head)
{
    const auto declared = head.find("Man");
    if (!declared)
        throw HttpError(Status::badRequest, "an M-POST must have the header field Man");
    const std::size_t end = declared->find(';');
    if (withoutQuotes(withoutBlanks(declared->substr(0, end))) != mandatoryExtension)
        throw HttpError(Status::notExtended,
            "the only mandatory extension is " + std::string(mandatoryExtension));
    const std::string_view parameter =
        end == std::string_view::npos ? "" : withoutBlanks(declared->substr(end + 1));
    const std::size_t equals = parameter.find('=');
    if (equals != std::string_view::npos &&
        equalNames(withoutBlanks(parameter.substr(0, equals)), "ns")) {
        const std::string_view prefix = withoutBlanks(parameter.substr(equals + 1));
        if (isPrefix(prefix))
            return std::string(prefix);
    }
    throw HttpError(Status::badRequest, "the header field Man must end with ;ns= and two digits");
}

} // namespace Host::Http
