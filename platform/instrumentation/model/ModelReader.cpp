// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/model/ModelReader.h"

#include "platform/instrumentation/model/ModelBuilder.h"
#include "platform/instrumentation/model/NumericLocale.h"
#include "platform/instrumentation/model/Quote.h"

#include <nlohmann/json.hpp>

#include <algorithm>
#include <stdexcept>
#include <string>

namespace Vorn {

namespace {

// `at` counts bytes from 0; lines and columns are counted from 1, columns in bytes.
[[noreturn]] void failAt(std::string_view text, std::size_t at, std::string_view reason)
{
    const std::string_view before = text.substr(0, std::min(at, text.size()));
    const auto line = std::count(before.begin(), before.end(), '\n') + 1;
    const std::size_t column = before.size() - (before.rfind('\n') + 1) + 1; // npos + 1 is 0
    throw std::runtime_error("line " + std::to_string(line) + ", column " + std::to_string(column) +
                             ": " + excerpt(reason));
}

// The library's message without its own name for the error and without the place.
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

// Hands the parser's events to the builder. The parser keeps one bit per level of nesting and
// does not recurse; exceptions of the builder pass through it.
class Events final : public nlohmann::json_sax<nlohmann::json> {
public:
    explicit Events(std::string_view document) : document_(document) {}

    std::vector<ModelNode> takeNodes() { return builder_.takeNodes(); }

    bool null() override { return builder_.other("null"), true; }
    bool boolean(bool value) override { return builder_.other(value ? "true" : "false"), true; }
    bool number_integer(number_integer_t value) override
    {
        return builder_.number(static_cast<double>(value)), true;
    }
    bool number_unsigned(number_unsigned_t value) override { return builder_.code(value), true; }
    bool number_float(number_float_t value, const string_t&) override
    {
        return builder_.number(value), true;
    }
    bool string(string_t& value) override { return builder_.text(value), true; }
    bool binary(binary_t&) override { return false; } // JSON texts have none
    bool start_object(std::size_t) override { return builder_.beginObject(), true; }
    bool key(string_t& name) override { return builder_.key(name), true; }
    bool end_object() override { return builder_.endObject(), true; }
    bool start_array(std::size_t) override { return builder_.beginArray(), true; }
    bool end_array() override { return builder_.endArray(), true; }
    bool parse_error(
        std::size_t position, const std::string&, const nlohmann::detail::exception& error) override
    {
        // The position is the number of bytes read, the offending one included.
        failAt(document_, position == 0 ? 0 : position - 1, reasonOf(error.what()));
    }

private:
    std::string_view document_;
    ModelBuilder builder_;
};

} // namespace

std::vector<ModelNode> readModel(std::string_view text)
{
    // The parser takes a NUL for the end of the text and would pass over what follows.
    if (const std::size_t nul = text.find('\0'); nul != std::string_view::npos)
        failAt(text, nul, "the file holds the character NUL");
    const NumericLocale decimalPoint;
    Events events(text);
    nlohmann::json::sax_parse(text.begin(), text.end(), &events);
    return events.takeNodes();
}

} // namespace Vorn
