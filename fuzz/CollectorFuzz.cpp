// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Whatever a controller answers, and with each workaround, two passes end, and every node has a
// name and either a finite reading or a status that says why there is none.

#include "tools/collect/Collector.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <span>

namespace {

// Takes each answer from the input: a byte for its length, and its bytes.
class InputTransport : public Ipmi::Transport {
public:
    explicit InputTransport(std::span<const std::uint8_t> input) : input_(input) {}

    Ipmi::Bytes send(const Ipmi::AddressedCommand& /*command*/, std::chrono::milliseconds) override
    {
        if (input_.empty())
            throw Ipmi::SilentBmc(true);
        const std::size_t length = std::min<std::size_t>(input_[0], input_.size() - 1);
        Ipmi::Bytes answer(input_.begin() + 1, input_.begin() + 1 + static_cast<long>(length));
        input_ = input_.subspan(1 + length);
        if (!answer.empty() && answer[0] == Ipmi::CompletionCode::busy)
            answer[0] = Ipmi::CompletionCode::success; // the collector would wait
        return answer;
    }

private:
    std::span<const std::uint8_t> input_;
};

bool isSound(const Vorn::MachineFileNode& node)
{
    constexpr std::array<unsigned, 3> statusesWithout = {13, 16, 17};
    const bool saysWhyNot = std::find(statusesWithout.begin(), statusesWithout.end(),
                                node.values.status) != statusesWithout.end();
    const auto& reading = node.values.reading;
    return !node.description.empty() && (reading ? std::isfinite(*reading) : saysWhyNot);
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size);

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    if (size == 0)
        return 0;
    InputTransport transport({data + 1, size - 1});
    Ipmi::Collector collector({.readsDiscrete = (data[0] & 1U) != 0,
        .ignoresScanning = (data[0] & 2U) != 0,
        .assumesBmcOwner = (data[0] & 4U) != 0});
    for (int pass = 0; pass < 2; ++pass) {
        try {
            collector.pass(transport, std::chrono::seconds(10));
        } catch (const std::runtime_error&) {
            collector.loseAll();
        }
        if (!std::all_of(collector.nodes().begin(), collector.nodes().end(), isSound))
            std::abort();
    }
    return 0;
}
