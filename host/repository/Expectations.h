// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What an error says was expected where a rule of the grammar did not match.

#pragma once

#include "host/repository/Grammar.h"

namespace Host::Grammar {

// clang-format off
template <typename Rule> inline constexpr const char* expectation = nullptr;

template <> inline constexpr auto expectation<CommentEnd> = "*/ at the end of the comment";
template <> inline constexpr auto expectation<EscapeCode> =
    "one of b t n f r \" ' \\ or x with hexadecimal digits after the backslash";
template <> inline constexpr auto expectation<PieceEnd> =
    "a character or the closing \" of the string";
template <> inline constexpr auto expectation<OneCharacter> = "a character between the single quotes";
template <> inline constexpr auto expectation<CharacterEnd> = "the closing ' of the character";
template <> inline constexpr auto expectation<Number> =
    "a number: decimal, octal from 0, hexadecimal from 0x, binary up to b, or real";
template <> inline constexpr auto expectation<Scalar> =
    "a string, character, number, true, false or null";
template <> inline constexpr auto expectation<Value> =
    "a string, character, number, true, false, null or a list in braces";
template <> inline constexpr auto expectation<ListEnd> = ", or } in the list";
template <> inline constexpr auto expectation<QualifierDataType> = "a data type";
template <> inline constexpr auto expectation<Type> =
    "a data type, or the name of a class followed by ref";
template <> inline constexpr auto expectation<ArrayEnd> = "the array's size or ]";
template <> inline constexpr auto expectation<Flavor> =
    "EnableOverride, DisableOverride, ToSubclass, Restricted or Translatable";
template <> inline constexpr auto expectation<Scope> =
    "schema, class, association, indication, qualifier, property, reference, method, parameter or any";
template <> inline constexpr auto expectation<Open> = "(";
template <> inline constexpr auto expectation<Close> = ")";
template <> inline constexpr auto expectation<WordsEnd> = ", or )";
template <> inline constexpr auto expectation<Qualifier> = "the name of a qualifier";
template <> inline constexpr auto expectation<QualifiersEnd> = ", or ] after the qualifier";
template <> inline constexpr auto expectation<DeclaredName> = "the name of the qualifier";
template <> inline constexpr auto expectation<Colon> = ": and the qualifier's type";
template <> inline constexpr auto expectation<ScopeComma> = ", and the qualifier's scope";
template <> inline constexpr auto expectation<ScopeKeyword> = "Scope";
template <> inline constexpr auto expectation<FlavorKeyword> = "Flavor";
template <> inline constexpr auto expectation<Semicolon> = ";";
template <> inline constexpr auto expectation<NamedParameter> = "the name of the parameter";
template <> inline constexpr auto expectation<Parameter> = "a parameter";
template <> inline constexpr auto expectation<ParametersEnd> = ", or ) after the parameter";
template <> inline constexpr auto expectation<NamedFeature> =
    "the name of the property, reference or method";
template <> inline constexpr auto expectation<NoFeature> =
    "a property, a reference, a method or }";
template <> inline constexpr auto expectation<FeatureEnd> = "; after the declaration";
template <> inline constexpr auto expectation<NamedClass> = "the name of the class";
template <> inline constexpr auto expectation<AliasName> = "an alias such as $Name";
template <> inline constexpr auto expectation<NamedSuperclass> = "the name of the superclass";
template <> inline constexpr auto expectation<ClassOpen> = "{";
template <> inline constexpr auto expectation<ClassKeyword> = "class after the qualifiers";
template <> inline constexpr auto expectation<Instances> =
    "a class or qualifier declaration (instances are not accepted)";
template <> inline constexpr auto expectation<NamedPragma> = "the name of the pragma";
template <> inline constexpr auto expectation<PragmaText> = "a string";
template <> inline constexpr auto expectation<Production> =
    "#pragma, a qualifier declaration or a class";
// clang-format on

} // namespace Host::Grammar
