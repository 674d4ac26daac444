// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/model/ModelBuilder.h"

#include "platform/instrumentation/model/Quote.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <limits>
#include <optional>
#include <stdexcept>
#include <utility>

namespace Vorn {

namespace Member = ModelMember;

namespace {

bool isTextMember(std::string_view name)
{
    return name == Member::type || name == Member::path || name == Member::description;
}

bool isCodeMember(std::string_view name)
{
    return name == Member::sensorType || name == Member::status || name == Member::baseUnits;
}

std::optional<double> NodeReading::*numberMember(std::string_view name)
{
    for (const Member::Number& number : Member::numbers)
        if (number.name == name)
            return number.value;
    return nullptr;
}

// The number of a member of a node, or that of the last and one when there is no such member.
std::size_t memberIndex(std::string_view name)
{
    return static_cast<std::size_t>(
        std::find(Member::all.begin(), Member::all.end(), name) - Member::all.begin());
}

// One step of a JSON pointer (RFC 6901).
std::string pointerStep(std::string_view name)
{
    std::string step = "/";
    for (const char character : name) {
        if (character == '~' || character == '/')
            step += character == '~' ? "~0" : "~1";
        else
            step += character;
    }
    return excerpt(step);
}

std::string decimal(double value)
{
    std::array<char, 32> digits{};
    const auto end = std::to_chars(digits.begin(), digits.end(), value).ptr;
    return {digits.begin(), end};
}

} // namespace

std::string ModelBuilder::pointer() const
{
    const std::string node = "/nodes/" + std::to_string(nodes_.size());
    switch (place_) {
    case Place::Document:
        return "the document";
    case Place::Root:
        return pointerStep(key_);
    case Place::Nodes:
        return node;
    case Place::Node:
        return node + pointerStep(key_);
    case Place::States:
        break;
    }
    return node + "/possibleStates/" + std::to_string(node_.values.possibleStates->size());
}

std::string ModelBuilder::expected() const
{
    constexpr const char* code = "an unsigned 32-bit integer";
    switch (place_) {
    case Place::Document:
    case Place::Nodes:
        return "an object";
    case Place::Root:
        return "an array";
    case Place::States:
        return code;
    case Place::Node:
        break;
    }
    if (key_ == Member::type)
        return R"("temperature", "voltage" or "tachometer")";
    if (key_ == Member::possibleStates)
        return "an array of unsigned 32-bit integers";
    if (isTextMember(key_))
        return "a string";
    return isCodeMember(key_) ? code : "a number";
}

void ModelBuilder::fail(const std::string& reason) const
{
    throw std::runtime_error(pointer() + ": " + reason);
}

void ModelBuilder::refuse(const std::string& found) const
{
    fail("expected " + expected() + ", found " + found);
}

void ModelBuilder::beginObject()
{
    if (place_ == Place::Document) {
        place_ = Place::Root;
    } else if (place_ == Place::Nodes) {
        place_ = Place::Node;
        node_ = {};
        seen_.reset();
    } else {
        refuse("an object");
    }
}

void ModelBuilder::endObject()
{
    if (place_ == Place::Node)
        return finishNode();
    place_ = Place::Document;
    if (!hasNodes_)
        fail("member \"nodes\" is missing");
}

void ModelBuilder::beginArray()
{
    if (place_ == Place::Root) {
        place_ = Place::Nodes;
    } else if (place_ == Place::Node && key_ == Member::possibleStates) {
        place_ = Place::States;
        node_.values.possibleStates.emplace();
    } else {
        refuse("an array");
    }
}

void ModelBuilder::endArray()
{
    place_ = place_ == Place::States ? Place::Node : Place::Root;
}

void ModelBuilder::key(const std::string& name)
{
    key_ = name;
    if (!isFirst(name))
        fail("the member is there twice");
}

// Whether the member comes up for the first time; refuses what is no member at all.
bool ModelBuilder::isFirst(const std::string& name)
{
    const std::size_t index = memberIndex(name);
    if (place_ == Place::Root ? name != Member::nodes : index == seen_.size())
        fail("there is no such member");
    if (place_ == Place::Root)
        return !std::exchange(hasNodes_, true);
    const bool wasSeen = seen_[index];
    seen_.set(index);
    return !wasSeen;
}

void ModelBuilder::text(const std::string& value)
{
    if (place_ != Place::Node || !isTextMember(key_))
        refuse("the string " + quote(value));
    if (value.find('\0') != std::string::npos)
        fail("the string holds the character NUL");
    if (key_ == Member::type)
        setType(value);
    else if (key_ == Member::path)
        setPath(value);
    else
        node_.description = value;
}

void ModelBuilder::number(double value)
{
    const auto member = place_ == Place::Node ? numberMember(key_) : nullptr;
    if (member == nullptr)
        refuse("the number " + decimal(value));
    node_.values.*member = value;
}

void ModelBuilder::code(std::uint64_t value)
{
    const bool isState = place_ == Place::States;
    if (!isState && (place_ != Place::Node || !isCodeMember(key_)))
        return number(static_cast<double>(value));
    if (value > std::numeric_limits<std::uint32_t>::max())
        refuse("the number " + std::to_string(value));
    const auto code = static_cast<std::uint32_t>(value);
    if (isState)
        node_.values.possibleStates->push_back(code);
    else if (key_ == Member::sensorType)
        node_.sensorType = code;
    else if (key_ == Member::status)
        node_.values.status = code;
    else
        node_.values.baseUnits = code;
}

void ModelBuilder::other(std::string_view value)
{
    refuse(std::string(value));
}

void ModelBuilder::setType(const std::string& name)
{
    const auto known = std::find_if(Member::typeNames.begin(), Member::typeNames.end(),
        [&](const Member::TypeName& typeName) { return typeName.name == name; });
    if (known == Member::typeNames.end())
        refuse("the string " + quote(name));
    node_.type = known->type;
}

void ModelBuilder::setPath(const std::string& path)
{
    const auto [known, isNew] = indicesByPath_.try_emplace(path, nodes_.size());
    if (!isNew)
        fail(quote(path) + " is the path of /nodes/" + std::to_string(known->second) + " already");
    node_.path = path;
}

void ModelBuilder::finishNode()
{
    place_ = Place::Nodes;
    for (const std::string_view name : {Member::type, Member::path, Member::description})
        if (!seen_[memberIndex(name)])
            fail("member \"" + std::string(name) + "\" is missing");
    if (!seen_[memberIndex(Member::sensorType)])
        node_.sensorType = static_cast<unsigned>(node_.type);
    nodes_.push_back(std::move(node_));
}

std::vector<ModelNode> ModelBuilder::takeNodes()
{
    return std::move(nodes_);
}

} // namespace Vorn
