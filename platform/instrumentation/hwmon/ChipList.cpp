// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/hwmon/ChipList.h"

#include "platform/instrumentation/Report.h"

#include <sensors/error.h>
#include <sensors/sensors.h>

#include <fcntl.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstdio>
#include <memory>
#include <mutex>
#include <new>
#include <stdexcept>
#include <system_error>
#include <utility>

namespace Vorn::Hwmon {

namespace {

// Throws std::system_error when the process lacks the descriptors with which chips are listed:
// libsensors takes a file that it cannot open for one that is not there, so that its list would
// have no chips, or labels would be missing.
void requireDescriptors()
{
    std::array<Descriptor, 3> spare; // the class's folder, a chip's and a file
    for (Descriptor& each : spare) {
        each = Descriptor(::open("/", O_PATH | O_CLOEXEC));
        if (!each.isOpen())
            throw std::system_error(errno, std::generic_category(), "the chips cannot be listed");
    }
}

} // namespace

ChipList& ChipList::instance()
{
    static ChipList list;
    return list;
}

ChipList::~ChipList()
{
    sensors_cleanup();
}

std::shared_ptr<const Catalogue> ChipList::present(Clock::duration ageOfAttributes)
{
    for (;;) {
        auto listed = known();
        if (listed != nullptr && isPresent(*listed, ageOfAttributes))
            return listed;
        const std::unique_lock alone(mutex_);
        if (catalogue_ != listed) // another thread has renewed the list meanwhile
            continue;
        renew();
        return catalogue_;
    }
}

std::optional<double> ChipList::computedValue(
    const Chip& chip, const Feature& feature, const Attribute& attribute)
{
    const std::shared_lock shared(mutex_);
    int chipPosition = 0;
    while (const auto* const name = sensors_get_detected_chips(nullptr, &chipPosition)) {
        if (chip.path != name->path)
            continue;
        int featurePosition = 0;
        while (const auto* const found = sensors_get_features(name, &featurePosition)) {
            if (feature.name != found->name)
                continue;
            const auto* const subfeature =
                sensors_get_subfeature(name, found, attribute.meaning->type);
            double value = 0.0;
            const bool isRead =
                subfeature != nullptr && sensors_get_value(name, subfeature->number, &value) == 0;
            // Another chip may have been registered at this path meanwhile.
            return isRead && folderId(chip.path) == chip.id ? std::optional(value) : std::nullopt;
        }
    }
    return std::nullopt;
}

std::shared_ptr<const Catalogue> ChipList::known()
{
    const std::shared_lock shared(mutex_);
    return catalogue_;
}

// To list the attributes of all chips takes as long as a tenth of their readings.
bool ChipList::isPresent(const Catalogue& catalogue, Clock::duration ageOfAttributes)
{
    if (catalogue.machine != presentMachine())
        return false;
    const auto now = Clock::now();
    if (now - attributesListed_.load() <= ageOfAttributes)
        return true;
    if (catalogue.attributes != attributeNames(catalogue.machine).fingerprint)
        return false;
    attributesListed_ = now;
    return true;
}

// REQUIRES: this thread holds the exclusive lock.
void ChipList::renew()
{
    // libsensors fails when a chip disappears while it lists them; the next attempt may succeed.
    constexpr int maximumAttempts = 5;
    for (int attempt = 1; true; ++attempt) {
        catalogue_.reset();
        sensors_cleanup();
        // The machine is taken first: a chip or attribute that appears while libsensors lists the
        // others makes a difference to it, and a later call lists them again.
        const auto now = Clock::now();
        Machine machine = presentMachine();
        const AttributeNames attributes = attributeNames(machine);
        try {
            Catalogue catalogue =
                machine.hasHwmon ? makeCatalogue(attributes, initialise(SensorsConfiguration()))
                                 : Catalogue();
            requireDescriptors();
            catalogue.machine = std::move(machine);
            catalogue.attributes = attributes.fingerprint;
            catalogue_ = std::make_shared<const Catalogue>(std::move(catalogue));
            attributesListed_ = now;
            return;
        } catch (const std::runtime_error&) {
            if (attempt == maximumAttempts)
                throw;
        }
    }
}

// Makes libsensors list the chips, with the configuration applied to them.
FeatureLines ChipList::initialise(const SensorsConfiguration& configuration)
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
    return {text, !errors.list().empty()};
}

// Reports the errors in the words of sensors(1), but for those that the previous call had: each new
// list of chips comes with a new reading of the same configuration.
void ChipList::reportOnce(const std::vector<LibsensorsHooks::ParseError>& errors,
    const SensorsConfiguration& configuration)
{
    std::vector<std::string> texts;
    for (const LibsensorsHooks::ParseError& error : errors) {
        const std::string& text =
            texts.emplace_back("Error: " + configuration.place(error.line) + ": " + error.text);
        if (std::find(reported_.begin(), reported_.end(), text) == reported_.end())
            report("ChipList", text);
    }
    reported_ = std::move(texts);
}

} // namespace Vorn::Hwmon
