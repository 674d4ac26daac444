// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The part of the MOF grammar (DSP0004, annex A) that the files in schema/ use. A rule that must
// match has in `expected` the text that an error message says was expected.

#pragma once

#include <tao/pegtl.hpp>

#include <array>

namespace Host::Grammar {

namespace peg = tao::pegtl;

// clang-format off

// Tokens, each with the blanks and comments behind it.
struct LineComment : peg::seq<peg::two<'/'>, peg::until<peg::eolf>> {};
struct Blanks : peg::star<peg::sor<peg::space, LineComment>> {};
template <typename Rule>
struct Token : peg::seq<Rule, Blanks> { static constexpr const char* expected = Rule::expected; };
template <char c>
struct Mark : peg::seq<peg::one<c>, Blanks> {
    static constexpr std::array text = {c, '\0'};
    static constexpr const char* expected = text.data();
};
template <typename Text>
struct Keyword : peg::seq<Text, peg::not_at<peg::identifier_other>, Blanks> {};
template <typename Rule, typename End>
struct CommaList : peg::seq<peg::must<Rule>, peg::star<Mark<','>, peg::must<Rule>>, peg::must<End>> {};

// Values.
struct PlainCharacter : peg::seq<peg::not_at<peg::one<'"', '\\'>>, peg::utf8::range<0x20, 0x10FFFF>> {};
struct Piece : peg::star<PlainCharacter> {};
struct ClosingQuote : peg::one<'"'> { static constexpr auto expected = "the closing \" of the string"; };
struct Text : peg::plus<peg::one<'"'>, Piece, peg::must<ClosingQuote>, Blanks> { static constexpr auto expected = "a string"; };
struct Digits : peg::sor<peg::one<'0'>, peg::seq<peg::range<'1', '9'>, peg::star<peg::digit>>> {};
struct Number : peg::seq<peg::opt<peg::one<'-'>>, Digits, peg::not_at<peg::identifier_other>> {};
struct True : TAO_PEGTL_ISTRING("true") {};
struct False : TAO_PEGTL_ISTRING("false") {};
struct Null : TAO_PEGTL_ISTRING("null") {};
struct Literal : peg::sor<Text, peg::seq<Number, Blanks>, Keyword<True>, Keyword<False>, Keyword<Null>> {
    static constexpr auto expected = "a string, decimal number, true, false or null";
};
struct ListEnd : Mark<'}'> { static constexpr auto expected = ", or } in the list"; };
struct List : peg::seq<Mark<'{'>, CommaList<Literal, ListEnd>> {};
struct Default : peg::seq<Mark<'='>, peg::must<Literal>> {};

// Types.
struct TypeName : peg::identifier { static constexpr auto expected = "a data type or the name of a class"; };
struct ArrayMark : peg::seq<Mark<'['>, peg::must<Mark<']'>>> {};

// Qualifiers.
struct QualifierName : peg::identifier { static constexpr auto expected = "the name of a qualifier"; };
struct QualifierValue : peg::sor<peg::seq<Mark<'('>, peg::must<Literal, Mark<')'>>>, List> {};
struct Qualifier : peg::seq<peg::must<Token<QualifierName>>, peg::opt<QualifierValue>> {
    static constexpr auto expected = QualifierName::expected;
};
struct QualifiersEnd : Mark<']'> { static constexpr auto expected = ", or ] after the qualifier"; };
struct Qualifiers : peg::seq<Mark<'['>, CommaList<Qualifier, QualifiersEnd>> {};

// Qualifier declarations.
struct ScopeName : peg::identifier { static constexpr auto expected = "a scope"; };
struct FlavorName : peg::identifier { static constexpr auto expected = "a flavor"; };
struct WordsEnd : Mark<')'> { static constexpr auto expected = ", or )"; };
struct ScopeKeyword : Keyword<TAO_PEGTL_ISTRING("scope")> { static constexpr auto expected = "Scope"; };
struct FlavorKeyword : Keyword<TAO_PEGTL_ISTRING("flavor")> { static constexpr auto expected = "Flavor"; };
struct QualifierDeclaration : peg::seq<Keyword<TAO_PEGTL_ISTRING("qualifier")>,
    peg::must<Token<QualifierName>, Mark<':'>, Token<TypeName>>, peg::opt<ArrayMark>, peg::opt<Default>,
    peg::must<Mark<','>, ScopeKeyword, Mark<'('>>, CommaList<Token<ScopeName>, WordsEnd>,
    peg::must<Mark<','>, FlavorKeyword, Mark<'('>>, CommaList<Token<FlavorName>, WordsEnd>,
    peg::must<Mark<';'>>> {};

// Classes.
struct Reference : Keyword<TAO_PEGTL_ISTRING("ref")> {};
struct PropertyName : peg::identifier { static constexpr auto expected = "the name of the property"; };
struct PropertyType : Token<TypeName> { static constexpr auto expected = "a property or }"; };
struct PropertyEnd : Mark<';'> { static constexpr auto expected = "; after the property"; };
struct NamedProperty : peg::must<Token<PropertyName>> {};
struct Property : peg::seq<peg::opt<Qualifiers>, peg::must<PropertyType>,
    peg::sor<peg::seq<Reference, NamedProperty>, peg::seq<NamedProperty, peg::opt<ArrayMark>, peg::opt<Default>>>,
    peg::must<PropertyEnd>> {};
struct ClassName : peg::identifier { static constexpr auto expected = "the name of a class"; };
struct Superclass : peg::identifier { static constexpr auto expected = "the name of the superclass"; };
struct ClassKeyword : Keyword<TAO_PEGTL_ISTRING("class")> { static constexpr auto expected = "class after the qualifiers"; };
struct ClassHead : peg::seq<peg::sor<ClassKeyword, peg::seq<Qualifiers, peg::must<ClassKeyword>>>,
    peg::must<Token<ClassName>>, peg::opt<Mark<':'>, peg::must<Token<Superclass>>>, peg::must<Mark<'{'>>> {};
struct Class : peg::seq<ClassHead, peg::until<Mark<'}'>, Property>, peg::must<Mark<';'>>> {};

// Files.
struct PragmaName : peg::sor<TAO_PEGTL_ISTRING("include"), TAO_PEGTL_ISTRING("namespace")> {
    static constexpr auto expected = "include or namespace";
};
struct Pragma : peg::seq<Keyword<TAO_PEGTL_ISTRING("#pragma")>,
    peg::must<Token<PragmaName>, Mark<'('>, Text, Mark<')'>>> {};
struct Declaration : peg::sor<Pragma, QualifierDeclaration, Class> {
    static constexpr auto expected = "#pragma, a qualifier declaration or a class";
};
struct File : peg::seq<Blanks, peg::until<peg::eof, peg::must<Declaration>>> {};

// clang-format on

} // namespace Host::Grammar
