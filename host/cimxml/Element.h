// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The elements of the protocol in a request (DSP0201).

#pragma once

#include "host/cimxml/RequestError.h"

#include <cstddef>
#include <initializer_list>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace Host::CimXml {

inline constexpr std::size_t defaultMaximumDepth = 64;
inline constexpr std::size_t maximumElements = 100'000;
inline constexpr std::size_t maximumAttributes = 16; // of one element

// An element with the elements in it. All functions but the accessors throw RequestError
// (requestNotLooselyValid) at this element when it is not as they require.
class Element {
public:
    struct Position {
        std::size_t line = 1;   // counts from 1
        std::size_t offset = 0; // bytes before the place
    };

    Element(std::string name, Position position) : name_(std::move(name)), position_(position) {}

    const std::string& name() const noexcept { return name_; }
    bool is(std::string_view elementName) const noexcept { return name_ == elementName; }

    std::optional<std::string_view> findAttribute(std::string_view attributeName) const;
    std::string_view attribute(std::string_view attributeName) const;

    // Returns the elements in it, which must not hold any text beside them.
    const std::vector<Element>& children() const;
    // Returns the elements in it, all of which must be of these names.
    const std::vector<Element>& children(std::initializer_list<std::string_view> names) const;
    // Returns the one element in it, which must be of one of these names.
    const Element& child(std::initializer_list<std::string_view> names) const;
    // Returns the one element in it, which must be of one of these names; null when there is none.
    const Element* findChild(std::initializer_list<std::string_view> names) const;
    // Returns its text. It must contain no elements.
    const std::string& content() const;

    [[noreturn]] void fail(
        std::string_view why, Outcome outcome = Outcome::requestNotLooselyValid) const;

private:
    friend class DocumentReader;

    std::string name_;
    Position position_;
    std::vector<std::pair<std::string, std::string>> attributes_;
    std::vector<Element> children_;
    std::string text_;
};

// Reads a text as XML 1.0 in UTF-8 and returns its outermost element. Elements and attributes that
// are not of the protocol are skipped, as DSP0200 requires of servers. A document type declaration
// is refused, so that no entities are declared or expanded. Takes time and memory in proportion to
// the text. Throws RequestError: requestNotWellFormed, or requestNotValid for a document type
// declaration and beyond the bounds.
Element readDocument(std::string_view text, std::size_t maximumDepth = defaultMaximumDepth);

} // namespace Host::CimXml
