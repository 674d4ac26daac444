// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/cim/PathText.h"

#include "host/broker/ClassInformation.h"
#include "host/broker/Names.h"
#include "host/broker/ObjectPath.h"
#include "tools/UsageError.h"
#include "tools/cim/ProviderClient.h"

#include <algorithm>
#include <charconv>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>

namespace Tools {

namespace {

constexpr unsigned deepest = Host::Value::maximumNesting - 1;

// The parts of a path, as views of its text.
struct Parts {
    std::string_view host;
    std::string_view nameSpace;
    std::string_view className;
    std::string_view keys; // what follows the dot
};

// Removes the text up to and including the first delimiter. Returns the part before it; an empty
// text, and removes nothing, when there is no delimiter.
std::string_view takeBefore(std::string_view& text, char delimiter)
{
    const auto place = text.find(delimiter);
    if (place == std::string_view::npos)
        return {};
    const std::string_view before = text.substr(0, place);
    text.remove_prefix(place + 1);
    return before;
}

Parts partsOf(std::string_view text)
{
    Parts parts;
    if (text.starts_with("//")) {
        text.remove_prefix(2);
        parts.host = takeBefore(text, '/');
    }
    // A colon within a quoted value ends no namespace.
    if (const auto colon = text.find(':'); colon < text.find('"'))
        parts.nameSpace = takeBefore(text, ':');
    parts.className = takeBefore(text, '.');
    parts.keys = text;
    return parts;
}

// Reads the keys of one path. Throws UsageError with the column in the text.
class KeyReader {
public:
    KeyReader(std::string_view text, std::string_view keys) : text_(text), rest_(keys) {}

    // Calls the visitor for each key with its name, its text and whether that is quoted.
    template <typename Visit>
    void read(const Visit& visit)
    {
        do {
            const std::string_view name = takeName();
            begin_ = rest_;
            const bool isQuoted = rest_.starts_with('"');
            visit(name, isQuoted ? takeQuoted() : takePlain(), isQuoted);
        } while (take(','));
        if (!rest_.empty())
            fail(rest_, "expected a comma or the end");
    }

    // Throws UsageError for the value that is being visited.
    [[noreturn]] void refuseValue(const std::string& reason) const { fail(begin_, reason); }

private:
    [[noreturn]] void fail(std::string_view place, const std::string& reason) const
    {
        const std::size_t column = text_.size() - place.size() + 1;
        throw UsageError(std::string(text_) + ": column " + std::to_string(column) + ": " + reason);
    }

    bool take(char wanted)
    {
        if (!rest_.starts_with(wanted))
            return false;
        rest_.remove_prefix(1);
        return true;
    }

    std::string_view takeName()
    {
        const auto end = rest_.find_first_of("=,\"");
        if (end == 0 || end == std::string_view::npos || rest_[end] != '=')
            fail(rest_, "expected the name of a key and =");
        const std::string_view name = rest_.substr(0, end);
        rest_.remove_prefix(end + 1);
        return name;
    }

    std::string takeQuoted()
    {
        std::string text;
        for (rest_.remove_prefix(1); !rest_.empty(); rest_.remove_prefix(1)) {
            if (take('"'))
                return text;
            if (rest_.front() == '\\' && rest_.size() > 1)
                rest_.remove_prefix(1);
            text += rest_.front();
        }
        fail(begin_, "the quotes are not closed");
    }

    std::string takePlain()
    {
        std::string text(rest_.substr(0, rest_.find(',')));
        rest_.remove_prefix(text.size());
        return text;
    }

    std::string_view text_;
    std::string_view rest_;
    std::string_view begin_; // of the value, to the end of the text
};

template <typename Number>
std::optional<Number> numberIn(std::string_view text)
{
    Number number{};
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number);
    if (error != std::errc{} || end != text.data() + text.size())
        return std::nullopt;
    return number;
}

// Returns the value of an unquoted text; nothing when it is neither a number nor a boolean.
std::optional<Host::Value> plainValue(std::string_view text)
{
    if (const auto number = numberIn<std::uint64_t>(text))
        return Host::Value::integer(CMPI_uint64, *number);
    if (const auto number = numberIn<std::int64_t>(text))
        return Host::Value::integer(CMPI_sint64, static_cast<std::uint64_t>(*number));
    if (Host::equalNames(text, "TRUE") || Host::equalNames(text, "FALSE"))
        return Host::Value::boolean(Host::equalNames(text, "TRUE"));
    return std::nullopt;
}

const Host::ObjectPath* readPath(Host::Arena& arena, const Host::ClassInformation& classes,
    std::string_view text, unsigned depth)
{
    const Parts parts = partsOf(text);
    const std::string_view itsNameSpace = parts.nameSpace.empty() ? nameSpace : parts.nameSpace;
    if (classes.keysOf(itsNameSpace, parts.className) == nullptr)
        return nullptr;
    Host::ObjectPath& path = Host::ObjectPath::make(arena, itsNameSpace, parts.className);
    if (!parts.host.empty())
        path.setHost(std::string(parts.host).c_str());
    const auto references = classes.referencesOf(itsNameSpace, parts.className);
    KeyReader reader(text, parts.keys);
    reader.read([&](std::string_view name, const std::string& value, bool isQuoted) {
        const bool isReference = std::any_of(references.begin(), references.end(),
            [&](const auto& reference) { return Host::equalNames(reference.name, name); });
        if (isReference) {
            const Host::ObjectPath* const target =
                isQuoted && depth < deepest ? readPath(arena, classes, value, depth + 1) : nullptr;
            if (target == nullptr)
                reader.refuseValue("expected the path of an object of a known class, in quotes");
            path.addKey(name, Host::Value::of(*target));
        } else if (isQuoted) {
            path.addKey(name, Host::Value::text(arena, value));
        } else if (const auto plain = plainValue(value)) {
            path.addKey(name, *plain);
        } else {
            reader.refuseValue("expected a text in quotes, a number, TRUE or FALSE");
        }
    });
    return &path;
}

} // namespace

const Host::ObjectPath* readPath(
    Host::Arena& arena, const Host::ClassInformation& classes, std::string_view text)
{
    return readPath(arena, classes, text, 0);
}

} // namespace Tools
