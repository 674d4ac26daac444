// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/cimxml/Element.h"

#include "host/cimxml/Characters.h"

#include <algorithm>

namespace Host::CimXml {

namespace {

std::string joined(std::initializer_list<std::string_view> names)
{
    std::string all;
    for (const std::string_view name : names)
        all.append(all.empty() ? "" : " or ").append(name);
    return all;
}

} // namespace

std::optional<std::string_view> Element::findAttribute(std::string_view attributeName) const
{
    for (const auto& [name, value] : attributes_)
        if (name == attributeName)
            return value;
    return std::nullopt;
}

std::string_view Element::attribute(std::string_view attributeName) const
{
    const auto found = findAttribute(attributeName);
    if (!found)
        fail("there is no attribute " + std::string(attributeName));
    return *found;
}

const std::vector<Element>& Element::children() const
{
    if (text_.find_first_not_of(xmlWhiteSpace) != std::string::npos)
        fail("there is text between the elements");
    return children_;
}

const std::vector<Element>& Element::children(std::initializer_list<std::string_view> names) const
{
    for (const Element& child : children())
        if (std::find(names.begin(), names.end(), child.name()) == names.end())
            child.fail("it does not belong into " + name_);
    return children_;
}

const Element& Element::child(std::initializer_list<std::string_view> names) const
{
    const Element* const found = findChild(names);
    if (found == nullptr)
        fail("it holds no " + joined(names));
    return *found;
}

const Element* Element::findChild(std::initializer_list<std::string_view> names) const
{
    const std::vector<Element>& found = children(names);
    if (found.size() > 1)
        found[1].fail("one element is all that " + name_ + " can hold");
    return found.empty() ? nullptr : &found.front();
}

const std::string& Element::content() const
{
    if (!children_.empty())
        children_.front().fail("it does not belong into " + name_);
    return text_;
}

void Element::fail(std::string_view why, Outcome outcome) const
{
    throw RequestError(
        outcome, position_.line, position_.offset, std::string(name_).append(": ").append(why));
}

} // namespace Host::CimXml
