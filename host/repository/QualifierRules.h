// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Which qualifiers are in effect on an element.

#pragma once

#include "host/repository/Namespace.h"
#include "host/repository/Qualifier.h"
#include "host/repository/SyntaxTree.h"

namespace Host {

// The declaration a namespace gets. Throws MofError for a default that does not fit the type
// and for flavors that exclude each other.
std::unique_ptr<const QualifierDeclaration> declareQualifier(const Syntax::QualifierType& written);

// The qualifiers an element carries itself. Throws MofError for one that the namespace does not
// declare, one that comes twice, a value that does not fit, and too many.
QualifierList ownQualifiers(
    const std::vector<Syntax::Qualifier>& written, const Namespace& nameSpace);

// Throws MofError for the first qualifier that may not stand on such an element.
void requireScope(const QualifierList& own, Scope scope);

// Adds what the element inherits. Throws MofError for an own qualifier that gives another value
// to one that may not be overridden.
QualifierList withInherited(QualifierList own, const QualifierList& inherited);

// Whether one of the qualifiers ends with its class.
bool hasRestricted(const QualifierList& qualifiers);

// As a subclass has them that does not declare the element anew.
QualifierList inheritable(const QualifierList& qualifiers);

} // namespace Host
