// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The operations on associations (DSP0200), from an instance or from a class.

#pragma once

#include "host/cimxml/Operation.h"
#include "host/operations/FoundObjects.h"

namespace Host {

class Manager;
class Repository;
class Request;

// All are thread-safe, add the objects to return and throw Refusal as the manager does. From a
// class they return classes, as the association classes declare them.

void associators(const Manager& manager, const Repository& classes,
    const CimXml::Operation& operation, Request& request, FoundObjects& found);
void associatorNames(const Manager& manager, const Repository& classes,
    const CimXml::Operation& operation, Request& request, FoundObjects& found);
void references(const Manager& manager, const Repository& classes,
    const CimXml::Operation& operation, Request& request, FoundObjects& found);
void referenceNames(const Manager& manager, const Repository& classes,
    const CimXml::Operation& operation, Request& request, FoundObjects& found);

} // namespace Host
