// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/objectmanagers/Request.h"

#include <utility>

namespace Testing {

std::vector<std::string> Request::arguments(const std::string& url) const
{

    std::vector<std::string> words = {operation};
    // References have no result class but the association.
    for (const auto& [option, value] : {std::pair(isReferences() ? "-arc" : "-ac", association),
             {"-arc", resultClass}, {"-ar", role}, {"-arr", resultRole}})
        if (!value.empty())
            words.insert(words.end(), {option, value});
    words.push_back(url);
    if (!properties.empty() || hasEmptyList)
        words.push_back(properties);
    return words;
}

std::ostream& operator<<(std::ostream& stream, const Request& request)
{
    for (const std::string& word : request.arguments(request.object))
        stream << word << ' ';
    return stream;
}

} // namespace Testing
