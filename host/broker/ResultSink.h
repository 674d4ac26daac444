// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Where the answer of a provider goes.

#pragma once

#include <cmpidt.h>

namespace Host {

class Error;
class Instance;
class ObjectPath;
class Value;

// Called while the provider runs, by one thread at a time. What is handed over belongs to
// the request and may be changed by the provider after the call: a sink that keeps it takes
// a copy. An exception reaches the provider as CMPI_RC_ERR_FAILED.
class ResultSink {
public:
    virtual ~ResultSink() = default;

    virtual void instance(const Instance& instance) = 0;
    virtual void path(const ObjectPath& path) = 0;
    virtual void data(const Value& value) = 0;
    virtual void error(const Error& error) = 0;
    // The answer is complete; nothing but refusals follows.
    virtual void done() = 0;
    // Something was delivered that is nothing: null, without a handle, of a type that no
    // value can have, or after the end.
    virtual void refused(CMPIrc code) = 0;
};

} // namespace Host
