// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Sources of the tests' own. A test that provides one is linked with the function that opens them
// in place of the product's.

#pragma once

#include "platform/instrumentation/Source.h"

#include <functional>
#include <memory>
#include <string>

namespace Testing {

using SourceFactory = std::function<std::unique_ptr<Vorn::Source>()>;

// Lets VORN_INSTRUMENTATION name a kind of source, or replaces it. Thread-safe.
void provideSource(const std::string& scheme, SourceFactory factory);

} // namespace Testing
