// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/collect/Bmc.h"

#include <algorithm>
#include <thread>

namespace Ipmi {

namespace {

using std::chrono::milliseconds;

constexpr milliseconds maximumSilence{5000};

// The kernel repeats a message to a satellite after half of this time. The rest of the silence is
// the BMC's, which may be the one that does not answer.
constexpr milliseconds satelliteTimeout{2000};

} // namespace

Bytes Bmc::ask(const AddressedCommand& command)
{
    constexpr int repetitions = 2;
    constexpr milliseconds pause{100};
    Bytes answer = exchange(command);
    for (int count = 0; count < repetitions && answer.front() == CompletionCode::busy; ++count) {
        std::this_thread::sleep_for(pause);
        answer = exchange(command);
    }
    return answer;
}

Bytes Bmc::exchange(const AddressedCommand& command)
{
    const auto begin = Clock::now();
    const Responder& responder = command.responder;
    const std::pair satellite{responder.channel, responder.address};
    if (!responder.isBmc && silentSatellites_.contains(satellite))
        return {CompletionCode::timedOut};
    Bytes answer = transport_.send(command, responder.isBmc ? maximumSilence : satelliteTimeout);
    const bool isUnanswered = answer.empty();
    if (isUnanswered)
        answer = {CompletionCode::timedOut};
    const bool isTimeout = answer.front() == CompletionCode::timedOut;
    if (!isTimeout && answer.front() != CompletionCode::unspecified)
        return answer;
    // A satellite may answer at once with the code of a timeout, for one of its sensors.
    const bool hasWaited = Clock::now() - begin >= satelliteTimeout / 2;
    if (!responder.isBmc && (isUnanswered || (isTimeout && hasWaited)))
        silentSatellites_.insert(satellite);
    if (!isAlive(begin + maximumSilence)) {
        // The timeout of a satellite may have preceded what the driver reports at once.
        throw SilentBmc(Clock::now() - begin > maximumSilence / 2);
    }
    return answer;
}

// Returns whether the BMC answers before the end. Both codes may be those of the kernel, or of the
// BMC itself for a sensor that it cannot read.
bool Bmc::isAlive(Clock::time_point end)
{
    const auto left = std::chrono::ceil<milliseconds>(end - Clock::now());
    if (left <= milliseconds::zero())
        return false;
    const Bytes answer = transport_.send({{}, CommandCode::getDeviceId, {}}, left);
    return !answer.empty() && answer.front() != CompletionCode::timedOut &&
           answer.front() != CompletionCode::unspecified;
}

} // namespace Ipmi
