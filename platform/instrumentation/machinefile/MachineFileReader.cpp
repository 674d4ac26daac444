// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/machinefile/MachineFileReader.h"

#include "platform/instrumentation/machinefile/MachineFileMembers.h"
#include "platform/text/Escape.h"
#include "platform/text/Utf8.h"

#include <nlohmann/json.hpp>

#include <algorithm>
#include <bitset>
#include <cstdint>
#include <limits>
#include <memory>
#include <sstream>
#include <stdexcept>
#include <string>
#include <unordered_map>
#include <utility>

#include <locale.h> // NOLINT(modernize-deprecated-headers): <clocale> need not declare newlocale

namespace Vorn {

namespace Member = MachineFileMember;

namespace {

// The members of an object in the order of the text. The library's own object types keep one of
// several members of the same name; this one keeps all, so that duplicates can be refused.
template <typename Key, typename Value, typename... Rest>
struct Members : nlohmann::ordered_map<Key, Value, Rest...> {
    using nlohmann::ordered_map<Key, Value, Rest...>::ordered_map;

    Value& operator[](const Key& key) { return this->emplace_back(key, Value()).second; }
};

using Json = nlohmann::basic_json<Members>;

// Sets this thread's locale to C during its lifetime: the parser reads numbers by strtod(), which
// expects a decimal comma in some locales.
class NumericLocale {
public:
    NumericLocale() : locale_(newlocale(LC_ALL_MASK, "C", nullptr)), previous_(uselocale(locale_))
    {
    }
    ~NumericLocale()
    {
        uselocale(previous_);
        if (locale_ != nullptr)
            freelocale(locale_);
    }
    NumericLocale(const NumericLocale&) = delete;
    NumericLocale& operator=(const NumericLocale&) = delete;

private:
    locale_t locale_; // null when memory is exhausted: the thread keeps its locale
    locale_t previous_;
};

// Returns a part of the file as an error message shows it: short and printable.
std::string excerpt(std::string_view text)
{
    constexpr std::size_t maximumExcerpt = 160;
    const std::string_view beginning = Text::cutAtCharacter(text, maximumExcerpt);
    return Text::escapeControls(Text::toValidUtf8(beginning)) +
           (beginning.size() < text.size() ? "..." : "");
}

std::string quote(std::string_view text)
{
    return '"' + excerpt(text) + '"';
}

// Throws for a place given as a number of bytes from 0; lines and columns are counted from 1,
// columns in bytes.
[[noreturn]] void failAt(std::string_view text, std::size_t at, std::string_view reason)
{
    const std::string_view before = text.substr(0, at);
    const auto line = std::count(before.begin(), before.end(), '\n') + 1;
    const std::size_t column = before.size() - (before.rfind('\n') + 1) + 1; // npos + 1 is 0
    throw std::runtime_error("line " + std::to_string(line) + ", column " + std::to_string(column) +
                             ": " + excerpt(reason));
}

// Returns the library's message without the name of the error and the place, which it begins with.
std::string_view reasonOf(std::string_view message)
{
    const auto skip = [&](std::string_view start, std::string_view end) {
        const std::size_t at = message.find(end);
        if (message.starts_with(start) && at != std::string_view::npos)
            message.remove_prefix(at + end.size());
    };
    skip("[json.exception", "] ");
    skip("parse error", ": ");
    return message;
}

// Throws where values are nested deeper than in any model file: the parser's memory for them would
// be many times that of the text.
void requireShallow(std::string_view text)
{
    constexpr int maximumDepth = 5; // one more than the format's: its own errors name the member
    int depth = 0;
    bool isInString = false;
    for (std::size_t at = 0; at < text.size(); ++at) {
        const char character = text[at];
        if (isInString && character == '\\')
            ++at; // what follows is part of the string
        else if (character == '"')
            isInString = !isInString;
        else if (!isInString && (character == '[' || character == '{') && ++depth > maximumDepth)
            failAt(text, at, "the values are nested too deeply");
        else if (!isInString && (character == ']' || character == '}'))
            --depth;
    }
}

Json parsed(std::string_view text)
{
    // The parser takes a NUL for the end of the text and would ignore what follows.
    if (const std::size_t nul = text.find('\0'); nul != std::string_view::npos)
        failAt(text, nul, "the file holds the character NUL");
    requireShallow(text);
    const NumericLocale decimalPoint;
    std::istringstream in{std::string(text)};
    try {
        return Json::parse(in);
    } catch (const Json::parse_error& error) {
        // The number of bytes read includes the one at fault.
        failAt(text, error.byte == 0 ? 0 : error.byte - 1, reasonOf(error.what()));
    } catch (const Json::out_of_range& error) {
        failAt(text, static_cast<std::size_t>(in.tellg()) - 1, reasonOf(error.what()));
    }
}

// One step of the path from the document to a value.
struct Place {
    const Place* parent = nullptr;
    std::string_view step = {};

    // Returns the JSON pointer (RFC 6901), empty for the document.
    std::string pointer() const
    {
        if (parent == nullptr)
            return {};
        std::string escaped = "/";
        for (const char character : step) {
            if (character == '~' || character == '/')
                escaped += character == '~' ? "~0" : "~1";
            else
                escaped += character;
        }
        return parent->pointer() + excerpt(escaped);
    }
};

[[noreturn]] void fail(const Place& place, const std::string& reason)
{
    const bool isDocument = place.parent == nullptr;
    throw std::runtime_error((isDocument ? "the document" : place.pointer()) + ": " + reason);
}

std::string described(const Json& value)
{
    if (value.is_object())
        return "an object";
    if (value.is_array())
        return "an array";
    if (value.is_string())
        return "the string " + quote(value.get_ref<const std::string&>());
    return (value.is_number() ? "the number " : "") + value.dump();
}

[[noreturn]] void refuse(const Place& place, const std::string& expected, const Json& found)
{
    fail(place, "expected " + expected + ", found " + described(found));
}

const Json::object_t& objectOf(const Json& value, const Place& place)
{
    if (!value.is_object())
        refuse(place, "an object", value);
    return value.get_ref<const Json::object_t&>();
}

const Json::array_t& arrayOf(const Json& value, const Place& place, const char* expected)
{
    if (!value.is_array())
        refuse(place, expected, value);
    return value.get_ref<const Json::array_t&>();
}

const std::string& textOf(const Json& value, const Place& place, const char* expected = "a string")
{
    if (!value.is_string())
        refuse(place, expected, value);
    const auto& text = value.get_ref<const std::string&>();
    if (text.find('\0') != std::string::npos)
        fail(place, "the string holds the character NUL");
    return text;
}

std::uint32_t codeOf(const Json& value, const Place& place)
{
    if (!value.is_number_unsigned() ||
        value.get<std::uint64_t>() > std::numeric_limits<std::uint32_t>::max())
        refuse(place, "an unsigned 32-bit integer", value);
    return value.get<std::uint32_t>();
}

double numberOf(const Json& value, const Place& place)
{
    if (!value.is_number())
        refuse(place, "a number", value);
    return value.get<double>();
}

std::vector<unsigned> codesOf(const Json& value, const Place& place)
{
    std::vector<unsigned> codes;
    for (const Json& code : arrayOf(value, place, "an array of unsigned 32-bit integers")) {
        const std::string index = std::to_string(codes.size());
        codes.push_back(codeOf(code, {&place, index}));
    }
    return codes;
}

NodeLexicon::NodeType typeOf(const Json& value, const Place& place)
{
    constexpr const char* expected = R"("temperature", "voltage" or "tachometer")";
    const std::string& name = textOf(value, place, expected);
    for (const Member::TypeName& known : Member::typeNames)
        if (known.name == name)
            return known.type;
    refuse(place, expected, value);
}

void readMember(std::string_view name, const Json& value, const Place& place, MachineFileNode& node)
{
    if (name == Member::type)
        node.type = typeOf(value, place);
    else if (name == Member::path)
        node.path = textOf(value, place);
    else if (name == Member::description)
        node.description = textOf(value, place);
    else if (name == Member::sensorType)
        node.sensorType = codeOf(value, place);
    else if (name == Member::status)
        node.values.status = codeOf(value, place);
    else if (name == Member::baseUnits)
        node.values.baseUnits = codeOf(value, place);
    else if (name == Member::possibleStates)
        node.values.possibleStates = codesOf(value, place);
    for (const Member::Number& number : Member::numbers)
        if (name == number.name)
            node.values.*number.value = numberOf(value, place);
}

std::size_t memberIndex(std::string_view name)
{
    return static_cast<std::size_t>(
        std::find(Member::all.begin(), Member::all.end(), name) - Member::all.begin());
}

MachineFileNode nodeOf(const Json& value, const Place& place)
{
    MachineFileNode node;
    std::bitset<Member::all.size()> seen;
    for (const auto& [name, member] : objectOf(value, place)) {
        const Place memberPlace{&place, name};
        const std::size_t index = memberIndex(name);
        if (index == seen.size())
            fail(memberPlace, "there is no such member");
        if (seen[index])
            fail(memberPlace, "the member is there twice");
        seen.set(index);
        readMember(name, member, memberPlace, node);
    }
    for (const std::string_view name : {Member::type, Member::path, Member::description})
        if (!seen[memberIndex(name)])
            fail(place, "member \"" + std::string(name) + "\" is missing");
    if (!seen[memberIndex(Member::sensorType)])
        node.sensorType = static_cast<unsigned>(node.type);
    return node;
}

std::vector<MachineFileNode> nodesOf(const Json& value, const Place& place)
{
    std::vector<MachineFileNode> nodes;
    std::unordered_map<std::string, std::size_t> indicesByPath;
    for (const Json& element : arrayOf(value, place, "an array")) {
        const std::string index = std::to_string(nodes.size());
        const Place nodePlace{&place, index};
        MachineFileNode node = nodeOf(element, nodePlace);
        const auto [known, isNew] = indicesByPath.try_emplace(node.path, nodes.size());
        if (!isNew)
            fail({&nodePlace, Member::path}, quote(node.path) + " is the path of /nodes/" +
                                                 std::to_string(known->second) + " already");
        nodes.push_back(std::move(node));
    }
    return nodes;
}

} // namespace

std::vector<MachineFileNode> readMachineFile(std::string_view text)
{
    const Json value = parsed(text);
    const Place document;
    const auto& members = objectOf(value, document);
    for (const auto& [name, member] : members)
        if (name != Member::nodes)
            fail({&document, name}, "there is no such member");
    if (members.empty())
        fail(document, "member \"nodes\" is missing");
    if (members.size() > 1)
        fail({&document, Member::nodes}, "the member is there twice");
    return nodesOf(members.front().second, {&document, Member::nodes});
}

} // namespace Vorn
