// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The list of chips of the private copy of libsensors.

#pragma once

#include "platform/instrumentation/hwmon/LibsensorsHooks.h"
#include "platform/instrumentation/hwmon/SensorsConfiguration.h"

#include <shared_mutex>
#include <string>
#include <vector>

namespace Vorn::Hwmon {

// libsensors keeps one list, which all sources of the process share. Any number of threads may read
// it, but renewing it excludes all others: a caller of libsensors holds a lock of this class for
// the duration of the call, and no longer, so that a thread with two cursors cannot block itself.
//
// While libsensors reads its configuration it sets the process's locale to "C" and back, which its
// interface cannot prevent. This happens at the first request and when the machine or the
// configuration has changed. Another user of libsensors in the process has a list of its own.
class ChipList {
public:
    using Lock = std::shared_lock<std::shared_mutex>;

    // Returns the list of this process. libsensors is released when the library is unloaded.
    static ChipList& instance();

    // Renews the list if the machine has changed, and locks it. Throws std::runtime_error with
    // libsensors' reason.
    Lock lockPresent();

    // Locks the list without renewing it.
    Lock lockKnown();

    ~ChipList();
    ChipList(const ChipList&) = delete;
    ChipList& operator=(const ChipList&) = delete;

private:
    ChipList() = default;

    void renew();
    void initialise(const SensorsConfiguration& configuration);
    void reportOnce(const std::vector<LibsensorsHooks::ParseError>& errors,
        const SensorsConfiguration& configuration);

    std::shared_mutex mutex_;
    LibsensorsHooks hooks_;
    std::string fingerprint_;           // of the machine when it was listed; empty before
    std::vector<std::string> reported_; // errors in the configuration
};

} // namespace Vorn::Hwmon
