// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/http/Resource.h"
#include "host/http/UnsentObjects.h"

#include <memory>
#include <string>
#include <utility>
#include <vector>

namespace Tools {

// The size of all texts that clients have yet to fetch. The metrics of 10,000 sensors fit three
// times.
inline constexpr std::size_t maximumUnsentBytes = std::size_t{64} << 20;

// The answer to clients whose text does not fit.
inline Host::Http::HttpError tooMuchUnsentText()
{
    return Host::Http::HttpError::closing(
        503, "clients have yet to fetch too much text", {{"Retry-After", "1"}});
}

// A text that clients have yet to fetch.
struct UnsentText {
    // Throws HttpError where it does not fit.
    UnsentText(std::string text, Host::Http::UnsentObjects& unsent)
        : content(std::move(text)), share(unsent.hold(content.size()))
    {
        if (!share)
            throw tooMuchUnsentText();
    }

    std::string content;
    Host::Http::UnsentObjects::Share share; // counts the bytes
};

inline Host::Http::Representation representationOf(
    const std::shared_ptr<const UnsentText>& text, std::vector<Host::Http::HeaderField> fields)
{
    return {std::move(fields), {text, &text->content}};
}

} // namespace Tools
