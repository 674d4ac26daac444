// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

namespace Tools {

enum class ServiceState { ready, reloading, stopping };

// Tells the service manager that started this process, where one waits to be told.
void tellServiceManager(ServiceState state) noexcept;

} // namespace Tools
