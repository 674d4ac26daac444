// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/machinefile/MachineFileReader.h"

#include "platform/instrumentation/Thousandths.h"
#include "platform/instrumentation/machinefile/MachineFileMembers.h"
#include "platform/text/Escape.h"
#include "platform/text/Utf8.h"

#include <nlohmann/json.hpp>

#include <algorithm>
#include <cstdint>
#include <limits>
#include <optional>
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
    const std::size_t place = message.find(": ");
    return message.substr((place == std::string_view::npos ? message.find("] ") : place) + 2);
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

// Returns a value of one of the types in which the parser keeps values.
template <typename T>
const T& require(const Json& value, const Place& place, const char* expected)
{
    if (const T* const found = value.get_ptr<const T*>())
        return *found;
    refuse(place, expected, value);
}

void read(
    const Json& value, const Place& place, std::string& text, const char* expected = "a string")
{
    text = require<std::string>(value, place, expected);
    if (text.find('\0') != std::string::npos)
        fail(place, "the string holds the character NUL");
}

void read(const Json& value, const Place& place, NodeLexicon::NodeType& type)
{
    constexpr const char* expected = R"("temperature", "voltage" or "tachometer")";
    std::string name;
    read(value, place, name, expected);
    for (const Member::TypeName& known : Member::typeNames) {
        if (known.name == name) {
            type = known.type;
            return;
        }
    }
    refuse(place, expected, value);
}

void read(const Json& value, const Place& place, unsigned& code)
{
    constexpr const char* expected = "an unsigned 32-bit integer";
    const auto number = require<std::uint64_t>(value, place, expected);
    if (number > std::numeric_limits<std::uint32_t>::max())
        refuse(place, expected, value);
    code = static_cast<unsigned>(number);
}

void read(const Json& value, const Place& place, std::vector<unsigned>& codes)
{
    for (const Json& code :
        require<Json::array_t>(value, place, "an array of unsigned 32-bit integers")) {
        const std::string index = std::to_string(codes.size());
        read(code, {&place, index}, codes.emplace_back());
    }
}

void read(const Json& value, const Place& place, double& number)
{
    if (!value.is_number())
        refuse(place, "a number", value);
    number = value.get<double>();
}

template <typename T>
void read(const Json& value, const Place& place, std::optional<T>& optional)
{
    read(value, place, optional.emplace());
}

void readMember(std::string_view name, const Json& value, const Place& place, MachineFileNode& node)
{
    bool isKnown = false;
    Member::forEach(node, [&](std::string_view known, auto& field) {
        if (known != name)
            return;
        isKnown = true;
        read(value, place, field);
    });
    if (!isKnown)
        fail(place, "there is no such member");
}

// Throws unless the member is the first of its name.
void requireFirst(
    const Json::object_t& members, Json::object_t::const_iterator member, const Place& place)
{
    if (members.find(member->first) != member)
        fail(place, "the member is there twice");
}

void requireMember(const Json::object_t& members, const Place& place, std::string_view name)
{
    if (members.count(std::string(name)) == 0)
        fail(place, "member \"" + std::string(name) + "\" is missing");
}

MachineFileNode nodeOf(const Json& value, const Place& place)
{
    MachineFileNode node;
    const auto& members = require<Json::object_t>(value, place, "an object");
    for (auto member = members.begin(); member != members.end(); ++member) {
        const Place memberPlace{&place, member->first};
        requireFirst(members, member, memberPlace);
        readMember(member->first, member->second, memberPlace, node);
    }
    for (const std::string_view name : {Member::type, Member::path, Member::description})
        requireMember(members, place, name);
    if (members.count(std::string(Member::sensorType)) == 0)
        node.sensorType = static_cast<unsigned>(node.type);
    Member::changeThousandths(node, keepingThousandths);
    return node;
}

std::vector<MachineFileNode> nodesOf(const Json& value, const Place& place)
{
    std::vector<MachineFileNode> nodes;
    std::unordered_map<std::string, std::size_t> indicesByPath;
    for (const Json& element : require<Json::array_t>(value, place, "an array")) {
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

MachineFile readMachineFile(std::string_view text)
{
    const Json value = parsed(text);
    const Place document;
    const auto& members = require<Json::object_t>(value, document, "an object");
    MachineFile file;
    std::optional<double> period;
    std::optional<double> time;
    for (auto member = members.begin(); member != members.end(); ++member) {
        const auto& [name, content] = *member;
        const Place place{&document, name};
        requireFirst(members, member, place);
        if (name == Member::nodes)
            file.nodes = nodesOf(content, place);
        else if (name == Member::period)
            read(content, place, period);
        else if (name == Member::time)
            read(content, place, time);
        else
            fail(place, "there is no such member");
    }
    requireMember(members, document, Member::nodes);
    if (period.has_value() != time.has_value())
        requireMember(members, document, period ? Member::time : Member::period);
    if (period && *period <= 0)
        fail({&document, Member::period}, "the period is not above 0");
    if (period)
        file.renewal = {*period, *time};
    return file;
}

} // namespace Vorn
