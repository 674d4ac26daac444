// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/machinefile/MachineFileReader.h"

#include "platform/instrumentation/Thousandths.h"
#include "platform/instrumentation/machinefile/MachineFileMembers.h"
#include "platform/text/Escape.h"
#include "platform/text/Utf8.h"

#include <nlohmann/json.hpp>

#include <algorithm>
#include <cstdint>
#include <initializer_list>
#include <memory>
#include <optional>
#include <sstream>
#include <stdexcept>
#include <string>
#include <type_traits>
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

// Calls a function with a locale at the end of its lifetime.
using LocalePointer = std::unique_ptr<std::remove_pointer_t<locale_t>, void (*)(locale_t)>;

// Returns a part of the file as an error message shows it: short and printable.
std::string excerpt(std::string_view text)
{
    constexpr std::size_t maximumExcerpt = 160;
    const std::string_view beginning = Text::cutAtCharacter(text, maximumExcerpt);
    return Text::toOneLine(beginning) + (beginning.size() < text.size() ? "..." : "");
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
    const auto line = std::ranges::count(before, '\n') + 1;
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
    // The parser reads numbers by strtod(), which expects a decimal comma in some locales. Where
    // memory is exhausted, the thread keeps its locale. It is restored before the other is freed.
    const LocalePointer plain(newlocale(LC_ALL_MASK, "C", nullptr), &freelocale);
    const LocalePointer former(uselocale(plain.get()), [](locale_t locale) { uselocale(locale); });
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

// Why a value is refused, and the place of that value below the one that is being read.
struct RefusedValue {
    std::string reason;
    Json::json_pointer place{};
};

// Calls a function that reads a part of a value. The name or the index of the part becomes the
// first step to the place of a refusal.
template <typename Step, typename Function>
void readPart(const Step& step, Function function)
{
    try {
        function();
    } catch (RefusedValue& refusal) {
        refusal.place = Json::json_pointer() / step / refusal.place;
        throw;
    }
}

std::string described(const Json& value)
{
    if (value.is_structured())
        return std::string("an ") + value.type_name();
    if (value.is_string())
        return "the string " + quote(value.get_ref<const std::string&>());
    return (value.is_number() ? "the number " : "") + value.dump();
}

[[noreturn]] void refuse(const std::string& expected, const Json& found)
{
    throw RefusedValue{"expected " + expected + ", found " + described(found)};
}

// Returns a value of one of the types in which the parser keeps values.
template <typename T>
const T& require(const Json& value, const char* expected)
{
    if (const T* const found = value.get_ptr<const T*>())
        return *found;
    refuse(expected, value);
}

void read(const Json& value, std::string& text)
{
    text = require<std::string>(value, "a string");
    if (text.find('\0') != std::string::npos)
        throw RefusedValue{"the string holds the character NUL"};
}

void read(const Json& value, NodeLexicon::NodeType& type)
{
    constexpr const char* expected = R"("temperature", "voltage" or "tachometer")";
    const auto known = std::ranges::find(Member::typeNames,
        std::string_view(require<std::string>(value, expected)), &Member::TypeName::name);
    if (known == Member::typeNames.end())
        refuse(expected, value);
    type = known->type;
}

void read(const Json& value, unsigned& code)
{
    constexpr const char* expected = "an unsigned 32-bit integer";
    const auto number = require<std::uint64_t>(value, expected);
    if (!std::in_range<std::uint32_t>(number))
        refuse(expected, value);
    code = static_cast<unsigned>(number);
}

void read(const Json& value, double& number)
{
    if (!value.is_number())
        refuse("a number", value);
    number = value.get<double>();
}

template <typename T>
void read(const Json& value, std::optional<T>& optional)
{
    read(value, optional.emplace());
}

template <typename T>
void readArray(const Json& value, std::vector<T>& elements, const char* expected)
{
    for (const Json& element : require<Json::array_t>(value, expected))
        readPart(elements.size(), [&] { read(element, elements.emplace_back()); });
}

void read(const Json& value, std::vector<unsigned>& codes)
{
    readArray(value, codes, "an array of unsigned 32-bit integers");
}

// Reads the members of an object into fields. visitFields(visit) calls visit(name, field) for each
// member that the object may have.
template <typename VisitFields>
void readMembers(const Json& value, VisitFields visitFields)
{
    const auto& members = require<Json::object_t>(value, "an object");
    for (auto member = members.begin(); member != members.end(); ++member) {
        readPart(member->first, [&] {
            if (members.find(member->first) != member)
                throw RefusedValue{"the member is there twice"};
            bool isKnown = false;
            visitFields([&](std::string_view name, auto& field) {
                if (name != member->first)
                    return;
                isKnown = true;
                read(member->second, field);
            });
            if (!isKnown)
                throw RefusedValue{"there is no such member"};
        });
    }
}

void requireMembers(const Json& object, std::initializer_list<std::string_view> names)
{
    for (const std::string_view name : names)
        if (!object.contains(name))
            throw RefusedValue{"member \"" + std::string(name) + "\" is missing"};
}

void read(const Json& value, MachineFileNode& node)
{
    readMembers(value, [&](auto visit) { Member::forEach(node, visit); });
    requireMembers(value, {Member::type, Member::path, Member::description});
    if (!value.contains(Member::sensorType))
        node.sensorType = static_cast<unsigned>(node.type);
    Member::changeThousandths(node, keepingThousandths);
}

void read(const Json& value, std::vector<MachineFileNode>& nodes)
{
    readArray(value, nodes, "an array");
    std::unordered_map<std::string_view, std::size_t> indices; // by path
    for (const MachineFileNode& node : nodes) {
        const auto [known, isNew] = indices.try_emplace(node.path, indices.size());
        if (!isNew)
            throw RefusedValue{quote(node.path) + " is the path of /nodes/" +
                                   std::to_string(known->second) + " already",
                Json::json_pointer() / indices.size() / std::string(Member::path)};
    }
}

MachineFile fileOf(const Json& value)
{
    MachineFile file;
    std::optional<double> period;
    std::optional<double> time;
    readMembers(value, [&](auto visit) {
        visit(Member::nodes, file.nodes);
        visit(Member::period, period);
        visit(Member::time, time);
    });
    requireMembers(value, {Member::nodes});
    if (period || time) {
        requireMembers(value, {Member::period, Member::time});
        if (*period <= 0)
            throw RefusedValue{
                "the period is not above 0", Json::json_pointer() / std::string(Member::period)};
        file.renewal = Renewal{*period, *time};
    }
    return file;
}

} // namespace

MachineFile readMachineFile(std::string_view text)
{
    const Json value = parsed(text);
    try {
        return fileOf(value);
    } catch (const RefusedValue& refusal) {
        const std::string place = excerpt(refusal.place.to_string());
        throw std::runtime_error((place.empty() ? "the document" : place) + ": " + refusal.reason);
    }
}

} // namespace Vorn
