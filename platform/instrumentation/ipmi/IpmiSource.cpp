// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/ipmi/IpmiSource.h"

#include "platform/instrumentation/NodeStatus.h"
#include "platform/instrumentation/machinefile/MachineFile.h"

#include <cerrno>
#include <stdexcept>

#include <time.h> // NOLINT(modernize-deprecated-headers): <ctime> need not declare clock_gettime
#include <unistd.h>

namespace Vorn {

double secondsSinceStart()
{
    timespec now{};
    clock_gettime(CLOCK_BOOTTIME, &now);
    return static_cast<double>(now.tv_sec) + static_cast<double>(now.tv_nsec) / 1e9;
}

IpmiSource::IpmiSource(const std::string& named)
{
    const std::string path = named.empty() ? defaultCollection : named;
    const auto isMissing = [&] { return access(path.c_str(), F_OK) != 0 && errno == ENOENT; };
    if (isMissing())
        return;
    try {
        file_.emplace(path);
    } catch (const std::runtime_error&) {
        if (isMissing()) // since the first question
            return;
        throw;
    }
    if (!file_->renewal())
        throw std::runtime_error(
            "model file " + path + ": it does not say when the sensors were read");
}

const std::vector<Node>& IpmiSource::nodes(NodeLexicon::NodeType type)
{
    static const std::vector<Node> none;
    return file_ ? file_->nodes(type) : none;
}

const NodeReading& IpmiSource::read(const Node& node)
{
    const NodeReading& values = file_->read(node);
    if (!isOutdated())
        return values;
    lost_ = values;
    lost_.status = NodeStatus::lostCommunication;
    lost_.reading.reset();
    return lost_;
}

std::optional<double> IpmiSource::age() const
{
    return file_ ? std::optional(secondsSinceStart() - file_->renewal()->time) : std::nullopt;
}

bool IpmiSource::isOutdated() const
{
    constexpr double periods = 3;
    const double seconds = *age();
    // A file from before the machine started has a time that may lie in the future.
    return seconds < 0 || seconds > periods * file_->renewal()->period;
}

} // namespace Vorn
