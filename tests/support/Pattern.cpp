// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/support/Pattern.h"

#include <regex>

namespace Testing {

struct Pattern::Compiled {
    std::regex expression;
};

Pattern::Pattern(const std::string& expression)
    : compiled_(std::make_shared<const Compiled>(Compiled{std::regex(expression)}))
{
}

std::vector<std::string> Pattern::match(const std::string& text) const
{
    std::smatch found;
    std::regex_match(text, found, compiled_->expression);
    return {found.begin(), found.end()};
}

bool Pattern::isIn(const std::string& text) const
{
    return std::regex_search(text, compiled_->expression);
}

std::string Pattern::replace(const std::string& text, const std::string& by) const
{
    return std::regex_replace(text, compiled_->expression, by);
}

} // namespace Testing
