// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Sources that tests define. A test that provides one is linked with another openSource() in place
// of the product's.

#pragma once

#include "platform/instrumentation/Source.h"

#include <functional>
#include <memory>
#include <string>

namespace Testing {

using SourceFactory = std::function<std::unique_ptr<Vorn::Source>()>;

// Adds or replaces a kind of source that VORN_INSTRUMENTATION can name. Thread-safe.
void provideSource(const std::string& scheme, SourceFactory factory);

} // namespace Testing
