// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <memory>
#include <string>
#include <vector>

namespace Testing {

// A regular expression of ECMAScript. The standard library's templates for it, which take seconds
// to compile, are in one file.
class Pattern {
public:
    explicit Pattern(const std::string& expression);

    // Returns whether the whole text matches.
    bool matches(const std::string& text) const { return !match(text).empty(); }

    // Returns the text and its groups; nothing unless the whole text matches.
    std::vector<std::string> match(const std::string& text) const;

    // Returns whether a part of the text matches.
    bool isIn(const std::string& text) const;

    // Returns the text with another one, in which $1 is the first group, for each match.
    std::string replace(const std::string& text, const std::string& by) const;

private:
    struct Compiled;
    std::shared_ptr<const Compiled> compiled_;
};

} // namespace Testing
