// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The grammar of MOF: pragmas, qualifier declarations and classes. No rule contains itself, so
// that no text nests deeper than the rules do.

#pragma once

#include <tao/pegtl.hpp>

namespace Host::Grammar {

namespace peg = tao::pegtl;

// clang-format off

// Leaves the input where it was when it does not match: there the error is shown.
template <typename... Rules>
struct Whole : peg::sor<peg::seq<Rules...>, peg::failure> {};

// Between tokens.
struct CommentEnd : Whole<peg::until<peg::string<'*', '/'>>> {};
struct BlockComment : peg::seq<peg::string<'/', '*'>, peg::must<CommentEnd>> {};
struct LineComment : peg::seq<peg::two<'/'>, peg::until<peg::eolf>> {};
struct Blanks : peg::star<peg::sor<peg::one<' ', '\t', '\r', '\n', '\f', '\v'>, LineComment,
    BlockComment>> {};

template <typename... Rules>
struct Token : peg::seq<Whole<Rules...>, Blanks> {};
template <char c>
struct Mark : Token<peg::one<c>> {};
template <typename Text>
struct Keyword : Token<Text, peg::not_at<peg::identifier_other>> {};
template <typename Rule, typename End>
struct CommaList : peg::seq<peg::must<Rule>, peg::star<Mark<','>, peg::must<Rule>>, peg::must<End>> {};

// Texts and characters.
struct HexadecimalCode : peg::seq<peg::one<'x', 'X'>, peg::xdigit, peg::rep_opt<3, peg::xdigit>> {};
struct EscapeCode : Whole<peg::sor<peg::one<'b', 't', 'n', 'f', 'r', '"', '\'', '\\'>, HexadecimalCode>> {};
struct Escape : peg::seq<peg::one<'\\'>, peg::must<EscapeCode>> {};
struct ControlCharacter : peg::sor<peg::range<'\x00', '\x08'>, peg::range<'\x0a', '\x1f'>> {};
template <char quote>
struct PlainCharacter : peg::seq<peg::not_at<peg::sor<ControlCharacter, peg::one<quote>>>, peg::utf8::any> {};
struct PieceText : peg::star<peg::sor<Escape, PlainCharacter<'"'>>> {};
struct PieceEnd : peg::one<'"'> {};
struct Piece : peg::seq<peg::one<'"'>, PieceText, peg::must<PieceEnd>> {};
struct Text : peg::plus<Token<Piece>> {};
struct OneCharacter : peg::sor<Escape, PlainCharacter<'\''>> {};
struct CharacterEnd : peg::one<'\''> {};
struct CharacterLiteral : Token<peg::one<'\''>, peg::must<OneCharacter>, peg::must<CharacterEnd>> {};

// Numbers.
struct Sign : peg::opt<peg::one<'+', '-'>> {};
struct Exponent : peg::seq<peg::one<'e', 'E'>, Sign, peg::plus<peg::digit>> {};
struct Real : peg::seq<Sign, peg::star<peg::digit>, peg::one<'.'>, peg::plus<peg::digit>, peg::opt<Exponent>> {};
struct Hexadecimal : peg::seq<Sign, peg::one<'0'>, peg::one<'x', 'X'>, peg::plus<peg::xdigit>> {};
struct Binary : peg::seq<Sign, peg::plus<peg::one<'0', '1'>>, peg::one<'b', 'B'>> {};
struct Octal : peg::seq<Sign, peg::one<'0'>, peg::plus<peg::range<'0', '7'>>> {};
struct Decimal : peg::seq<Sign, peg::sor<peg::one<'0'>, peg::seq<peg::range<'1', '9'>, peg::star<peg::digit>>>> {};
struct NumberEnd : peg::not_at<peg::sor<peg::identifier_other, peg::one<'.'>>> {};
struct Number : Token<peg::sor<Real, Hexadecimal, Binary, Octal, Decimal>, NumberEnd> {};
struct NumberStart : peg::at<peg::one<'+', '-', '.', '0', '1', '2', '3', '4', '5', '6', '7', '8', '9'>> {};

// Values.
struct True : TAO_PEGTL_ISTRING("true") {};
struct False : TAO_PEGTL_ISTRING("false") {};
struct Null : TAO_PEGTL_ISTRING("null") {};
struct Scalar : peg::sor<Text, CharacterLiteral, peg::seq<NumberStart, peg::must<Number>>,
    Keyword<True>, Keyword<False>, Keyword<Null>> {};
struct ListEnd : Mark<'}'> {};
struct List : peg::seq<Mark<'{'>, peg::sor<Mark<'}'>, CommaList<Scalar, ListEnd>>> {};
struct Value : peg::sor<List, Scalar> {};
struct Default : peg::seq<Mark<'='>, peg::must<Value>> {};

// Types.
struct DataType : peg::sor<
    TAO_PEGTL_ISTRING("uint8"), TAO_PEGTL_ISTRING("uint16"), TAO_PEGTL_ISTRING("uint32"),
    TAO_PEGTL_ISTRING("uint64"), TAO_PEGTL_ISTRING("sint8"), TAO_PEGTL_ISTRING("sint16"),
    TAO_PEGTL_ISTRING("sint32"), TAO_PEGTL_ISTRING("sint64"), TAO_PEGTL_ISTRING("real32"),
    TAO_PEGTL_ISTRING("real64"), TAO_PEGTL_ISTRING("boolean"), TAO_PEGTL_ISTRING("string"),
    TAO_PEGTL_ISTRING("char16"), TAO_PEGTL_ISTRING("datetime")> {};
struct QualifierDataType : Keyword<DataType> {};
struct ReferenceClass : peg::identifier {};
struct Type : Whole<peg::sor<Keyword<DataType>,
    peg::seq<Token<ReferenceClass>, Keyword<TAO_PEGTL_ISTRING("ref")>>>> {};
struct ArraySize : peg::plus<peg::digit> {};
struct ArrayEnd : Mark<']'> {};
struct Array : peg::seq<Mark<'['>, peg::opt<Token<ArraySize>>, peg::must<ArrayEnd>> {};

// Qualifiers.
struct FlavorWord : peg::sor<
    TAO_PEGTL_ISTRING("enableoverride"), TAO_PEGTL_ISTRING("disableoverride"),
    TAO_PEGTL_ISTRING("tosubclass"), TAO_PEGTL_ISTRING("restricted"),
    TAO_PEGTL_ISTRING("translatable")> {};
struct Flavor : Keyword<FlavorWord> {};
struct ScopeWord : peg::sor<
    TAO_PEGTL_ISTRING("schema"), TAO_PEGTL_ISTRING("class"), TAO_PEGTL_ISTRING("association"),
    TAO_PEGTL_ISTRING("indication"), TAO_PEGTL_ISTRING("qualifier"),
    TAO_PEGTL_ISTRING("property"), TAO_PEGTL_ISTRING("reference"), TAO_PEGTL_ISTRING("method"),
    TAO_PEGTL_ISTRING("parameter"), TAO_PEGTL_ISTRING("any")> {};
struct Scope : Keyword<ScopeWord> {};
struct Open : Mark<'('> {};
struct Close : Mark<')'> {};
struct WordsEnd : Mark<')'> {};
struct QualifierName : peg::identifier {};
struct QualifierValue : peg::sor<peg::seq<Mark<'('>, peg::must<Scalar, Close>>, List> {};
struct Qualifier : peg::seq<Token<QualifierName>, peg::opt<QualifierValue>,
    peg::opt<Mark<':'>, peg::must<Flavor>, peg::star<Flavor>>> {};
struct QualifiersEnd : Mark<']'> {};
struct Qualifiers : peg::seq<Mark<'['>, CommaList<Qualifier, QualifiersEnd>> {};

// Qualifier declarations.
struct DeclaredName : Token<QualifierName> {};
struct Colon : Mark<':'> {};
struct ScopeComma : Mark<','> {};
struct ScopeKeyword : Keyword<TAO_PEGTL_ISTRING("scope")> {};
struct FlavorKeyword : Keyword<TAO_PEGTL_ISTRING("flavor")> {};
struct Semicolon : Mark<';'> {};
struct QualifierDeclaration : peg::seq<Keyword<TAO_PEGTL_ISTRING("qualifier")>,
    peg::must<DeclaredName, Colon, QualifierDataType>, peg::opt<Array>, peg::opt<Default>,
    peg::must<ScopeComma, ScopeKeyword, Open>, CommaList<Scope, WordsEnd>,
    peg::opt<Mark<','>, peg::must<FlavorKeyword, Open>, CommaList<Flavor, WordsEnd>>,
    peg::must<Semicolon>> {};

// Classes.
struct ParameterName : peg::identifier {};
struct NamedParameter : Token<ParameterName> {};
struct Parameter : peg::seq<peg::opt<Qualifiers>, peg::must<Type, NamedParameter>, peg::opt<Array>> {};
struct ParametersEnd : Mark<')'> {};
struct Parameters : peg::seq<Mark<'('>, peg::sor<Mark<')'>, CommaList<Parameter, ParametersEnd>>> {};
struct FeatureName : peg::identifier {};
struct NamedFeature : Token<FeatureName> {};
struct NoFeature : peg::failure {};
struct FeatureType : peg::sor<peg::seq<Qualifiers, peg::must<Type>>, Type, peg::must<NoFeature>> {};
struct FeatureEnd : Mark<';'> {};
struct Feature : peg::seq<FeatureType, peg::must<NamedFeature>,
    peg::sor<Parameters, peg::seq<peg::opt<Array>, peg::opt<Default>>>, peg::must<FeatureEnd>> {};
struct ClassName : peg::identifier {};
struct NamedClass : Token<ClassName> {};
struct AliasName : Token<peg::one<'$'>, peg::identifier> {};
struct Superclass : peg::identifier {};
struct NamedSuperclass : Token<Superclass> {};
struct ClassOpen : Mark<'{'> {};
struct ClassKeyword : Keyword<TAO_PEGTL_ISTRING("class")> {};
struct Instances : peg::failure {};
struct Instance : peg::seq<peg::at<Keyword<TAO_PEGTL_ISTRING("instance")>>, peg::must<Instances>> {};
struct ClassHead : peg::sor<ClassKeyword,
    peg::seq<Qualifiers, peg::opt<Instance>, peg::must<ClassKeyword>>> {};
struct Class : peg::seq<ClassHead, peg::must<NamedClass>,
    peg::opt<Keyword<TAO_PEGTL_ISTRING("as")>, peg::must<AliasName>>,
    peg::opt<Mark<':'>, peg::must<NamedSuperclass>>, peg::must<ClassOpen>,
    peg::until<Mark<'}'>, Feature>, peg::must<Semicolon>> {};

// Files.
struct PragmaName : peg::identifier {};
struct NamedPragma : Token<PragmaName> {};
struct PragmaText : Text {};
struct PragmaWord : peg::seq<peg::one<'#'>, peg::star<peg::blank>, TAO_PEGTL_ISTRING("pragma")> {};
struct Pragma : peg::seq<Keyword<PragmaWord>, peg::must<NamedPragma, Open, PragmaText, Close>> {};
struct Production : peg::sor<Pragma, QualifierDeclaration, Class, Instance> {};
struct File : peg::seq<peg::opt<peg::utf8::bom>, Blanks,
    peg::until<peg::eof, peg::must<Production>>> {};

// clang-format on

} // namespace Host::Grammar
