// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The elements of a request: those that the protocol knows, with what they must hold.

#pragma once

#include "host/cimxml/RequestError.h"

#include <pugixml.hpp>

#include <cstddef>
#include <initializer_list>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace Host::CimXml {

// Part of a Document, which must outlive it. What the protocol does not know, elements as well
// as attributes, is passed over. All but the accessors throw RequestError
// (requestNotLooselyValid) at this element.
class Element {
public:
    Element(pugi::xml_node node, std::string_view text) : node_(node), text_(text) {}

    std::string_view name() const { return node_.name(); }
    bool is(std::string_view elementName) const { return name() == elementName; }

    std::optional<std::string_view> findAttribute(const char* attributeName) const;
    std::string_view attribute(const char* attributeName) const;

    // The elements in it, which must not hold any text beside them.
    std::vector<Element> children() const;
    // The same, all of which must be of these names.
    std::vector<Element> children(std::initializer_list<std::string_view> names) const;
    // The one element in it, of one of these names.
    Element child(std::initializer_list<std::string_view> names) const;
    // The same, or nothing when there is none.
    std::optional<Element> findChild(std::initializer_list<std::string_view> names) const;
    // Its text, which must be all it holds.
    std::string content() const;

    [[noreturn]] void fail(
        std::string_view why, Outcome outcome = Outcome::requestNotLooselyValid) const;

private:
    pugi::xml_node node_;
    std::string_view text_;
};

// A text as a tree of elements. Throws RequestError when requireWellFormed does.
class Document {
public:
    Document(std::string_view text, std::size_t maximumDepth);

    Element root() const { return {tree_.document_element(), text_}; }

private:
    std::string text_; // for the places of errors
    pugi::xml_document tree_;
};

} // namespace Host::CimXml
