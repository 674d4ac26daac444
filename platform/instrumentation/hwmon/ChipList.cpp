// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/hwmon/ChipList.h"

#include "platform/instrumentation/Report.h"
#include "platform/instrumentation/hwmon/Machine.h"

#include <sensors/error.h>
#include <sensors/sensors.h>

#include <algorithm>
#include <cstdio>
#include <memory>
#include <mutex>
#include <new>
#include <stdexcept>
#include <utility>

namespace Vorn::Hwmon {

ChipList& ChipList::instance()
{
    static ChipList list;
    return list;
}

ChipList::~ChipList()
{
    const std::unique_lock alone(mutex_);
    sensors_cleanup();
}

ChipList::Lock ChipList::lockKnown()
{
    return Lock(mutex_);
}

ChipList::Lock ChipList::lockPresent()
{
    for (;;) {
        const std::string present = machineFingerprint();
        Lock shared(mutex_);
        if (fingerprint_ == present)
            return shared;
        shared.unlock();
        {
            const std::unique_lock alone(mutex_);
            if (fingerprint_ != present)
                renew();
        }
        shared.lock();
        // The fingerprint is empty when a renewal by another thread failed meanwhile.
        if (!fingerprint_.empty())
            return shared;
    }
}

// REQUIRES: this thread holds the exclusive lock.
void ChipList::renew()
{
    // libsensors fails when a chip disappears while it lists them; the next attempt may succeed.
    constexpr int maximumAttempts = 5;
    for (int attempt = 1; true; ++attempt) {
        fingerprint_.clear();
        sensors_cleanup();
        // The fingerprint is taken first: a chip that appears while libsensors lists the others
        // changes it, and the next call lists them again.
        const std::string present = machineFingerprint();
        try {
            if (hasHwmon())
                initialise(SensorsConfiguration());
            fingerprint_ = present;
            return;
        } catch (const std::runtime_error&) {
            if (attempt == maximumAttempts)
                throw;
        }
    }
}

void ChipList::initialise(const SensorsConfiguration& configuration)
{
    std::string text = configuration.text();
    const std::unique_ptr<FILE, decltype(&fclose)> file(
        fmemopen(text.data(), text.size(), "r"), &fclose);
    if (file == nullptr)
        throw std::bad_alloc();
    const LibsensorsHooks::ParseErrors errors;
    const int result = sensors_init(file.get());
    reportOnce(errors.list(), configuration);
    if (result != 0)
        throw std::runtime_error(
            std::string("libsensors cannot list the chips: ") + sensors_strerror(result));
}

// Reports the errors that the previous call did not have: each new list of chips comes with a new
// reading of the same configuration.
void ChipList::reportOnce(const std::vector<LibsensorsHooks::ParseError>& errors,
    const SensorsConfiguration& configuration)
{
    std::vector<std::string> texts;
    for (const LibsensorsHooks::ParseError& error : errors) {
        const std::string& text =
            texts.emplace_back(configuration.place(error.line) + ": " + error.text);
        if (std::find(reported_.begin(), reported_.end(), text) == reported_.end())
            report("ChipList", text);
    }
    reported_ = std::move(texts);
}

} // namespace Vorn::Hwmon
