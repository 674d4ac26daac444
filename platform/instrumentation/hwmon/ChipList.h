// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// libsensors' list of chips, shared by all sources of the process.

#pragma once

#include "platform/instrumentation/hwmon/Configuration.h"
#include "platform/instrumentation/hwmon/LibsensorsHooks.h"

#include <shared_mutex>
#include <string>
#include <vector>

namespace Vorn::Hwmon {

// libsensors keeps one list for the whole process. Any number of threads may read from it, but
// making it anew needs it alone: whoever calls libsensors holds a lock from here meanwhile, and
// not longer, so that a thread with two cursors cannot stand in its own way.
//
// While libsensors reads its configuration it sets the process's locale to "C" and back, which
// its interface gives no way to avoid. It happens at the first request and when the machine
// or the configuration has changed. Another user of libsensors in the same process shares the
// list; there is no way to keep the two apart.
class ChipList {
public:
    using Lock = std::shared_lock<std::shared_mutex>;

    // The list of this process. libsensors is released when the library is unloaded.
    static ChipList& instance();

    // The chips that the machine has now. Throws std::runtime_error with libsensors' reason.
    Lock lockPresent();

    // The chips as they were listed last.
    Lock lockKnown();

    ~ChipList();
    ChipList(const ChipList&) = delete;
    ChipList& operator=(const ChipList&) = delete;

private:
    ChipList() = default;

    void renew();
    void initialise(const Configuration& configuration);
    void reportOnce(
        const std::vector<LibsensorsHooks::ParseError>& errors, const Configuration& configuration);

    std::shared_mutex mutex_;
    LibsensorsHooks hooks_;
    std::string fingerprint_;           // of the machine that is listed; empty when nothing is
    std::vector<std::string> reported_; // what is wrong in the configuration
};

} // namespace Vorn::Hwmon
