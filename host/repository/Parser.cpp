// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/repository/Parser.h"

#include "host/repository/Expectations.h"
#include "host/repository/MofError.h"
#include "host/repository/TreeReader.h"

#include <tao/pegtl/contrib/parse_tree.hpp>

namespace Host {

namespace {

namespace peg = tao::pegtl;
using Node = peg::parse_tree::node;

template <typename Rule>
using IsKept = peg::parse_tree::selector<Rule,
    peg::parse_tree::store_content::on<Grammar::Pragma, Grammar::PragmaName,
        Grammar::QualifierDeclaration, Grammar::Class, Grammar::ClassName, Grammar::Superclass,
        Grammar::Feature, Grammar::FeatureName, Grammar::Parameters, Grammar::Parameter,
        Grammar::ParameterName, Grammar::Qualifier, Grammar::QualifierName, Grammar::ScopeWord,
        Grammar::FlavorWord, Grammar::DataType, Grammar::ReferenceClass, Grammar::Array,
        Grammar::ArraySize, Grammar::List, Grammar::Text, Grammar::PragmaText, Grammar::PieceText,
        Grammar::OneCharacter, Grammar::Real, Grammar::Hexadecimal, Grammar::Binary, Grammar::Octal,
        Grammar::Decimal, Grammar::True, Grammar::False, Grammar::Null>>;

struct Errors {
    template <typename Rule>
    static constexpr const char* message = Grammar::expectation<Rule>;
    // Only where a rule must match, not wherever it does not.
    template <typename Rule>
    static constexpr bool raise_on_failure = false;
};
template <typename Rule>
using Control = peg::must_if<Errors>::control<Rule>;

constexpr bool isIdentifierCharacter(char c)
{
    return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9') || c == '_';
}

// The word or character that stands where another was expected.
std::string wordAt(std::string_view rest)
{
    if (rest.empty())
        return "the end of the file";
    if (rest.front() == '\n' || rest.front() == '\r')
        return "the end of the line";
    std::size_t length = 1;
    if (isIdentifierCharacter(rest.front()))
        while (length < rest.size() && isIdentifierCharacter(rest[length]))
            ++length;
    return quotation(rest.substr(0, length));
}

MofError toMofError(const peg::parse_error& error, std::string_view text,
    const std::shared_ptr<const std::string>& file)
{
    const peg::position& at = error.positions().front();
    // A comment without an end is shown where it begins.
    const bool isComment = error.message() == Grammar::expectation<Grammar::CommentEnd>;
    const std::string found = wordAt(text.substr(isComment ? text.size() : at.byte));
    return {{file, static_cast<std::uint32_t>(at.line), static_cast<std::uint32_t>(at.column)},
        "expected " + std::string(error.message()) + ", found " + found};
}

} // namespace

std::vector<Syntax::Production> parseMof(
    std::string_view text, const std::shared_ptr<const std::string>& file)
{
    peg::memory_input<> input(text.data(), text.size(), "");
    std::unique_ptr<Node> root;
    try {
        root = peg::parse_tree::parse<Grammar::File, IsKept, peg::nothing, Control>(input);
    } catch (const peg::parse_error& error) {
        throw toMofError(error, text, file);
    }
    std::vector<Syntax::Production> productions;
    for (const auto& node : root->children)
        productions.push_back(readProduction(*node, file));
    return productions;
}

} // namespace Host
