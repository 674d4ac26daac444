// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The operations on instances and their properties (DSP0200), dispatched to the manager.

#pragma once

#include "host/cimxml/Operation.h"
#include "host/operations/FoundObjects.h"

namespace Host {

class Manager;
class Repository;
class Request;

// All are thread-safe, add the objects to return and throw Refusal as the manager does. The
// operation has its effective selection.

void getInstance(const Manager& manager, const CimXml::Operation& operation, Request& request,
    FoundObjects& found);
void enumerateInstances(const Manager& manager, const CimXml::Operation& operation,
    Request& request, FoundObjects& found);
void enumerateInstanceNames(const Manager& manager, const CimXml::Operation& operation,
    Request& request, FoundObjects& found);

// Throws Refusal (CMPI_RC_ERR_NO_SUCH_PROPERTY) for a property that the class does not have.
void getProperty(const Manager& manager, const Repository& classes,
    const CimXml::Operation& operation, Request& request, FoundObjects& found);

} // namespace Host
