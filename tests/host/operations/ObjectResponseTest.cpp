// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Responses that are read piece by piece after their request has ended.

#include "host/operations/ObjectResponse.h"
#include "host/broker/Broker.h"
#include "host/broker/Request.h"
#include "tests/host/operations/ScriptedManager.h"

#include <thread>

namespace OperationTests {

namespace {

constexpr std::size_t portion = std::size_t{16} * 1024;
constexpr std::size_t largestObject = 2048;

TEST(ObjectResponseTest, ManyObjectsComeInSmallPieces)
{
    ScriptedManager manager;
    manager.deliverThings(5000);
    const auto answer =
        (*manager).answer(Message(call("EnumerateInstances", classOf("ClassName", "Thing"))), {});
    std::string whole;
    std::size_t pieces = 0;
    for (std::string piece; answer->append(piece); piece.clear(), ++pieces) {
        EXPECT_FALSE(piece.empty());
        EXPECT_LT(piece.size(), portion + largestObject);
        whole += piece;
    }
    EXPECT_GT(pieces, whole.size() / (portion + largestObject));
    EXPECT_EQ(countOf(whole, "<VALUE.NAMEDINSTANCE>"), 5000U);
    EXPECT_TRUE(whole.ends_with("</SIMPLERSP></MESSAGE></CIM>\n"));
    EXPECT_FALSE(answer->append(whole));
}

TEST(ObjectResponseTest, WhatIsThereAlreadyStays)
{
    ScriptedManager manager;
    manager.deliverThings(1);
    const auto answer = (*manager).answer(
        Message(call("EnumerateInstanceNames", classOf("ClassName", "Thing"))), {});
    std::string out = "before ";
    EXPECT_TRUE(answer->append(out));
    EXPECT_TRUE(out.starts_with("before <?xml"));
    const std::string all = out;
    EXPECT_FALSE(answer->append(out));
    EXPECT_EQ(out, all);
}

TEST(ObjectResponseTest, AFailureComesInOnePieceOnce)
{
    Host::WrittenResponse answer("whole");
    std::string out = "the ";
    EXPECT_TRUE(answer.append(out));
    EXPECT_EQ(out, "the whole");
    EXPECT_FALSE(answer.append(out));
    EXPECT_EQ(out, "the whole");
}

TEST(ObjectResponseTest, AnotherThreadMayReadIt)
{
    ScriptedManager manager;
    manager.deliverThings(1000);
    std::unique_ptr<Response> answer;
    std::thread([&] {
        answer = (*manager).answer(
            Message(call("EnumerateInstances", classOf("ClassName", "Thing"))), {});
    }).join();
    std::string text;
    std::thread([&] {
        text = textOf(*answer);
        answer.reset();
    }).join();
    EXPECT_EQ(countOf(text, "<VALUE.NAMEDINSTANCE>"), 1000U);
}

TEST(ObjectResponseTest, ItsObjectsGoWhenItWasReadOrWithIt)
{
    const auto classes = Testing::compile(CimXmlTests::Classes);
    const Host::Broker broker;
    const Message message(call("EnumerateInstanceNames", classOf("ClassName", "Thing")));
    std::weak_ptr<Host::Arena> memory;
    const auto make = [&] {
        const Host::Request request(broker);
        memory = request.shareArena();
        Host::FoundObjects objects(request.shareArena());
        objects.add(&request.makePath("root/test", "Thing"));
        return std::make_unique<Host::ObjectResponse>(message,
            Host::CimXml::OperationKind::enumerateInstanceNames, *classes,
            Host::CimXml::Location{"host", "root/test"}, Host::CimXml::ObjectSelection{},
            std::move(objects), std::nullopt);
    };
    auto read = make();
    EXPECT_FALSE(memory.expired());
    EXPECT_EQ(countOf(textOf(*read), "<INSTANCENAME"), 1U);
    EXPECT_TRUE(memory.expired());
    auto unread = make();
    EXPECT_FALSE(memory.expired());
    unread.reset();
    EXPECT_TRUE(memory.expired());
}

} // namespace

} // namespace OperationTests
