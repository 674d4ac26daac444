// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/cimxml/Element.h"

#include "host/cimxml/Characters.h"
#include "host/cimxml/WellFormed.h"

#include <algorithm>
#include <array>
#include <new>

namespace Host::CimXml {

namespace {

// The names of the protocol, sorted.
constexpr std::array<std::string_view, 68> knownNames = {"CIM", "CLASS", "CLASSNAME", "CLASSPATH",
    "CORRELATOR", "DECLARATION", "DECLGROUP", "DECLGROUP.WITHNAME", "DECLGROUP.WITHPATH",
    "ENUMERATIONCONTEXT", "ERROR", "EXPMETHODCALL", "EXPMETHODRESPONSE", "EXPPARAMVALUE", "HOST",
    "IMETHODCALL", "IMETHODRESPONSE", "INSTANCE", "INSTANCENAME", "INSTANCEPATH", "IPARAMVALUE",
    "IRETURNVALUE", "KEYBINDING", "KEYVALUE", "LOCALCLASSPATH", "LOCALINSTANCEPATH",
    "LOCALNAMESPACEPATH", "MESSAGE", "METHOD", "METHODCALL", "METHODRESPONSE", "MULTIEXPREQ",
    "MULTIEXPRSP", "MULTIREQ", "MULTIRSP", "NAMESPACE", "NAMESPACEPATH", "OBJECTPATH", "PARAMETER",
    "PARAMETER.ARRAY", "PARAMETER.REFARRAY", "PARAMETER.REFERENCE", "PARAMVALUE", "PROPERTY",
    "PROPERTY.ARRAY", "PROPERTY.REFERENCE", "QUALIFIER", "QUALIFIER.DECLARATION",
    "RESPONSEDESTINATION", "RETURNVALUE", "SCOPE", "SIMPLEEXPREQ", "SIMPLEEXPRSP", "SIMPLEREQ",
    "SIMPLEREQACK", "SIMPLERSP", "VALUE", "VALUE.ARRAY", "VALUE.INSTANCEWITHPATH",
    "VALUE.NAMEDINSTANCE", "VALUE.NAMEDOBJECT", "VALUE.NULL", "VALUE.OBJECT",
    "VALUE.OBJECTWITHLOCALPATH", "VALUE.OBJECTWITHPATH", "VALUE.REFARRAY", "VALUE.REFERENCE",
    "VALUE.REFERENCEARRAY"};
static_assert(std::is_sorted(knownNames.begin(), knownNames.end()));

bool isKnown(std::string_view name)
{
    return std::binary_search(knownNames.begin(), knownNames.end(), name);
}

bool isText(const pugi::xml_node& node)
{
    return node.type() == pugi::node_pcdata || node.type() == pugi::node_cdata;
}

std::string joined(std::initializer_list<std::string_view> names)
{
    std::string all;
    for (const std::string_view name : names)
        all.append(all.empty() ? "" : " or ").append(name);
    return all;
}

} // namespace

std::optional<std::string_view> Element::findAttribute(const char* attributeName) const
{
    const pugi::xml_attribute found = node_.attribute(attributeName);
    return found ? std::optional<std::string_view>(found.value()) : std::nullopt;
}

std::string_view Element::attribute(const char* attributeName) const
{
    const auto found = findAttribute(attributeName);
    if (!found)
        fail("there is no attribute " + std::string(attributeName));
    return *found;
}

std::vector<Element> Element::children() const
{
    std::vector<Element> found;
    for (const pugi::xml_node& child : node_) {
        if (isText(child) && !trimmed(child.value()).empty())
            fail("there is text between the elements");
        if (child.type() == pugi::node_element && isKnown(child.name()))
            found.emplace_back(child, text_);
    }
    return found;
}

std::vector<Element> Element::children(std::initializer_list<std::string_view> names) const
{
    std::vector<Element> found = children();
    for (const Element& child : found)
        if (std::find(names.begin(), names.end(), child.name()) == names.end())
            child.fail("it does not belong into " + std::string(name()));
    return found;
}

Element Element::child(std::initializer_list<std::string_view> names) const
{
    const auto found = findChild(names);
    if (!found)
        fail("it holds no " + joined(names));
    return *found;
}

std::optional<Element> Element::findChild(std::initializer_list<std::string_view> names) const
{
    const std::vector<Element> found = children(names);
    if (found.size() > 1)
        found[1].fail("one element is all that " + std::string(name()) + " can hold");
    return found.empty() ? std::nullopt : std::optional(found.front());
}

std::string Element::content() const
{
    std::string all;
    for (const pugi::xml_node& child : node_) {
        if (isText(child))
            all += child.value();
        else if (child.type() == pugi::node_element && isKnown(child.name()))
            Element(child, text_).fail("it does not belong into " + std::string(name()));
    }
    return all;
}

void Element::fail(std::string_view why, Outcome outcome) const
{
    throw RequestError(outcome, text_, static_cast<std::size_t>(node_.offset_debug()),
        std::string(name()).append(": ").append(why));
}

Document::Document(std::string_view text, std::size_t maximumDepth) : text_(text)
{
    static constexpr std::string_view byteOrderMark = "\xEF\xBB\xBF";
    if (text_.starts_with(byteOrderMark))
        text_.erase(0, byteOrderMark.size());
    requireWellFormed(text_, maximumDepth);
    // White space may be all of a value.
    const pugi::xml_parse_result result = tree_.load_buffer(text_.data(), text_.size(),
        pugi::parse_default | pugi::parse_ws_pcdata, pugi::encoding_utf8);
    if (result.status == pugi::status_out_of_memory)
        throw std::bad_alloc();
    if (!result)
        throw RequestError(Outcome::requestNotWellFormed, text_,
            static_cast<std::size_t>(result.offset), result.description());
}

} // namespace Host::CimXml
