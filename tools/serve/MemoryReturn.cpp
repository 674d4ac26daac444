// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/serve/MemoryReturn.h"

#include "host/cimxml/Message.h"
#include "tools/serve/FreedMemory.h"

#include <utility>

namespace Tools {

namespace {

using Host::CimXml::Response;

// The least size of a large message; usual ones have a few hundred bytes. The parsed message takes
// ten times as much and more.
constexpr std::size_t largeMessage = std::size_t{64} << 10;

class ReturningResponse : public Response {
public:
    explicit ReturningResponse(std::unique_ptr<Response> answer) : answer_(std::move(answer)) {}
    ~ReturningResponse() override
    {
        answer_.reset();
        returnFreedMemory();
    }
    ReturningResponse(const ReturningResponse&) = delete;
    ReturningResponse& operator=(const ReturningResponse&) = delete;

    bool append(std::string& out) override { return answer_->append(out); }
    std::size_t heldObjects() const noexcept override { return answer_->heldObjects(); }
    unsigned status() const noexcept override { return answer_->status(); }

private:
    std::unique_ptr<Response> answer_;
};

} // namespace

std::unique_ptr<Response> MemoryReturn::answer(
    const Host::CimXml::Message& message, const Host::CimXml::Caller& caller)
{
    const bool isLarge = message.size() >= largeMessage;
    std::unique_ptr<Response> answer;
    try {
        answer = handler_.answer(message, caller);
    } catch (...) {
        if (isLarge)
            returnFreedMemory();
        throw;
    }
    if (answer->heldObjects() < largeAnswer && !isLarge)
        return answer;
    return std::make_unique<ReturningResponse>(std::move(answer));
}

} // namespace Tools
