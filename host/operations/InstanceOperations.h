// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The operations on instances and their properties (DSP0200), dispatched to the manager.

#pragma once

#include "host/cimxml/Operation.h"
#include "host/operations/FoundObjects.h"

namespace Host {

class Manager;
class Repository;
class Request;

// Thread-safe. Each adds the objects to return; throws Refusal as the manager does. The operation
// has its effective selection.
class InstanceOperations {
public:
    // Both must outlive it.
    InstanceOperations(const Repository& classes, Manager& manager)
        : classes_(classes), manager_(manager)
    {
    }

    void get(const CimXml::Operation& operation, Request& request, FoundObjects& found) const;
    void enumerate(const CimXml::Operation& operation, Request& request, FoundObjects& found) const;
    void enumerateNames(
        const CimXml::Operation& operation, Request& request, FoundObjects& found) const;

    // Throws Refusal (CMPI_RC_ERR_NO_SUCH_PROPERTY) for one that the class does not have.
    void getProperty(
        const CimXml::Operation& operation, Request& request, FoundObjects& found) const;

private:
    // The name as it is declared.
    const std::string& propertyOf(const CimXml::Operation& operation) const;

    const Repository& classes_;
    Manager& manager_;
};

} // namespace Host
