// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The list of chips of the private copy of libsensors.

#pragma once

#include "platform/instrumentation/hwmon/Catalogue.h"
#include "platform/instrumentation/hwmon/FeatureLines.h"
#include "platform/instrumentation/hwmon/LibsensorsHooks.h"
#include "platform/instrumentation/hwmon/SensorsConfiguration.h"

#include <atomic>
#include <chrono>
#include <memory>
#include <optional>
#include <shared_mutex>
#include <string>
#include <vector>

namespace Vorn::Hwmon {

// libsensors keeps one list, which all sources of the process share. Its catalogue is made when the
// list is renewed, so that requests need libsensors only for values that it computes. Thread-safe.
//
// While libsensors reads its configuration it sets the process's locale to "C" and back, which its
// interface cannot prevent. This happens at the first request and when the machine or the
// configuration has changed. Another user of libsensors in the process has a list of its own.
class ChipList {
public:
    using Clock = std::chrono::steady_clock;

    // Returns the list of this process. libsensors is released when the library is unloaded.
    static ChipList& instance();

    // Returns the catalogue of the chips that are present now. Where the attributes of the chips
    // were listed longer ago than that age, they are listed again: a driver may have added some to
    // a chip that stays. Throws std::runtime_error with libsensors' reason.
    std::shared_ptr<const Catalogue> present(
        Clock::duration ageOfAttributes = std::chrono::seconds(2));

    // Returns the value of the attribute, to which libsensors applies the `compute` line; nothing
    // when it cannot be read, or when the chip was removed.
    std::optional<double> computedValue(
        const Chip& chip, const Feature& feature, const Attribute& attribute);

    ~ChipList();
    ChipList(const ChipList&) = delete;
    ChipList& operator=(const ChipList&) = delete;

private:
    ChipList() = default;

    std::shared_ptr<const Catalogue> known();
    bool isPresent(const Catalogue& catalogue, Clock::duration ageOfAttributes);
    void renew();
    FeatureLines initialise(const SensorsConfiguration& configuration);
    void reportOnce(const std::vector<LibsensorsHooks::ParseError>& errors,
        const SensorsConfiguration& configuration);

    std::shared_mutex mutex_; // shared by readers of libsensors' list, exclusive for its renewal
    LibsensorsHooks hooks_;
    std::shared_ptr<const Catalogue> catalogue_; // of libsensors' list; null where there is none
    std::atomic<Clock::time_point> attributesListed_{};
    std::vector<std::string> reported_; // errors in the configuration
};

} // namespace Vorn::Hwmon
