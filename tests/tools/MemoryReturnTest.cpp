// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/serve/MemoryReturn.h"
#include "host/cimxml/Message.h"

#include <gtest/gtest.h>

#include <fstream>
#include <memory>
#include <string>
#include <thread>
#include <vector>

#include <unistd.h>

#if defined(__has_feature)
#if __has_feature(address_sanitizer) || __has_feature(thread_sanitizer)
#define SENSOR_PROFILE_OTHER_MALLOC
#endif
#endif

namespace MemoryReturnTests {

using Host::CimXml::Answer;

class HeldAnswer : public Answer {
public:
    HeldAnswer(std::size_t objects, std::unique_ptr<char[]> last)
        : objects_(objects), last_(std::move(last))
    {
    }
    bool append(std::string&) override { return false; }
    std::size_t heldObjects() const noexcept override { return objects_; }

private:
    std::size_t objects_;
    std::unique_ptr<char[]> last_;
};

// Uses 64 MiB in small blocks, on a thread as workers are, and keeps the last of them, behind
// which nothing can be given back.
class WastefulHandler : public Host::CimXml::OperationHandler {
public:
    explicit WastefulHandler(std::size_t objects) : objects_(objects) {}
    std::unique_ptr<Answer> answer(
        const Host::CimXml::Message&, const Host::CimXml::Caller&) override
    {
        std::unique_ptr<Answer> made;
        std::thread([&] {
            std::vector<std::unique_ptr<char[]>> blocks(std::size_t{1} << 16);
            for (auto& block : blocks)
                block = std::make_unique<char[]>(1024);
            made = std::make_unique<HeldAnswer>(objects_, std::move(blocks.back()));
        }).join();
        return made;
    }

private:
    std::size_t objects_;
};

std::size_t residentMegabytes()
{
    std::size_t whole = 0;
    std::size_t resident = 0;
    std::ifstream("/proc/self/statm") >> whole >> resident;
    return resident * static_cast<std::size_t>(::sysconf(_SC_PAGESIZE)) >> 20U;
}

// What is resident more once an answer of so many objects was dropped.
std::size_t leftBehindBy(std::size_t objects)
{
    WastefulHandler handler(objects);
    Tools::MemoryReturn memoryReturn(handler);
    const Host::CimXml::Message message(
        R"(<CIM CIMVERSION="2.0" DTDVERSION="2.0"><MESSAGE ID="1" PROTOCOLVERSION="1.0">)"
        R"(<SIMPLEREQ><IMETHODCALL NAME="EnumerateClassNames"><LOCALNAMESPACEPATH>)"
        R"(<NAMESPACE NAME="root"/></LOCALNAMESPACEPATH></IMETHODCALL></SIMPLEREQ></MESSAGE></CIM>)");
    const std::size_t before = residentMegabytes();
    auto answer = memoryReturn.answer(message, {});
    EXPECT_EQ(answer->heldObjects(), objects);
    answer.reset();
    const std::size_t after = residentMegabytes();
    return after > before ? after - before : 0;
}

TEST(MemoryReturn, WhatLargeAnswersLeaveFreeGoesBackToTheSystem)
{
#ifdef SENSOR_PROFILE_OTHER_MALLOC
    GTEST_SKIP() << "the sanitizer's memory is not given back";
#endif
    EXPECT_LT(leftBehindBy(10'000), 16U);
}

TEST(MemoryReturn, SmallerAnswersKeepItForTheNext)
{
#ifdef SENSOR_PROFILE_OTHER_MALLOC
    GTEST_SKIP() << "the sanitizer's memory is not given back";
#endif
    EXPECT_GT(leftBehindBy(9'999), 48U);
}

} // namespace MemoryReturnTests
