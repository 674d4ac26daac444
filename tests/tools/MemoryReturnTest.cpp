// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/serve/MemoryReturn.h"

#include "host/cimxml/Message.h"
#include "tests/support/CimCall.h"
#include "tests/support/ProcessState.h"

#include <gtest/gtest.h>

#include <malloc.h>

#include <memory>
#include <stdexcept>
#include <string>
#include <thread>
#include <vector>

namespace MemoryReturnTests {

using Host::CimXml::Response;

class HeldResponse : public Response {
public:
    HeldResponse(std::size_t objects, std::unique_ptr<char[]> last)
        : objects_(objects), last_(std::move(last))
    {
    }
    bool append(std::string&) override { return false; }
    std::size_t heldObjects() const noexcept override { return objects_; }

private:
    std::size_t objects_;
    std::unique_ptr<char[]> last_;
};

// Allocates 64 MiB in small blocks on a thread of its own, and keeps the last block, which prevents
// the allocator from trimming its heap. Throws where the answer is to have no objects.
class WastefulHandler : public Host::CimXml::OperationHandler {
public:
    explicit WastefulHandler(std::size_t objects) : objects_(objects) {}
    std::unique_ptr<Response> answer(
        const Host::CimXml::Message&, const Host::CimXml::Caller&) override
    {
        std::unique_ptr<Response> made;
        std::thread([&] {
            std::vector<std::unique_ptr<char[]>> blocks(std::size_t{1} << 16);
            for (auto& block : blocks)
                block = std::make_unique<char[]>(1024);
            made = std::make_unique<HeldResponse>(objects_, std::move(blocks.back()));
        }).join();
        if (objects_ > 0)
            return made;
        kept_ = std::move(made);
        throw std::runtime_error("no answer");
    }

private:
    std::size_t objects_;
    std::unique_ptr<Response> kept_;
};

// Returns the growth of the resident memory, in MiB, after an answer with the given number of
// objects was destroyed.
std::size_t leftBehindBy(
    std::size_t objects, const std::string& body = Testing::cimCall("EnumerateClassNames"))
{
    WastefulHandler handler(objects);
    Tools::MemoryReturn memoryReturn(handler);
    const Host::CimXml::Message message(body);
    ::malloc_trim(0); // memory that earlier tests freed would be used again
    const std::size_t before = Testing::residentBytes() >> 20U;
    if (objects == 0) {
        EXPECT_THROW(memoryReturn.answer(message, {}), std::runtime_error);
    } else {
        EXPECT_EQ(memoryReturn.answer(message, {})->heldObjects(), objects);
    }
    const std::size_t after = Testing::residentBytes() >> 20U;
    return after > before ? after - before : 0;
}

TEST(MemoryReturnTest, WhatLargeAnswersLeaveFreeGoesBackToTheSystem)
{
    EXPECT_LT(leftBehindBy(10'000), 16U);
}

TEST(MemoryReturnTest, SmallerAnswersKeepItForTheNext)
{
    EXPECT_GT(leftBehindBy(9'999), 48U);
}

// Returns a message of the given size, most of it blanks after the call.
std::string messageOf(std::size_t size)
{
    const std::string call = Testing::cimCall("EnumerateClassNames");
    return call + std::string(size - call.size(), ' ');
}

TEST(MemoryReturnTest, WhatLargeMessagesLeaveFreeGoesBackToTheSystem)
{
    EXPECT_LT(leftBehindBy(1, messageOf(std::size_t{64} << 10)), 16U);
    EXPECT_LT(leftBehindBy(0, messageOf(std::size_t{64} << 10)), 16U);
    EXPECT_GT(leftBehindBy(1, messageOf((std::size_t{64} << 10) - 1)), 48U);
    EXPECT_GT(leftBehindBy(0, messageOf((std::size_t{64} << 10) - 1)), 48U);
}

} // namespace MemoryReturnTests
