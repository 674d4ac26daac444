// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The operations on associations (DSP0200), from an instance or from a class.

#pragma once

#include "host/cimxml/Operation.h"
#include "host/operations/FoundObjects.h"

namespace Host {

class Manager;
class Repository;
class Request;

// Thread-safe. Each adds the objects to return; throws Refusal as the manager does. From a class
// they return classes, as the association classes declare them.
class AssociationOperations {
public:
    // Both must outlive it.
    AssociationOperations(const Repository& classes, Manager& manager)
        : classes_(classes), manager_(manager)
    {
    }

    void associators(
        const CimXml::Operation& operation, Request& request, FoundObjects& found) const;
    void associatorNames(
        const CimXml::Operation& operation, Request& request, FoundObjects& found) const;
    void references(
        const CimXml::Operation& operation, Request& request, FoundObjects& found) const;
    void referenceNames(
        const CimXml::Operation& operation, Request& request, FoundObjects& found) const;

private:
    const Repository& classes_;
    Manager& manager_;
};

} // namespace Host
